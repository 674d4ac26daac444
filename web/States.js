// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The states of sensors: how urgent each is, and the shape that shows the urgency.

/** The urgencies, the most urgent first. */
export const urgencies = ['critical', 'warning', 'lost', 'unknown', 'inactive', 'normal'];

const urgencyByState = {
    'Normal': 'normal',
    'Warning low': 'warning',
    'Warning high': 'warning',
    'Warning': 'warning',
    'Critical low': 'critical',
    'Critical high': 'critical',
    'Critical': 'critical',
    'Failing soon': 'warning',
    'Lost': 'lost',
    'No contact': 'lost',
    'Disabled': 'inactive',
    'Offline': 'inactive',
    'Starting': 'inactive',
    'Stopping': 'inactive',
    'Stopped': 'inactive',
    'Dormant': 'inactive',
    'Unknown': 'unknown',
};

/** Returns the urgency of a state of `/api/sensors`. */
export function urgencyOf(state) {
    return urgencyByState[state] ?? 'unknown';
}

/** Returns whether a person should look at a sensor of that urgency. */
export function isProblem(urgency) {
    return urgencies.indexOf(urgency) <= urgencies.indexOf('lost');
}

/** The shapes of the urgencies: paths in a square of 16 units, filled by the even-odd rule. */
export const shapes = {
    critical: 'M5 1h6l4 4v6l-4 4H5l-4-4V5zM7.2 4v5h1.6V4zM7.2 10.4v1.7h1.6v-1.7z',
    warning: 'M8 1.5l7 13H1zM7.3 6v4.3h1.4V6zM7.3 11.3v1.5h1.4v-1.5z',
    lost: 'M3.5 2L8 6.5 12.5 2 14 3.5 9.5 8 14 12.5 12.5 14 8 9.5 3.5 14 2 12.5 6.5 8 2 3.5z',
    unknown: 'M8 2l6 6-6 6-6-6zM8 4.5L4.5 8 8 11.5 11.5 8z',
    inactive: 'M3 7h10v2H3z',
    normal: 'M8 5a3 3 0 1 0 0 6 3 3 0 0 0 0-6z',
};
