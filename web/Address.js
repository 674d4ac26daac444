// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What the page shows, as a part of its address, so that it can be sent.

/**
 * The query has `search`, `problems`, `span` and a `device` for each sensor in the chart.
 * Dispatches `change` when the user goes back or forward.
 */
export class Address extends EventTarget {
    constructor() {
        super();
        this.#read();
        addEventListener('popstate', () => {
            this.#read();
            this.dispatchEvent(new Event('change'));
        });
    }

    /** Sets what the search shows; the browser's history keeps the last search only. */
    setSearch(search, hasProblemsOnly) {
        this.search = search;
        this.hasProblemsOnly = hasProblemsOnly;
        history.replaceState(null, '', this.#text());
    }

    /** Sets what the chart shows, so that going back shows what it did before. */
    setChart(devices, span) {
        this.devices = devices;
        this.span = span;
        if (this.#text() !== location.pathname + location.search)
            history.pushState(null, '', this.#text());
    }

    #read() {
        const query = new URLSearchParams(location.search);
        this.search = query.get('search') ?? '';
        this.hasProblemsOnly = query.has('problems');
        this.devices = [...new Set(query.getAll('device'))];
        this.span = query.get('span') === 'day' ? 'day' : 'hour';
    }

    #text() {
        const query = new URLSearchParams();
        if (this.search)
            query.set('search', this.search);
        if (this.hasProblemsOnly)
            query.set('problems', '1');
        if (this.devices.length > 0)
            query.set('span', this.span);
        for (const device of this.devices)
            query.append('device', device);
        const text = query.toString();
        return location.pathname + (text ? `?${text}` : '');
    }
}
