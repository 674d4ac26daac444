// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What lies below the lines of the chart: the limits of the first sensor, and the states of all.

import { limitText, quantityText, stateText } from './Texts.js';
import { nameOf } from './SensorRow.js';
import { shapes, urgencyOf } from './States.js';

const stripHeight = 17;
const margin = 4;
const shapeSize = 12;

/** Returns a color or font of the style sheet by the name of its variable. */
export const styleValue = (name) =>
    getComputedStyle(document.documentElement).getPropertyValue(name).trim();

/** Draws the shape of an urgency, also where a state is too short for its word. */
function drawShape(canvas, urgency, left, top) {
    canvas.save();
    canvas.translate(left, top);
    canvas.scale(shapeSize / 16, shapeSize / 16);
    canvas.fill(new Path2D(shapes[urgency]), 'evenodd');
    canvas.restore();
}

/**
 * Fills the plot behind one sensor's states. Each of several sensors has a strip at the bottom,
 * with its name.
 */
function drawStates(canvas, area, chart, sensors, runsOfSensors) {
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
            canvas.fillStyle = styleValue(`--${urgency}-band`);
            const bottom = area.y + area.h - stripHeight * (runsOfSensors.length - index - 1);
            const height = isStrip ? stripHeight - 1 : area.h;
            canvas.fillRect(left, bottom - height, right - left, height);
            const longWords = `${nameOf(sensors[index])}: ${stateText(state)}`;
            const wordsLeft = left + shapeSize + margin;
            const words = (isStrip ? [longWords, stateText(state)] : [stateText(state)]).find(
                (each) => canvas.measureText(each).width + margin < right - wordsLeft);
            canvas.fillStyle = styleValue(`--${urgency}`);
            drawShape(canvas, urgency, left + 1, bottom - shapeSize - margin / 2);
            if (words)
                canvas.fillText(words, wordsLeft, bottom - margin);
        }
    });
}

function drawLimits(canvas, area, chart, { limits, unit }, prefix) {
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
        const words = `${prefix}${limitText(name)} ${quantityText(value, unit)}`;
        canvas.fillText(words, area.x + area.w - canvas.measureText(words).width - margin,
            name.startsWith('low') ? y + 13 : y - margin);
    }
}

/** Draws limits and states; `area` is the plot's rectangle on the canvas. */
export function drawUnderlay(canvas, area, chart, { sensors, runsOfSensors }) {
    canvas.save();
    canvas.font = `12px ${styleValue('--font')}`;
    canvas.lineWidth = 1;
    drawStates(canvas, area, chart, sensors, runsOfSensors);
    drawLimits(canvas, area, chart, sensors[0],
        sensors.length > 1 ? `${nameOf(sensors[0])}: ` : '');
    canvas.restore();
}
