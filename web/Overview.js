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
        machine.addEventListener('change', ({ detail }) =>
            this.#update(detail.changed, detail.forgotten));
        document.addEventListener('visibilitychange', () => this.#setTitle());
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
        this.troubles.select(finds);
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
        focusFirst(this.#opener, this.chips.row(device)?.button);
    }

    #showFound() {
        const { search, hasProblemsOnly } = this.address;
        const isLimited = search !== '' || hasProblemsOnly;
        setText(this.found, isLimited ? text('found', { number: this.chips.visible }) : '');
    }

    #update(changed, forgotten) {
        const focused = document.activeElement;
        const device = focused.closest('.sensor')?.dataset.device;
        this.troubles.update(changed, forgotten);
        this.chips.update(changed, forgotten);
        if (device && (document.activeElement !== focused || !focused.checkVisibility()))
            focusFirst(focused, this.chips.row(device)?.button); // its row was moved or removed
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
        this.#setTitle();
    }

    /** Shows the number of troubles in the title while it is kept up to date. */
    #setTitle() {
        const number = document.visibilityState === 'hidden' ? 0 : this.machine.troubles().length;
        const name = document.querySelector('h1').textContent;
        document.title = number > 0 ? `(${number}) ${name}` : name;
    }
}

/** Moves the focus to the first of the elements that can be seen; for none, to the content. */
function focusFirst(...elements) {
    const found = elements.find((element) => element?.isConnected && element.checkVisibility());
    (found ?? document.getElementById('content')).focus();
}
