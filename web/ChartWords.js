// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The chart in words, for screen readers and for the exact times.

import { extremesOf, stateRunsOf } from './ChartData.js';
import { nameOf } from './SensorRow.js';
import { isolated, momentText, readingText, setText, stateText, text } from './Texts.js';

/** Returns a sentence for each sensor: its least, mean and greatest reading. */
export function summaryText(history, sensors) {
    return sensors.map((sensor, index) => {
        const name = isolated(nameOf(sensor));
        const extremes = extremesOf(history.sensors[index]);
        if (extremes === null)
            return text('noReadings', { name });
        const quantity = (value) => readingText(value, sensor.unit);
        return text('extremes', { name, least: quantity(extremes.least),
            mean: quantity(extremes.mean), greatest: quantity(extremes.greatest) });
    }).join(' ');
}

/** Fills the list with the states of each sensor, the latest first. Keeps items that stay. */
export function fillStateChanges(list, history, sensors) {
    const lines = sensors.flatMap((sensor, index) => {
        const runs = stateRunsOf(history.sensors[index], history).reverse();
        return runs.map(({ state, begin, end }) => {
            const words = state === null ? text('nothingRecorded') : stateText(state);
            const [from, to] = [begin, end].map((time) => momentText(time / 1000, history.span));
            return `${isolated(nameOf(sensor))}: ${words}, ${from} – ${to}`;
        });
    });
    while (list.children.length > lines.length)
        list.lastElementChild.remove();
    lines.forEach((line, index) => {
        const item = list.children[index] ?? list.appendChild(document.createElement('li'));
        setText(item, line);
    });
}
