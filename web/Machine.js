// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The sensors of the machine as the page knows them.

import { isProblem, urgencyOf } from './States.js';

const order = new Intl.Collator('en', { numeric: true, sensitivity: 'base' });

/** Compares sensors by chip, label and identifier, so that "temp2" comes before "temp10". */
export function compareSensors(first, second) {
    return order.compare(first.chip, second.chip) ||
        order.compare(first.label ?? '', second.label ?? '') ||
        order.compare(first.deviceId, second.deviceId);
}

/**
 * A sensor is an object of `/api/sensors` with
 * - `urgency`, one of States.js;
 * - `isGone`: the machine does not have the sensor any more; its last reading is removed;
 * - `since`: the time of Unix at which its state began, null while that is unknown;
 * - `isSinceEarlier`: the state began before `since`, which is the beginning of the history.
 *
 * Dispatches `change`, whose `detail` has the sensors that were added or changed.
 */
export class Machine extends EventTarget {
    sensors = new Map(); // by deviceId

    /** Takes the list of all sensors. Those that it lacks are gone. */
    replace(list) {
        const listed = new Set(list.map((sensor) => sensor.deviceId));
        const gone = [...this.sensors.keys()].filter((deviceId) => !listed.has(deviceId));
        this.apply({ time: Math.floor(Date.now() / 1000), sensors: list, gone }, true);
    }

    /** Takes an event of changes. */
    apply({ time, sensors, gone }, isWholeList = false) {
        const changed = [];
        for (const sensor of sensors) {
            const known = this.sensors.get(sensor.deviceId);
            const isSame = known && !known.isGone && known.state === sensor.state;
            changed.push({
                ...sensor,
                urgency: urgencyOf(sensor.state),
                isGone: false,
                since: isSame ? known.since : known || !isWholeList ? time : null,
                isSinceEarlier: isSame && known.isSinceEarlier,
            });
        }
        for (const deviceId of gone) {
            const known = this.sensors.get(deviceId);
            if (known && !known.isGone)
                changed.push({ ...known, value: null, urgency: 'lost', isGone: true, since: time,
                    isSinceEarlier: false });
        }
        this.#store(changed);
    }

    /** Sets since when sensors are in their state, where that is unknown yet. */
    setSince(beginnings) {
        const changed = [];
        for (const { deviceId, state, since, isSinceEarlier } of beginnings) {
            const known = this.sensors.get(deviceId);
            if (known && known.since === null && known.state === state)
                changed.push({ ...known, since, isSinceEarlier });
        }
        this.#store(changed);
    }

    /** Returns the sensors that a person should look at. */
    troubles() {
        return [...this.sensors.values()].filter((sensor) => isProblem(sensor.urgency));
    }

    #store(changed) {
        const before = changed.map((sensor) => this.sensors.get(sensor.deviceId));
        for (const sensor of changed)
            this.sensors.set(sensor.deviceId, sensor);
        this.dispatchEvent(new CustomEvent('change', { detail: { changed, before } }));
    }
}
