// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The sensors that a person should look at, the most urgent first.

import { compareSensors } from './Machine.js';
import { SensorRow } from './SensorRow.js';
import { isProblem, urgencies } from './States.js';

const compareTroubles = (first, second) =>
    urgencies.indexOf(first.urgency) - urgencies.indexOf(second.urgency) ||
    compareSensors(first, second);

export class TroubleList {
    #rows = new Map(); // by deviceId
    #selects = () => true;

    constructor(section, machine, sparklines) {
        this.section = section;
        this.list = section.querySelector('ul');
        this.machine = machine;
        this.sparklines = sparklines;
        section.hidden = true;
    }

    /** Shows only the sensors for which the function returns true. */
    select(selects) {
        this.#selects = selects;
        for (const deviceId of this.#rows.keys())
            this.#show(deviceId);
        this.#showSection();
    }

    /** Updates the rows of these sensors; adds, removes and moves rows as their urgency changes. */
    update(sensors, forgotten) {
        let isReordered = forgotten.length > 0;
        for (const deviceId of forgotten)
            this.#remove(deviceId);
        for (const sensor of sensors) {
            const row = this.#rows.get(sensor.deviceId);
            isReordered ||= (row?.urgency ?? 'normal') !== sensor.urgency;
            if (!isProblem(sensor.urgency))
                this.#remove(sensor.deviceId);
            else if (row)
                row.update(sensor);
            else
                this.#add(sensor);
        }
        if (isReordered)
            this.#order();
    }

    row(deviceId) {
        return this.#rows.get(deviceId);
    }

    #add(sensor) {
        const row = new SensorRow(sensor);
        this.#rows.set(sensor.deviceId, row);
        this.list.append(row.element);
        this.sparklines.observe(row.element);
        this.#show(sensor.deviceId);
    }

    #show(deviceId) {
        const { element } = this.#rows.get(deviceId);
        element.hidden = !this.#selects(this.machine.sensors.get(deviceId));
    }

    #showSection() {
        this.section.hidden = !this.list.querySelector(':scope > :not([hidden])');
    }

    #remove(deviceId) {
        const row = this.#rows.get(deviceId);
        if (!row)
            return;
        this.sparklines.forget(row.element);
        row.element.remove();
        this.#rows.delete(deviceId);
    }

    /** Moves rows to the order of their urgency. */
    #order() {
        let place = this.list.firstElementChild;
        for (const { deviceId } of this.machine.troubles().sort(compareTroubles)) {
            const { element } = this.#rows.get(deviceId);
            if (element === place)
                place = place.nextElementSibling;
            else
                this.list.insertBefore(element, place);
        }
        this.#showSection();
    }
}
