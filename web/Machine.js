// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The sensors of the machine as the page knows them.

import { namesOf } from './Selectors.js';
import { isProblem, urgencyOf } from './States.js';

const order = new Intl.Collator('en', { numeric: true, sensitivity: 'base' });
const secondsUntilForgotten = 24 * 3600; // as long as the server has its history

/** Compares sensors by chip, label and identifier, so that "temp2" comes before "temp10". */
export function compareSensors(first, second) {
    return order.compare(first.chip, second.chip) ||
        order.compare(first.label ?? '', second.label ?? '') ||
        order.compare(first.deviceId, second.deviceId);
}

/**
 * A sensor is an object of `/api/sensors` with
 * - `names`, by which it is searched for;
 * - `urgency`, one of States.js;
 * - `isGone`: the machine does not have the sensor any more;
 * - `since`: the time of Unix at which its state began, null while that is unknown;
 * - `isSinceEarlier`: the state began at an unknown time before `since`.
 * A sensor that is gone for a day is forgotten.
 *
 * Dispatches `change`, whose `detail` has the sensors that were added or have changed, what they
 * were before, and the identifiers of those that are forgotten.
 */
export class Machine extends EventTarget {
    sensors = new Map(); // by deviceId
    #clockLead = 0; // of the server's clock, in seconds

    /** Takes the time of the server's clock. */
    setTime(time) {
        this.#clockLead = time - Date.now() / 1000;
        this.#store([]);
    }

    /** Takes the list of all sensors. Those that it lacks are gone. */
    replace(list) {
        const listed = new Set(list.map((sensor) => sensor.deviceId));
        const gone = [...this.sensors.keys()].filter((deviceId) => !listed.has(deviceId));
        this.#change(list, gone, { since: this.#now(), isSinceEarlier: true },
            { since: null, isSinceEarlier: false });
    }

    /** Takes an event of changes. */
    apply({ time, sensors, gone }) {
        const beginning = { since: time, isSinceEarlier: false };
        this.#change(sensors, gone, beginning, beginning);
    }

    /** Sets since when sensors are in their states, where the history knows better. */
    setSince(beginnings) {
        const changed = [];
        for (const { deviceId, state, since, isSinceEarlier } of beginnings) {
            const known = this.sensors.get(deviceId);
            const isKnown = known && (known.isGone ? null : known.state) === state;
            if (isKnown && (known.since === null ||
                (known.isSinceEarlier && (!isSinceEarlier || since < known.since))))
                changed.push({ ...known, since, isSinceEarlier });
        }
        this.#store(changed);
    }

    /** Returns the sensors that a person should look at. */
    troubles() {
        return [...this.sensors.values()].filter((sensor) => isProblem(sensor.urgency));
    }

    #now() {
        return Math.floor(Date.now() / 1000 + this.#clockLead);
    }

    /** Takes sensors; states began at `beginning`, and those of new sensors at `newBeginning`. */
    #change(sensors, gone, beginning, newBeginning) {
        const changed = sensors.map((sensor) => {
            const known = this.sensors.get(sensor.deviceId);
            const isSame = known && !known.isGone && known.state === sensor.state;
            const { since, isSinceEarlier } = isSame ? known : known ? beginning : newBeginning;
            const urgency = urgencyOf(sensor.state);
            const names = known?.names ?? namesOf(sensor);
            return { ...sensor, names, urgency, isGone: false, since, isSinceEarlier };
        });
        for (const deviceId of gone) {
            const known = this.sensors.get(deviceId);
            if (known && !known.isGone)
                changed.push({ ...known, ...beginning, value: null, urgency: 'lost',
                    isGone: true });
        }
        this.#store(changed);
    }

    #store(changed) {
        const before = changed.map((sensor) => this.sensors.get(sensor.deviceId));
        for (const sensor of changed)
            this.sensors.set(sensor.deviceId, sensor);
        const earliest = this.#now() - secondsUntilForgotten;
        const forgotten = [...this.sensors.values()].filter(({ isGone, since }) =>
            isGone && since < earliest).map(({ deviceId }) => deviceId);
        for (const deviceId of forgotten)
            this.sensors.delete(deviceId);
        if (changed.length > 0 || forgotten.length > 0)
            this.dispatchEvent(new CustomEvent('change',
                { detail: { changed, before, forgotten } }));
    }
}
