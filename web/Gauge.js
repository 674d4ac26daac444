// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A gauge that shows where a reading stands between its limits.

import { limitText, quantityText, text } from './Texts.js';

const width = 100;
const height = 12;
const markerWidth = 2.5;
const thickness = { normal: 2, warning: 6, critical: 10 }; // shows the zone without its color
const steps = [1, 1.5, 2, 3, 4, 5, 6, 8, 10];

/** Returns the least round number that is not below the value. */
function roundedUp(value) {
    const power = 10 ** Math.floor(Math.log10(value));
    return steps.find((step) => step * power >= value) * power;
}

/** Returns the lower and the upper ends of the gauge's scale; null for a sensor without limits. */
export function scaleOf({ limits, value }) {
    const all = Object.values(limits);
    if (all.length === 0)
        return null;
    const isLow = Object.keys(limits).some((name) => name.startsWith('low'));
    const isHigh = Object.keys(limits).some((name) => name.startsWith('high'));
    const least = Math.min(...all);
    const greatest = Math.max(...all);
    if (isLow && isHigh && greatest > least) {
        const margin = 0.15 * (greatest - least);
        return { low: least - margin, high: greatest + margin };
    }
    const low = Math.min(0, 1.2 * least);
    if (isHigh)
        return { low, high: Math.max(1.15 * greatest, low + 1) };
    return { low, high: roundedUp(Math.max(2 * greatest, 1.1 * (value ?? 0), low + 1)) };
}

/** Returns the zones of the scale in ascending order, each with its end and its kind. */
export function zonesOf(limits, { high }) {
    const criticalLow = limits.lowCritical ?? limits.lowFatal;
    const criticalHigh = limits.highCritical ?? limits.highFatal;
    return [
        { end: criticalLow, kind: 'critical' },
        { end: limits.lowWarning ?? criticalLow, kind: 'warning' },
        { end: limits.highWarning ?? criticalHigh ?? high, kind: 'normal' },
        { end: criticalHigh ?? high, kind: 'warning' },
        { end: high, kind: 'critical' },
    ].filter((zone) => zone.end !== undefined);
}

/** Returns the limits in words: "Low warning 5 °C, high critical 95 °C". */
export function limitsText({ limits, unit }) {
    const parts = Object.entries(limits).map(([name, value]) =>
        `${limitText(name)} ${quantityText(value, unit)}`);
    return parts.length > 0 ? parts.join(', ') : text('noLimits');
}

/** A gauge in an `svg` of the page's template. */
export class Gauge {
    #drawn = '';

    constructor(svg) {
        this.svg = svg;
        this.zones = svg.querySelector('g');
        this.marker = svg.querySelector('.marker');
    }

    update(sensor) {
        const scale = scaleOf(sensor);
        this.svg.classList.toggle('empty', !scale);
        this.#drawZones(sensor, scale);
        this.marker.classList.toggle('empty', sensor.value === null);
        if (!scale || sensor.value === null)
            return;
        const part = (sensor.value - scale.low) / (scale.high - scale.low);
        const x = (width - markerWidth) * Math.min(1, Math.max(0, part));
        this.marker.setAttribute('x', x.toFixed(1));
    }

    #drawZones(sensor, scale) {
        const key = JSON.stringify([sensor.limits, scale]);
        if (key === this.#drawn)
            return;
        this.#drawn = key;
        this.svg.setAttribute('aria-label', limitsText(sensor));
        let begin = 0;
        this.zones.replaceChildren(...(scale ? zonesOf(sensor.limits, scale) : []).map((zone) => {
            const end = width * (zone.end - scale.low) / (scale.high - scale.low);
            const rect = document.createElementNS(this.svg.namespaceURI, 'rect');
            rect.classList.add(zone.kind);
            rect.setAttribute('x', begin);
            rect.setAttribute('y', (height - thickness[zone.kind]) / 2);
            rect.setAttribute('width', Math.max(0, end - begin));
            rect.setAttribute('height', thickness[zone.kind]);
            begin = Math.max(begin, end);
            return rect;
        }));
    }
}
