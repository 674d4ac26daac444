// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A sensor in a list.

import { Gauge } from './Gauge.js';
import { shapes } from './States.js';
import { readingText, setText, stateText, text, timeText } from './Texts.js';

const template = document.getElementById('sensor-template').content.firstElementChild;

/** Returns the label, or what identifies a sensor that has none. */
export const nameOf = (sensor) => sensor.label ?? sensor.deviceId;

/** Returns the state in words. */
export const stateWords = (sensor) =>
    sensor.isGone ? text('gone') : stateText(sensor.state);

/** Returns since when the sensor is in its state; an empty text while that is unknown. */
export function sinceWords(sensor) {
    if (sensor.since === null)
        return '';
    return text(sensor.isSinceEarlier ? 'sinceBefore' : 'since', { time: timeText(sensor.since) });
}

/** Keeps the element of one sensor up to date. Sensors' texts never become markup. */
export class SensorRow {
    constructor(sensor) {
        this.element = template.cloneNode(true);
        const find = (selector) => this.element.querySelector(selector);
        this.shape = find('.shape path');
        this.button = find('button');
        this.reading = find('.reading');
        this.word = find('.word');
        this.since = find('.since');
        this.gauge = new Gauge(find('.gauge'));
        this.element.dataset.device = sensor.deviceId;
        find('button bdi').textContent = nameOf(sensor);
        find('.name').title = nameOf(sensor);
        find('.chip-name').textContent = sensor.chip;
        this.update(sensor);
    }

    update(sensor) {
        if (this.urgency !== sensor.urgency) {
            this.urgency = sensor.urgency;
            this.element.dataset.urgency = sensor.urgency;
            this.shape.setAttribute('d', shapes[sensor.urgency]);
        }
        setText(this.reading, readingText(sensor.value, sensor.unit));
        setText(this.word, stateWords(sensor));
        setText(this.since, sensor.urgency === 'normal' ? '' : sinceWords(sensor));
        this.gauge.update(sensor);
    }

    /** Marks whether the chart shows the sensor. */
    setShown(isShown) {
        this.button.setAttribute('aria-expanded', isShown);
    }
}
