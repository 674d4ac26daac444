// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The chart itself, by dygraphs.

import { rowsOf, stateRunsOf } from './ChartData.js';
import { drawUnderlay, styleValue } from './ChartUnderlay.js';
import { axisTimeText, quantityText } from './Texts.js';

/** The lines of sensors differ by color and by dashes. */
export const dashes = [null, [7, 3], [2, 2], [9, 3, 2, 3], [4, 4], [12, 4]];
export const mostSensors = dashes.length;
export const seriesColor = (index) => styleValue(`--series-${index + 1}`);

/**
 * Loads dygraphs, for the first chart. Its legend makes markup of labels and sets styles in a way
 * that the Content-Security-Policy forbids, so it is removed.
 */
export async function loadDygraphs() {
    if (window.Dygraph)
        return;
    await import('/web/dygraph.min.js');
    const { Dygraph } = window;
    Dygraph.PLUGINS = Dygraph.PLUGINS.filter((plugin) => plugin !== Dygraph.Plugins.Legend);
}

/** Returns the range of the value axis: all readings and limits, with a margin. */
function valueRangeOf(history, { limits }) {
    const shown = Object.entries(limits).filter(([name]) => !name.endsWith('Fatal'));
    const values = [...shown.map(([, value]) => value), ...history.sensors.flatMap(
        (sensor) => [...(sensor.values ?? sensor.minimum), ...(sensor.maximum ?? [])])]
        .filter((value) => value !== null);
    if (values.length === 0)
        return [0, 1];
    const least = values.reduce((one, other) => Math.min(one, other));
    const greatest = values.reduce((one, other) => Math.max(one, other));
    const margin = 0.08 * (greatest - least) || 0.1 * Math.abs(greatest) || 1;
    return [least - margin, greatest + margin];
}

export class Chart {
    #dygraph = null;
    #underlay = null;
    #shown = '';
    #arguments = []; // of the last call of show()

    /** Calls `onPoint` with the row of the history that the pointer is at; with null for none. */
    constructor(element, onPoint) {
        this.element = element;
        this.onPoint = onPoint;
    }

    /**
     * Shows the history; the limits are those of `sensor`. A zoom is kept for the same sensors.
     * Needs dygraphs.
     */
    show(history, sensor) {
        this.#arguments = [history, sensor];
        this.#underlay = { sensor, runsOfSensors: history.sensors.map(
            (each) => stateRunsOf(each, history)) };
        const labels = ['time', ...history.sensors.map((_, index) => `${index}`)];
        const shown = JSON.stringify([history.span, history.sensors.map((each) => each.deviceId)]);
        const options = { file: rowsOf(history), valueRange: valueRangeOf(history, sensor) };
        if (this.#dygraph && shown === this.#shown) {
            const isZoomed = this.#dygraph.isZoomed();
            this.#dygraph.updateOptions(isZoomed ? { file: options.file } : options);
            return;
        }
        this.#shown = shown;
        this.remove();
        this.#dygraph = new window.Dygraph(this.element, options.file, {
            ...this.#fixedOptions(history), labels, valueRange: options.valueRange });
    }

    /** Draws the chart anew, with the present colors of the style sheet. */
    redraw() {
        if (!this.#dygraph)
            return;
        this.remove();
        this.show(...this.#arguments);
    }

    remove() {
        this.#dygraph?.destroy();
        this.#dygraph = null;
    }

    /** Shows the part of the time that begins and ends at these parts of what is shown. */
    zoom(begin, end) {
        if (!this.#dygraph)
            return;
        const [left, right] = this.#dygraph.xAxisRange();
        const [first, last] = this.#dygraph.xAxisExtremes();
        const low = Math.max(first, left + begin * (right - left));
        const high = Math.min(last, left + end * (right - left));
        if (high - low >= 60_000)
            this.#dygraph.updateOptions({ dateWindow: [low, high] });
    }

    showAll() {
        this.#dygraph?.resetZoom();
    }

    #fixedOptions({ span, sensors }) {
        return {
            customBars: span === 'day',
            series: Object.fromEntries(sensors.map((_, index) => [`${index}`,
                { color: seriesColor(index), strokePattern: dashes[index] }])),
            strokeWidth: 1.75,
            gridLineColor: styleValue('--line'),
            axisLineColor: styleValue('--line'),
            highlightCircleSize: 4,
            underlayCallback: (canvas, area, chart) =>
                drawUnderlay(canvas, area, chart, this.#underlay),
            highlightCallback: (event, time, points, row) => this.onPoint(row),
            unhighlightCallback: () => this.onPoint(null),
            axes: {
                x: { axisLabelFormatter: (time, granularity, option, chart) => {
                    const [begin, end] = chart.xAxisRange();
                    return axisTimeText(time / 1000, (end - begin) / 1000);
                } },
                y: { axisLabelFormatter: (value) => quantityText(value) },
            },
        };
    }
}
