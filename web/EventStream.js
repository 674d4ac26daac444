// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The server's events, with reconnection.

const retryAfter = 2_000;
const silenceLimit = 40_000; // the server sends something every 15 seconds

/**
 * Receives `/api/events` while the page is visible: a browser has few connections to a server, and
 * hidden pages would use them up. Calls `handler` with the name and the data of each event but the
 * signs of life, and `onState` with the time since which there is no connection, in milliseconds;
 * with null when there is one.
 */
export class EventStream {
    #source = null;
    #timer = 0;
    #lostSince = null;

    constructor(handler, onState) {
        this.handler = handler;
        this.onState = onState;
        document.addEventListener('visibilitychange', () => this.#begin());
        this.#begin();
    }

    #begin() {
        this.#end();
        if (document.visibilityState === 'hidden')
            return;
        this.#source = new EventSource('/api/events');
        for (const name of ['sensors', 'changes', 'alive'])
            this.#source.addEventListener(name, (event) => this.#receive(name, event));
        this.#source.addEventListener('error', () => this.#lose());
        this.#setTimer(() => this.#lose(), silenceLimit);
    }

    #end() {
        clearTimeout(this.#timer);
        this.#source?.close();
        this.#source = null;
    }

    #receive(name, event) {
        this.#setTimer(() => this.#lose(), silenceLimit);
        this.#lostSince = null;
        this.onState(null);
        if (name !== 'alive')
            this.handler(name, JSON.parse(event.data));
    }

    #lose() {
        this.#end();
        this.#lostSince ??= Date.now();
        this.onState(this.#lostSince);
        this.#setTimer(() => this.#begin(), retryAfter);
    }

    #setTimer(callback, delay) {
        clearTimeout(this.#timer);
        this.#timer = setTimeout(callback, delay);
    }
}
