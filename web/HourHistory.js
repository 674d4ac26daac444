// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The last hour of all sensors, a reading a minute.

import { isHistoryKept } from './ChartData.js';

const points = 60;
const secondsOfPoint = 60;

export class HourHistory {
    isLive = false; // whether the readings of the machine are those of now
    #values = new Map(); // by deviceId, at most `points` of them
    #timer = 0;
    #isMissing = false;

    constructor(machine) {
        this.machine = machine;
    }

    /**
     * Reads the history, which the readings of the machine continue until the next call. Sets also
     * since when the sensors are in their states. Where the server keeps no history, the readings
     * are collected from now on; where it does not answer, it is asked again after a minute. While
     * the machine is not live, there are no readings.
     */
    async load() {
        clearInterval(this.#timer);
        this.#timer = setInterval(() => this.#continue(), 1000 * secondsOfPoint);
        if (!isHistoryKept())
            return;
        const response = await fetch(`/api/history?span=hour&points=${points}`).catch(() => null);
        this.#isMissing = response?.status !== 404;
        if (!response?.ok)
            return;
        const { interval, end, sensors } = await response.json();
        this.#isMissing = false;
        this.#values = new Map(sensors.map(({ deviceId, values }) => [deviceId, values]));
        this.machine.setSince(sensors.map(({ deviceId, states }) => {
            const [before, [state, count]] = [[null, 0], [null, 0], ...states].slice(-2);
            const isSinceEarlier = before[0] === null; // nothing was recorded before
            return { deviceId, state, since: end - count * interval, isSinceEarlier };
        }));
    }

    /** Returns the readings of the last hour and the present one, the oldest first. */
    valuesOf(deviceId) {
        return [...(this.#values.get(deviceId) ?? []), this.#present(deviceId)];
    }

    #present(deviceId) {
        return this.isLive ? this.machine.sensors.get(deviceId)?.value ?? null : null;
    }

    #continue() {
        if (this.#isMissing) {
            this.load();
            return;
        }
        this.#values = new Map([...this.machine.sensors.keys()].map((deviceId) =>
            [deviceId, this.valuesOf(deviceId).slice(-points)]));
    }
}
