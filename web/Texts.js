// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Texts, numbers and times in the language of the page, which the server has chosen.

const language = document.documentElement.lang;
const locale = navigator.languages.find((each) => each.startsWith(language)) ?? language;
let dictionary = {};

/** Loads the texts of the page's language. The other functions need them. */
export async function loadTexts() {
    const response = await fetch(`/web/languages/${language}.json`);
    dictionary = await response.json();
}

/** Returns the text of that name, with the values in place of their names in braces. */
export function text(name, values = {}) {
    return dictionary[name].replace(/\{(\w+)\}/g, (place, value) => values[value] ?? place);
}

/** Returns the words for a state of `/api/sensors`, and for a member of its `limits`. */
export const stateText = (state) => dictionary.states[state] ?? state;
export const limitText = (limit) => dictionary.limitNames[limit];

/** Sets an element's text only when it differs, since setting it costs a layout. */
export function setText(element, words) {
    if (element.textContent !== words)
        element.textContent = words;
}

const directionMarks = /[\u061c\u200e\u200f\u202a-\u202e\u2066-\u2069]/g;

/**
 * Returns data for a place within a text whose direction it does not change: isolated and without
 * the marks that would end the isolation.
 */
export const isolated = (data) => `\u2068${data.replace(directionMarks, '')}\u2069`;

const decimals = { '°C': 1, 'V': 2, 'RPM': 0 };
const formats = new Map();

/**
 * Returns a reading and its unit, with as many decimals as people compare readings of that unit by;
 * a dash for no reading.
 */
export function readingText(value, unit) {
    if (value === null)
        return '–';
    const digits = Math.abs(value) < 1 && unit === 'V' ? 3 : (decimals[unit] ?? 2);
    if (!formats.has(digits))
        formats.set(digits, new Intl.NumberFormat(locale,
            { minimumFractionDigits: digits, maximumFractionDigits: digits, useGrouping: 'min2' }));
    return formats.get(digits).format(value) + (unit ? `\u00a0${unit}` : '');
}

const exact = new Intl.NumberFormat(locale, { maximumFractionDigits: 6, useGrouping: 'min2' });

/** Returns a number in full, with its unit where it has one. */
export function quantityText(value, unit) {
    return exact.format(value) + (unit ? `\u00a0${unit}` : '');
}

const timeOfDay = new Intl.DateTimeFormat(locale, { timeStyle: 'short' });
const dayAndTime = new Intl.DateTimeFormat(locale, { dateStyle: 'short', timeStyle: 'short' });
const day = new Intl.DateTimeFormat(locale, { dateStyle: 'short' });
const exactTime = new Intl.DateTimeFormat(locale, { timeStyle: 'medium' });

/** Returns a time of Unix in the browser's zone: with the date unless it is of today. */
export function timeText(seconds) {
    const time = new Date(seconds * 1000);
    const isToday = time.toDateString() === new Date().toDateString();
    return (isToday ? timeOfDay : dayAndTime).format(time);
}

/** Returns a time in a span: of the hour with seconds, of the day with the date. */
export const momentText = (seconds, span) =>
    (span === 'hour' ? exactTime : dayAndTime).format(seconds * 1000);

/** Returns the present time with the date. */
export const nowText = () => dayAndTime.format(new Date());

/** Returns the label of a time axis that shows that many seconds: at midnight, the date. */
export function axisTimeText(seconds, length) {
    const time = new Date(seconds * 1000);
    const isMidnight = time.getHours() + time.getMinutes() + time.getSeconds() === 0;
    return (isMidnight ? day : length < 600 ? exactTime : timeOfDay).format(time);
}
