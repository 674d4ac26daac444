// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The history of the sensors in the chart.

/** Returns whether the server keeps a history. A request for one that is off would fail. */
export const isHistoryKept = () => document.documentElement.dataset.history !== 'off';

/**
 * Returns the answer of `/api/history` for these devices; null where there is no history of them.
 * Throws where the server does not answer.
 */
export async function loadHistory(devices, span) {
    if (!isHistoryKept())
        return null;
    const query = new URLSearchParams({ span });
    for (const device of devices)
        query.append('device', device);
    const response = await fetch(`/api/history?${query}`);
    if (!response.ok && response.status !== 404)
        throw new Error(`/api/history: ${response.status}`);
    return response.ok ? response.json() : null;
}

/**
 * Returns rows for dygraphs: a time, and for each sensor its reading or, of a day, an array with
 * minimum, mean and maximum.
 */
export function rowsOf({ interval, end, sensors }) {
    const series = sensors.map(({ values, minimum, mean, maximum }) =>
        values ?? mean.map((value, i) => [minimum[i], value, maximum[i]]));
    const count = series[0].length;
    return series[0].map((_, i) => [new Date(1000 * (end - (count - i) * interval)),
        ...series.map((values) => values[i])]);
}

/** Returns the least, the mean and the greatest reading of a sensor's history; null for none. */
export function extremesOf({ values, minimum, mean, maximum }) {
    const present = (list) => list.filter((value) => value !== null);
    const means = present(values ?? mean);
    if (means.length === 0)
        return null;
    return {
        least: Math.min(...present(values ?? minimum)),
        mean: means.reduce((sum, value) => sum + value, 0) / means.length,
        greatest: Math.max(...present(values ?? maximum)),
    };
}

/** Returns the times at which each state began and ended, in milliseconds, the oldest first. */
export function stateRunsOf({ states }, { end, interval }) {
    let begin = end - interval * states.reduce((sum, [, count]) => sum + count, 0);
    return states.map(([state, count]) => {
        const run = { state, begin: 1000 * begin, end: 1000 * (begin + count * interval) };
        begin += count * interval;
        return run;
    });
}
