// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The panel with the chart and its buttons. What it shows is in the address.

import { Chart, loadDygraphs, mostSensors } from './Chart.js';
import { loadHistory } from './ChartData.js';
import { ChartLegend } from './ChartLegend.js';
import { fillStateChanges, summaryText } from './ChartWords.js';
import { compareSensors } from './Machine.js';
import { nameOf } from './SensorRow.js';
import { isolated, setText, text } from './Texts.js';

const zooms = { in: [0.25, 0.75], out: [-0.5, 1.5], earlier: [-0.5, 0.5], later: [0.5, 1.5] };
const refreshAfter = { hour: 10_000, day: 60_000 };

export class ChartPanel {
    devices = []; // that are shown
    #timer = 0;

    /** Calls `onChange` when the user changed the address by the panel. */
    constructor(machine, address, onChange) {
        this.machine = machine;
        this.address = address;
        this.onChange = onChange;
        this.panel = document.getElementById('chart');
        this.title = document.getElementById('chart-title');
        this.comparison = document.getElementById('compare');
        this.legend = new ChartLegend(machine, (device) => {
            this.#set(this.devices.filter((other) => other !== device));
            this.focus(); // the button that was pressed is gone
        });
        this.chart = new Chart(document.getElementById('plot'), (row) => this.legend.showRow(row));
        this.panel.addEventListener('click', ({ target }) => this.#click(target));
        this.panel.addEventListener('keydown', ({ key }) => {
            if (key === 'Escape')
                this.#set([]);
        });
        matchMedia('(prefers-color-scheme: dark)').addEventListener('change', () => {
            this.legend.show(this.#sensors());
            this.chart.redraw();
        });
        this.narrow = matchMedia('(max-width: 40rem)');
        this.narrow.addEventListener('change', () => this.#coverPage());
    }

    /**
     * Shows the sensors in the address that the machine has, or had, and of them those of one unit.
     * Says which it does not show.
     */
    show() {
        const { address, machine } = this;
        const known = address.devices.filter((device) => machine.sensors.has(device));
        const { unit } = machine.sensors.get(known[0]) ?? {};
        this.devices = known.filter((device) => machine.sensors.get(device).unit === unit)
            .slice(0, mostSensors);
        this.#nameOthers(known);
        this.panel.hidden = this.devices.length === 0;
        this.#coverPage();
        clearTimeout(this.#timer);
        if (this.panel.hidden) {
            this.chart.remove();
            return;
        }
        const sensors = this.#sensors();
        this.title.firstElementChild.textContent = nameOf(sensors[0]);
        for (const button of this.panel.querySelectorAll('[data-span]'))
            button.setAttribute('aria-pressed', button.dataset.span === address.span);
        this.legend.show(sensors);
        this.#offerComparison(sensors[0]);
        this.#draw();
    }

    focus() {
        this.title.focus();
    }

    /** Says which sensors in the address are not shown, and why; `known` are the machine's. */
    #nameOthers(known) {
        const missing = this.address.devices.filter((device) => !known.includes(device));
        const others = known.filter((device) => !this.devices.includes(device))
            .map((device) => nameOf(this.machine.sensors.get(device)));
        const sentence = (name, names) => names.length === 0 ? ''
            : text(name, { names: names.map(isolated).join(', '), number: mostSensors });
        const sentences = [sentence('missing', missing), sentence('notCompared', others)];
        setText(document.getElementById('missing'), sentences.join(' ').trim());
    }

    /** Takes the page out of the order of the keyboard where the panel covers it. */
    #coverPage() {
        for (const element of document.querySelectorAll('.skip, .machine, main'))
            element.inert = this.narrow.matches && !this.panel.hidden;
    }

    #sensors() {
        return this.devices.map((device) => this.machine.sensors.get(device));
    }

    #set(devices, span = this.address.span) {
        this.address.setChart(devices, span);
        this.onChange();
    }

    #click(target) {
        const { span, zoom } = target.dataset;
        if (span)
            this.#set(this.devices, span);
        else if (zoom === 'all')
            this.chart.showAll();
        else if (zoom)
            this.chart.zoom(...zooms[zoom]);
        else if (target.id === 'compare-add' && this.comparison.value)
            this.#set([...this.devices, this.comparison.value]);
        else if (target.id === 'chart-close')
            this.#set([]);
    }

    /** Offers the other sensors of the same unit. */
    #offerComparison({ unit }) {
        const others = [...this.machine.sensors.values()].filter((other) =>
            other.unit === unit && !this.devices.includes(other.deviceId)).sort(compareSensors);
        this.comparison.disabled = others.length === 0 || this.devices.length === mostSensors;
        this.comparison.replaceChildren(new Option(text('choose'), ''), ...others.map((other) =>
            new Option(`${isolated(nameOf(other))} (${isolated(other.chip)})`, other.deviceId)));
    }

    /** Draws the history that the server has now, and again when there is more of it. */
    async #draw() {
        const { devices, address: { span } } = this;
        let words = null;
        const [history] = await Promise.all([loadHistory(devices, span), loadDygraphs()])
            .catch(() => [null, words = text('historyFailed')]); // what is drawn stays
        if (devices !== this.devices || span !== this.address.span)
            return;
        const sensors = this.#sensors();
        if (!words)
            this.panel.classList.toggle('empty', !history);
        words ??= history ? summaryText(history, sensors) : text('noHistory');
        setText(document.getElementById('plot-summary'), words);
        if (history) {
            this.chart.show(history, sensors);
            this.legend.setHistory(history);
            fillStateChanges(document.getElementById('state-changes'), history, sensors);
        }
        this.#timer = setTimeout(() => this.#draw(), refreshAfter[span]);
    }
}
