// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The last hour of all sensors, a reading a minute.

const points = 60;

/** Reads the history once and continues it with the readings of the machine. */
export class HourHistory {
    #values = new Map(); // by deviceId, at most `points` of them

    constructor(machine) {
        this.machine = machine;
    }

    /** Sets also since when the sensors are in their states. Does nothing without a history. */
    async load() {
        const response = await fetch(`/api/history?span=hour&points=${points}`);
        if (!response.ok)
            return;
        const { interval, end, sensors } = await response.json();
        for (const { deviceId, values } of sensors)
            this.#values.set(deviceId, values.slice(-points));
        this.machine.setSince(sensors.flatMap(({ deviceId, states }) => {
            const [state, count] = states.at(-1) ?? [null, 0];
            const isSinceEarlier = states.length === 1;
            return [{ deviceId, state, since: end - count * interval, isSinceEarlier }];
        }));
        setInterval(() => this.#continue(), interval * 1000);
    }

    /** Returns the readings of the last hour and the present one, the oldest first. */
    valuesOf(deviceId) {
        const present = this.machine.sensors.get(deviceId)?.value ?? null;
        return [...(this.#values.get(deviceId) ?? []), present];
    }

    #continue() {
        for (const { deviceId, value } of this.machine.sensors.values()) {
            const values = this.#values.get(deviceId) ?? [];
            values.push(value);
            this.#values.set(deviceId, values.slice(-points));
        }
    }
}
