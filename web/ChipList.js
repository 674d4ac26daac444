// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// All sensors, grouped by chip.

import { compareSensors } from './Machine.js';
import { SensorRow } from './SensorRow.js';

const template = document.getElementById('chip-template').content.firstElementChild;

export class ChipList {
    #chips = new Map(); // by name: the element, its list and the number of visible rows
    #rows = new Map(); // by deviceId
    #added = 0; // number of chips until now
    #selects = () => true;

    constructor(container, machine, sparklines) {
        this.container = container;
        this.machine = machine;
        this.sparklines = sparklines;
    }

    /**
     * Updates the rows of these sensors, adds the new ones at their place, and removes those of
     * forgotten ones.
     */
    update(sensors, forgotten) {
        for (const deviceId of forgotten)
            this.#remove(deviceId);
        const added = sensors.filter((sensor) => !this.#rows.has(sensor.deviceId));
        const changedChips = new Set(added.map((sensor) => sensor.chip));
        for (const sensor of sensors)
            this.#rows.get(sensor.deviceId)?.update(sensor);
        for (const sensor of added.sort(compareSensors))
            this.#add(sensor);
        for (const sensor of sensors)
            if (this.#show(sensor))
                changedChips.add(sensor.chip);
        this.#count(changedChips);
    }

    /** Shows only the sensors for which the function returns true. */
    select(selects) {
        this.#selects = selects;
        for (const sensor of this.machine.sensors.values())
            this.#show(sensor);
        this.#count(this.#chips.keys());
    }

    /** Returns the number of sensors that are shown. */
    get visible() {
        return [...this.#chips.values()].reduce((sum, { visible }) => sum + visible, 0);
    }

    row(deviceId) {
        return this.#rows.get(deviceId);
    }

    /** Returns whether the row of the sensor was shown or hidden. */
    #show(sensor) {
        const { element } = this.#rows.get(sensor.deviceId);
        const isHidden = !this.#selects(sensor);
        const isChanged = element.hidden !== isHidden;
        element.hidden = isHidden;
        return isChanged;
    }

    #count(names) {
        for (const name of names) {
            const chip = this.#chips.get(name);
            chip.visible = chip.list.querySelectorAll(':scope > :not([hidden])').length;
            chip.element.hidden = chip.visible === 0;
            chip.element.style.setProperty('--rows', chip.visible);
        }
    }

    #add(sensor) {
        const row = new SensorRow(sensor);
        const list = this.#chip(sensor).list;
        this.#rows.set(sensor.deviceId, row);
        insertSorted(list, row.element, (other) =>
            compareSensors(this.machine.sensors.get(other.dataset.device), sensor));
        this.sparklines.observe(row.element);
    }

    #remove(deviceId) {
        const { element } = this.#rows.get(deviceId);
        this.#rows.delete(deviceId);
        this.sparklines.forget(element);
        const chip = element.closest('.chip');
        const name = chip.querySelector('.chip-title').textContent;
        element.remove();
        if (chip.querySelector('.sensor')) {
            this.#count([name]);
        } else {
            chip.remove();
            this.#chips.delete(name);
        }
    }

    #chip(sensor) {
        const known = this.#chips.get(sensor.chip);
        if (known)
            return known;
        const element = template.cloneNode(true);
        const title = element.querySelector('.chip-title');
        title.textContent = sensor.chip;
        title.id = `chip-${++this.#added}`;
        element.setAttribute('aria-labelledby', title.id);
        element.querySelector('.device').textContent = sensor.device ?? '';
        const chip = { element, list: element.querySelector('ul'), first: sensor, visible: 0 };
        this.#chips.set(sensor.chip, chip);
        insertSorted(this.container, element, (other) => compareSensors(
            this.#chips.get(other.querySelector('.chip-title').textContent).first, sensor));
        return chip;
    }
}

/** Inserts the element before those that `compare` returns a positive number for. */
function insertSorted(parent, element, compare) {
    let next = null;
    for (let other = parent.lastElementChild; other && compare(other) > 0;
        other = other.previousElementSibling)
        next = other;
    parent.insertBefore(element, next);
}
