// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The chart itself, by dygraphs.

import { rowsOf, stateRunsOf } from './ChartData.js';
import { drawUnderlay, styleValue } from './ChartUnderlay.js';
import { axisTimeText, quantityText } from './Texts.js';

/** The lines of sensors differ by color and by dashes. */
export const dashes = [null, [7, 3], [2, 2], [9, 3, 2, 3], [4, 4], [12, 4]];
export const mostSensors = dashes.length;
const shortestWindow = 60_000; // in milliseconds
export const seriesColor = (index) => styleValue(`--series-${index + 1}`);

/**
 * Loads dygraphs, for the first chart. Its legend inserts labels as HTML and sets styles in a way
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
    const values = [...Object.values(limits), ...history.sensors.flatMap(
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
    #valueRange = []; // of the whole history
    #isValueZoomed = false;
    #arguments = []; // of the last call of show()

    /** Calls `onPoint` with the row of the history that the pointer is at; with null for none. */
    constructor(element, onPoint) {
        this.element = element;
        this.onPoint = onPoint;
    }

    /**
     * Shows the history of the sensors; the limits are those of the first. A zoom is kept for the
     * same sensors. Needs dygraphs.
     */
    show(history, sensors) {
        this.#arguments = [history, sensors];
        this.#underlay = { sensors, runsOfSensors: history.sensors.map(
            (each) => stateRunsOf(each, history)) };
        const labels = ['time', ...history.sensors.map((_, index) => `${index}`)];
        const shown = JSON.stringify([history.span, history.sensors.map((each) => each.deviceId)]);
        const file = rowsOf(history);
        const valueRange = valueRangeOf(history, sensors[0]);
        this.#valueRange = valueRange;
        if (this.#dygraph && shown === this.#shown) {
            const dateWindow = this.#windowWithin(file);
            this.#dygraph.updateOptions(
                { file, ...dateWindow, ...(this.#isValueZoomed ? {} : { valueRange }) });
            return;
        }
        this.#shown = shown;
        this.remove();
        this.#dygraph = new window.Dygraph(this.element, file, {
            ...this.#fixedOptions(history), labels, valueRange,
            zoomCallback: (begin, end, [shownRange]) => {
                this.#isValueZoomed = String(shownRange) !== String(this.#valueRange);
            },
        });
    }

    /** Redraws the chart in the present colors of the style sheet. */
    redraw() {
        if (!this.#dygraph)
            return;
        const dateWindow = this.#dygraph.isZoomed('x') ? this.#dygraph.xAxisRange() : null;
        this.remove();
        this.show(...this.#arguments);
        this.#dygraph.updateOptions({ dateWindow });
    }

    remove() {
        this.#dygraph?.destroy();
        this.#dygraph = null;
        this.#isValueZoomed = false;
    }

    /**
     * Shows the part of the time that begins and ends at these parts of what is shown: within the
     * history, at whose ends it keeps its length.
     */
    zoom(begin, end) {
        if (!this.#dygraph)
            return;
        const [left, right] = this.#dygraph.xAxisRange();
        const [first, last] = this.#dygraph.xAxisExtremes();
        const length = Math.min((end - begin) * (right - left), last - first);
        const low = Math.min(Math.max(first, left + begin * (right - left)), last - length);
        if (length >= shortestWindow)
            this.#dygraph.updateOptions({ dateWindow: [low, low + length] });
    }

    showAll() {
        this.#dygraph?.resetZoom();
    }

    /** Returns the option that has a zoom follow a history that has left it behind. */
    #windowWithin(rows) {
        const [left, right] = this.#dygraph.xAxisRange();
        const first = rows[0][0].getTime();
        return this.#dygraph.isZoomed('x') && left < first
            ? { dateWindow: [first, first + right - left] } : {};
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
