// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The chart in words, for screen readers and for the exact times.

import { extremesOf, stateRunsOf } from './ChartData.js';
import { nameOf } from './SensorRow.js';
import { exactTimeText, isolated, readingText, stateText, text } from './Texts.js';

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

/** Fills the list with the states of each sensor, the latest first. */
export function fillStateChanges(list, history, sensors) {
    list.replaceChildren(...sensors.flatMap((sensor, index) => {
        const runs = stateRunsOf(history.sensors[index], history).reverse();
        return runs.map(({ state, begin, end }) => {
            const item = document.createElement('li');
            const words = state === null ? text('nothingRecorded') : stateText(state);
            item.textContent = `${isolated(nameOf(sensor))}: ${words}, ` +
                `${exactTimeText(begin / 1000)} – ${exactTimeText(end / 1000)}`;
            return item;
        });
    }));
}
