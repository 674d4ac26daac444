// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Makes the server's table live.

import { Address } from './Address.js';
import { Announcer } from './Announcer.js';
import { ChartPanel } from './ChartPanel.js';
import { EventStream } from './EventStream.js';
import { HourHistory } from './HourHistory.js';
import { Machine } from './Machine.js';
import { Overview } from './Overview.js';
import { Sparklines } from './Sparkline.js';
import { loadTexts, setText, text, timeText } from './Texts.js';

const texts = loadTexts();
const address = new Address();
const machine = new Machine();
const hourHistory = new HourHistory(machine);
const sparklines = new Sparklines((deviceId) => hourHistory.valuesOf(deviceId));
await texts;

const panel = new ChartPanel(machine, address, () => showChart());
const overview = new Overview(machine, sparklines, address, (deviceId) => {
    address.setChart([deviceId], address.span);
    showChart();
    panel.focus();
});

function showChart() {
    const [last] = panel.devices;
    overview.markShown(address.devices);
    panel.show();
    if (address.devices.length === 0 && last)
        overview.returnFocus(last);
}

function showConnection(lostSince) {
    const words = lostSince === null ? text('live')
        : text('connectionLost', { time: timeText(lostSince / 1000) });
    setText(document.getElementById('connection'), words);
    document.body.classList.toggle('offline', lostSince !== null);
}

let isShown = false;

function showOverview() {
    isShown = true;
    overview.show();
    overview.search();
    showChart();
    new Announcer(machine);
}

function receive(name, data) {
    if (name === 'changes') {
        machine.apply(data);
        return;
    }
    machine.replace(data);
    if (!isShown)
        showOverview();
    hourHistory.load().then(() => sparklines.drawVisible(), () => {}); // the next list tries again
}

address.addEventListener('change', () => {
    overview.search();
    showChart();
});
new EventStream(receive, showConnection);
