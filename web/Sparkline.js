// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The readings of the last hour as a line, and when lines are drawn.

const width = 60;
const height = 16;
const margin = 1.5;
const leastSpan = 0.02; // of the reading: a line that hardly moves looks flat

/** Returns the path of an SVG for readings at equal distances; null is a gap. */
export function sparklinePath(values) {
    const present = values.filter((value) => value !== null);
    if (present.length === 0)
        return '';
    const least = present.reduce((one, other) => Math.min(one, other));
    const greatest = present.reduce((one, other) => Math.max(one, other));
    const middle = (least + greatest) / 2;
    const span = Math.max(greatest - least, leastSpan * Math.abs(middle), 1e-6);
    let path = '';
    let isDrawing = false;
    values.forEach((value, i) => {
        if (value !== null) {
            const x = width * i / Math.max(values.length - 1, 1);
            const y = height / 2 - (height - 2 * margin) * (value - middle) / span;
            path += `${isDrawing ? 'L' : 'M'}${x.toFixed(1)} ${y.toFixed(1)}`;
            if (!isDrawing && (values[i + 1] ?? null) === null)
                path += 'h.1'; // a single point
        }
        isDrawing = value !== null;
    });
    return path;
}

const redrawInterval = 10_000;

/** Draws the sparklines of rows that can be seen, at once and every ten seconds; on paper, all. */
export class Sparklines {
    #all = new Set();
    #visible = new Set();

    /** `valuesOf` returns the readings for a deviceId. */
    constructor(valuesOf) {
        this.valuesOf = valuesOf;
        this.observer = new IntersectionObserver((entries) => {
            for (const { target, isIntersecting } of entries) {
                if (isIntersecting) {
                    this.#visible.add(target);
                    this.#draw(target);
                } else {
                    this.#visible.delete(target);
                }
            }
        });
        setInterval(() => this.drawVisible(), redrawInterval);
        addEventListener('beforeprint', () => this.#drawOn(this.#all));
    }

    observe(row) {
        this.#all.add(row);
        this.observer.observe(row);
    }

    forget(row) {
        this.observer.unobserve(row);
        this.#all.delete(row);
        this.#visible.delete(row);
    }

    drawVisible() {
        this.#drawOn(this.#visible);
    }

    #drawOn(rows) {
        for (const row of rows)
            this.#draw(row);
    }

    #draw(row) {
        const path = sparklinePath(this.valuesOf(row.dataset.device));
        row.querySelector('.sparkline path').setAttribute('d', path);
    }
}
