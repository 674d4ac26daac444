// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The last hour of all sensors, a reading a minute.

const points = 60;

export class HourHistory {
    #values = new Map(); // by deviceId, at most `points` of them
    #timer = 0;

    constructor(machine) {
        this.machine = machine;
    }

    /**
     * Reads the history, which the readings of the machine continue until the next call. Sets also
     * since when the sensors are in their states. Does nothing where there is no history.
     */
    async load() {
        const response = await fetch(`/api/history?span=hour&points=${points}`);
        if (!response.ok)
            return;
        const { interval, end, sensors } = await response.json();
        this.#values = new Map(sensors.map(({ deviceId, values }) => [deviceId, values]));
        this.machine.setSince(sensors.map(({ deviceId, states }) => {
            const [before, [state, count]] = [[null, 0], [null, 0], ...states].slice(-2);
            const isSinceEarlier = before[0] === null; // nothing was recorded before
            return { deviceId, state, since: end - count * interval, isSinceEarlier };
        }));
        clearInterval(this.#timer);
        this.#timer = setInterval(() => this.#continue(), interval * 1000);
    }

    /** Returns the readings of the last hour and the present one, the oldest first. */
    valuesOf(deviceId) {
        const present = this.machine.sensors.get(deviceId)?.value ?? null;
        return [...(this.#values.get(deviceId) ?? []), present];
    }

    #continue() {
        for (const { deviceId, value } of this.machine.sensors.values()) {
            const values = [...(this.#values.get(deviceId) ?? []), value];
            this.#values.set(deviceId, values.slice(-points));
        }
    }
}
