// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Announces changes to screen readers.

import { nameOf, stateWords } from './SensorRow.js';
import { isProblem, urgencies } from './States.js';
import { isolated, text } from './Texts.js';

const collectingTime = 1_000; // changes often come together
const speakingTime = 5_000;
const mostSensors = 3;

/** Announces the sensors whose state became or ceased to be a problem. */
export class Announcer {
    #announced = new Map(); // the words for the state of each problem, by deviceId
    #waiting = new Set(); // of deviceIds
    #timer = null;

    constructor(machine) {
        this.machine = machine;
        this.region = document.getElementById('announcement');
        for (const sensor of machine.troubles())
            this.#announced.set(sensor.deviceId, stateWords(sensor));
        machine.addEventListener('change', ({ detail: { changed } }) => {
            for (const { deviceId, urgency } of changed)
                if (isProblem(urgency) || this.#announced.has(deviceId))
                    this.#waiting.add(deviceId);
            if (this.#waiting.size > 0)
                this.#timer ??= setTimeout(() => this.#announce(), collectingTime);
        });
    }

    #announce() {
        const news = [...this.#waiting].map((deviceId) => this.machine.sensors.get(deviceId))
            .filter((sensor) => sensor && this.#isNews(sensor));
        this.#waiting.clear();
        this.#timer = null;
        if (news.length === 0)
            return;
        news.sort((one, other) =>
            urgencies.indexOf(one.urgency) - urgencies.indexOf(other.urgency));
        const parts = news.slice(0, mostSensors).map((sensor) =>
            `${isolated(nameOf(sensor))}: ${stateWords(sensor)}`);
        if (news.length > mostSensors)
            parts.push(text('andMore', { number: news.length - mostSensors }));
        this.region.textContent = parts.join('; ');
        this.#timer = setTimeout(() => {
            this.#timer = null;
            this.region.textContent = '';
            if (this.#waiting.size > 0)
                this.#announce();
        }, speakingTime);
    }

    /** Returns whether the state differs from the one that was announced last. */
    #isNews(sensor) {
        const { deviceId, urgency } = sensor;
        const before = this.#announced.get(deviceId);
        if (!isProblem(urgency))
            return this.#announced.delete(deviceId);
        this.#announced.set(deviceId, stateWords(sensor));
        return before !== stateWords(sensor);
    }
}
