// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The server's events, with reconnection.

const retryAfter = 2_000;
const retrySpread = 1_000; // so that not all pages come back at the same time
const silenceLimit = 40_000; // the server sends something every 15 seconds

/**
 * Receives `/api/events` while the page is visible: a browser has few connections to a server, and
 * hidden pages would use them up. Calls `handler` with the name and the data of each event, and
 * `onState` with one of `live`, `connecting` and `lost`, and the time of the last contact in
 * milliseconds; null for none.
 */
export class EventStream {
    #source = null;
    #timer = 0;
    #lastContact = null;

    constructor(handler, onState) {
        this.handler = handler;
        this.onState = onState;
        document.addEventListener('visibilitychange', () => this.#begin('connecting'));
        this.#begin('connecting');
    }

    #begin(state) {
        this.#end();
        this.onState(state, this.#lastContact);
        if (document.visibilityState === 'hidden')
            return;
        this.#source = new EventSource('/api/events');
        for (const name of ['sensors', 'sources', 'changes', 'alive'])
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
        this.#lastContact = Date.now();
        this.onState('live', this.#lastContact);
        this.handler(name, JSON.parse(event.data));
    }

    #lose() {
        this.#end();
        this.#lastContact ??= Date.now();
        this.onState('lost', this.#lastContact);
        this.#setTimer(() => this.#begin('lost'), retryAfter + retrySpread * Math.random());
    }

    #setTimer(callback, delay) {
        clearTimeout(this.#timer);
        this.#timer = setTimeout(callback, delay);
    }
}
