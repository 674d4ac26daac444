// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The sensors in the chart, with their readings where the pointer is.

import { dashes, seriesColor } from './Chart.js';
import { rowsOf } from './ChartData.js';
import { nameOf } from './SensorRow.js';
import { momentText, readingText, setText, text } from './Texts.js';

const namespace = 'http://www.w3.org/2000/svg';

/** Returns a short line that looks as the one of the sensor in the chart. */
function sampleLine(index) {
    const svg = document.createElementNS(namespace, 'svg');
    const line = document.createElementNS(namespace, 'line');
    svg.setAttribute('viewBox', '0 0 28 4');
    svg.setAttribute('class', 'sample');
    svg.setAttribute('aria-hidden', 'true');
    for (const [name, value] of Object.entries({ x2: 28, y1: 2, y2: 2, 'stroke-width': 2.5,
        stroke: seriesColor(index), 'stroke-dasharray': (dashes[index] ?? []).join(' ') }))
        line.setAttribute(name, value);
    svg.append(line);
    return svg;
}

export class ChartLegend {
    #devices = [];
    #values = [];
    #history = null;
    #row = null; // of the history, where the pointer is

    /** Calls `onRemove` with the deviceId of a sensor that the user removes. */
    constructor(machine, onRemove) {
        this.machine = machine;
        this.list = document.getElementById('compared');
        this.onRemove = onRemove;
        machine.addEventListener('change', () => this.#update());
    }

    show(sensors) {
        this.#devices = sensors.map(({ deviceId }) => deviceId);
        this.#history = null;
        this.#values = sensors.map(() => document.createElement('span'));
        this.list.replaceChildren(...sensors.map((sensor, index) => {
            const item = document.createElement('li');
            const name = document.createElement('bdi');
            const chip = document.createElement('bdi');
            name.textContent = nameOf(sensor);
            chip.textContent = sensor.chip;
            chip.className = 'chip-name';
            this.#values[index].className = 'value';
            item.append(sampleLine(index), name, chip, this.#values[index]);
            if (sensors.length > 1)
                item.append(this.#removeButton(sensor));
            return item;
        }));
        this.showRow(null);
    }

    setHistory(history) {
        this.#history = history;
    }

    /** Shows the readings of a row of the history; the present ones for null. */
    showRow(row) {
        this.#row = row;
        this.#update();
    }

    #update() {
        const [time, ...values] =
            this.#history && this.#row !== null ? rowsOf(this.#history)[this.#row] ?? [] : [];
        this.#devices.forEach((device, index) => {
            const { value, unit } = this.machine.sensors.get(device) ?? { value: null };
            const then = Array.isArray(values[index]) ? values[index][1] : values[index];
            setText(this.#values[index], time
                ? `${readingText(then, unit)} (${momentText(time / 1000, this.#history.span)})`
                : readingText(value, unit));
        });
    }

    #removeButton(sensor) {
        const button = document.createElement('button');
        button.type = 'button';
        button.textContent = '✕';
        button.setAttribute('aria-label', text('remove', { name: nameOf(sensor) }));
        button.addEventListener('click', () => this.onRemove(sensor.deviceId));
        return button;
    }
}
