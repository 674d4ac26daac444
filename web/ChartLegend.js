// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The sensors in the chart, with their readings where the pointer is.

import { dashes, seriesColor } from './Chart.js';
import { rowsOf } from './ChartData.js';
import { nameOf } from './SensorRow.js';
import { exactTimeText, readingText, text } from './Texts.js';

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
    #sensors = [];
    #values = [];
    #rows = [];

    /** Calls `onRemove` with the deviceId of a sensor that the user removes. */
    constructor(onRemove) {
        this.list = document.getElementById('compared');
        this.onRemove = onRemove;
    }

    show(sensors) {
        this.#sensors = sensors;
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
        this.#rows = rowsOf(history);
    }

    /** Shows the readings of a row of the history; the present ones for null. */
    showRow(row) {
        const [time, ...values] = this.#rows[row] ?? [];
        this.#sensors.forEach((sensor, index) => {
            const then = Array.isArray(values[index]) ? values[index][1] : values[index];
            this.#values[index].textContent = time
                ? `${readingText(then, sensor.unit)} (${exactTimeText(time / 1000)})`
                : readingText(sensor.value, sensor.unit);
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
