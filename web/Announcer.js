// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What screen readers say of sensors that change.

import { nameOf, stateWords } from './SensorRow.js';
import { isProblem } from './States.js';
import { isolated, text } from './Texts.js';

const collectingTime = 1_000; // changes often come together
const speakingTime = 5_000;
const mostSensors = 3;

/** Announces the sensors whose state became or ceased to be a problem. */
export class Announcer {
    #waiting = new Map(); // by deviceId
    #timer = null;

    constructor(machine) {
        machine.addEventListener('change', ({ detail: { changed, before } }) => {
            changed.forEach((sensor, i) => {
                const old = before[i];
                const isNews = old && stateWords(old) !== stateWords(sensor) &&
                    (isProblem(old.urgency) || isProblem(sensor.urgency));
                if (isNews)
                    this.#waiting.set(sensor.deviceId, sensor);
            });
            if (this.#waiting.size > 0)
                this.#timer ??= setTimeout(() => this.#announce(), collectingTime);
        });
    }

    #announce() {
        const sensors = [...this.#waiting.values()];
        const parts = sensors.slice(0, mostSensors).map((sensor) =>
            `${isolated(nameOf(sensor))}: ${stateWords(sensor)}`);
        if (sensors.length > mostSensors)
            parts.push(text('andMore', { number: sensors.length - mostSensors }));
        document.getElementById('announcement').textContent = parts.join('; ');
        this.#waiting.clear();
        this.#timer = setTimeout(() => {
            this.#timer = null;
            if (this.#waiting.size > 0)
                this.#announce();
        }, speakingTime);
    }
}
