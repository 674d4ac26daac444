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
import { isolated, loadTexts, nowText, setText, text, timeText } from './Texts.js';

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

/** Names the sources that cannot be read: their sensors may be gone, or have never been there. */
function showLostSources(names) {
    setText(document.getElementById('lost-sources'), names.length === 0 ? ''
        : text('lostSources', { names: names.map(isolated).join(', ') }));
}

function showConnection(state, lastContact) {
    hourHistory.isLive = state === 'live';
    const time = lastContact && timeText(lastContact / 1000);
    const words = { live: () => text('live'), lost: () => text('connectionLost', { time }),
        connecting: () => time ? text('connecting', { time }) : '' };
    setText(document.getElementById('connection'), words[state]());
    if (document.body.dataset.connection !== state)
        document.body.dataset.connection = state;
}

addEventListener('beforeprint', () => {
    setText(document.getElementById('printed'), nowText());
});

let isShown = false;

function showOverview() {
    isShown = true;
    overview.show();
    overview.search();
    showChart();
    new Announcer(machine);
}

function receive(name, data) {
    if (name === 'changes' || name === 'alive')
        machine.setTime(data.time);
    if (name === 'changes')
        machine.apply(data);
    if (name === 'sources')
        showLostSources(data.lost);
    if (name !== 'sensors')
        return;
    machine.replace(data);
    if (!isShown)
        showOverview();
    hourHistory.load().then(() => sparklines.drawVisible(), () => {}); // it tries again
}

machine.addEventListener('change', ({ detail: { before, forgotten } }) => {
    const areOthers = before.includes(undefined) || forgotten.length > 0;
    if (isShown && address.devices.length > 0 && areOthers)
        showChart();
});
address.addEventListener('change', () => {
    overview.search();
    showChart();
});
new EventStream(receive, showConnection);
