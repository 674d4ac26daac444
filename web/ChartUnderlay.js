// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What lies below the lines of the chart: the limits of the first sensor, and the states of all.

import { limitText, quantityText, stateText } from './Texts.js';
import { urgencyOf } from './States.js';

const stripHeight = 5;
const margin = 4;

/** Returns a color or font of the style sheet by the name of its variable. */
export const styleValue = (name) =>
    getComputedStyle(document.documentElement).getPropertyValue(name).trim();

/** Fills the plot behind one sensor's states; each of several sensors has a strip at the bottom. */
function drawStates(canvas, area, chart, runsOfSensors) {
    const isStrip = runsOfSensors.length > 1;
    runsOfSensors.forEach((runs, index) => {
        for (const { state, begin, end } of runs) {
            const urgency = state === null ? null : urgencyOf(state);
            if (urgency === null || urgency === 'normal')
                continue;
            const left = Math.max(chart.toDomXCoord(begin), area.x);
            const right = Math.min(chart.toDomXCoord(end), area.x + area.w);
            if (right <= left)
                continue;
            canvas.fillStyle = styleValue(isStrip ? `--${urgency}` : `--${urgency}-band`);
            const top = area.y + area.h - stripHeight * (runsOfSensors.length - index);
            canvas.fillRect(left, isStrip ? top : area.y, right - left,
                isStrip ? stripHeight - 1 : area.h);
            const words = stateText(state);
            if (!isStrip && canvas.measureText(words).width + 2 * margin < right - left) {
                canvas.fillStyle = styleValue(`--${urgency}`);
                canvas.fillText(words, left + margin, area.y + area.h - margin);
            }
        }
    });
}

function drawLimits(canvas, area, chart, { limits, unit }) {
    for (const [name, value] of Object.entries(limits)) {
        const y = chart.toDomYCoord(value);
        if (y < area.y || y > area.y + area.h)
            continue;
        const color = styleValue(name.endsWith('Warning') ? '--warning' : '--critical');
        canvas.strokeStyle = color;
        canvas.setLineDash(name.endsWith('Warning') ? [6, 4] : []);
        canvas.beginPath();
        canvas.moveTo(area.x, y);
        canvas.lineTo(area.x + area.w, y);
        canvas.stroke();
        canvas.fillStyle = color;
        const words = `${limitText(name)} ${quantityText(value, unit)}`;
        canvas.fillText(words, area.x + area.w - canvas.measureText(words).width - margin,
            name.startsWith('low') ? y + 13 : y - margin);
    }
}

/** Draws limits and states; `area` is the plot's rectangle on the canvas. */
export function drawUnderlay(canvas, area, chart, { sensor, runsOfSensors }) {
    canvas.save();
    canvas.font = `12px ${styleValue('--font')}`;
    canvas.lineWidth = 1;
    drawStates(canvas, area, chart, runsOfSensors);
    drawLimits(canvas, area, chart, sensor);
    canvas.restore();
}
