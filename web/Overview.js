// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The counts, the search and the lists of sensors.

import { ChipList } from './ChipList.js';
import { searchFor } from './Selectors.js';
import { isProblem, urgencies } from './States.js';
import { setText, text } from './Texts.js';
import { TroubleList } from './TroubleList.js';

export class Overview {
    #shown = [];
    #opener = null; // of the chart

    /** Calls `onOpen` with the deviceId of a sensor that the user chooses. */
    constructor(machine, sparklines, address, onOpen) {
        this.machine = machine;
        this.address = address;
        this.counts = document.getElementById('counts');
        this.form = document.getElementById('search');
        this.found = document.getElementById('found');
        this.chips = new ChipList(document.querySelector('.chips'), machine, sparklines);
        this.troubles = new TroubleList(document.getElementById('troubles'), machine, sparklines);
        machine.addEventListener('change', ({ detail }) => this.#update(detail.changed));
        this.form.addEventListener('submit', (event) => event.preventDefault());
        this.form.addEventListener('input', () => {
            const { search, problems } = this.form.elements;
            address.setSearch(search.value, problems.checked);
            this.search();
        });
        document.getElementById('overview').addEventListener('click', (event) => {
            const row = event.target.closest('.sensor');
            if (!row)
                return;
            this.#opener = row.querySelector('button');
            onOpen(row.dataset.device);
        });
    }

    /** Replaces the table, which needs no script, by the lists. */
    show() {
        document.getElementById('table').remove();
        document.getElementById('overview').hidden = false;
        this.form.hidden = false;
    }

    /** Shows what the address says. */
    search() {
        const { search, hasProblemsOnly } = this.address;
        const { elements } = this.form;
        if (elements.search.value !== search)
            elements.search.value = search;
        elements.problems.checked = hasProblemsOnly;
        const finds = searchFor(search);
        this.chips.select((sensor) =>
            (!hasProblemsOnly || isProblem(sensor.urgency)) && finds(sensor));
        this.#showFound();
    }

    /** Marks the rows of the sensors that the chart shows. */
    markShown(devices) {
        for (const [list, isShown] of [[this.#shown, false], [devices, true]])
            for (const device of list)
                for (const rows of [this.chips, this.troubles])
                    rows.row(device)?.setShown(isShown);
        this.#shown = devices;
    }

    /** Moves the focus to what opened the chart; where that is gone, to the sensor's row. */
    returnFocus(device) {
        const opener = this.#opener?.isConnected ? this.#opener : this.chips.row(device).button;
        opener.focus();
    }

    #showFound() {
        const { search, hasProblemsOnly } = this.address;
        const isLimited = search !== '' || hasProblemsOnly;
        setText(this.found, isLimited ? text('found', { number: this.chips.visible }) : '');
    }

    #update(changed) {
        const focused = document.activeElement.closest('.sensor')?.dataset.device;
        this.troubles.update(changed);
        this.chips.update(changed);
        if (focused && !document.activeElement.closest('.sensor'))
            this.chips.row(focused).button.focus(); // its row among the troubles was removed
        this.markShown(this.#shown);
        this.#showFound();
        this.#count();
    }

    #count() {
        const numbers = Object.fromEntries(urgencies.map((urgency) => [urgency, 0]));
        for (const sensor of this.machine.sensors.values())
            ++numbers[sensor.urgency];
        for (const item of this.counts.children) {
            const number = String(numbers[item.dataset.urgency]);
            if (item.dataset.number === number)
                continue;
            item.dataset.number = number;
            item.querySelector('b').textContent = number;
        }
        const problems = this.machine.troubles().length;
        const name = document.querySelector('h1').textContent;
        document.title = problems > 0 ? `(${problems}) ${name}` : name;
    }
}
