// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Sensors by what users type into the search.

/** Returns the names by which `sensorctl` selects the sensor. */
export function namesOf(sensor) {
    const label = sensor.label ?? '';
    const path = sensor.deviceId.slice(label.length + 1);
    const feature = path.slice(path.lastIndexOf('/') + 1);
    return [sensor.chip, label, feature, path, sensor.deviceId, `${sensor.chip}/${label}`,
        `${sensor.chip}/${feature}`];
}

/** Returns text without the case of its ASCII letters, which are all that `sensorctl` folds. */
const folded = (text) => text.replace(/[A-Z]+/g, (letters) => letters.toLowerCase());

/** Returns the regular expression for a set that begins at `[`, and its end; null for no set. */
function setAt(pattern, begin) {
    const end = pattern.indexOf(']', begin + (/^\[[!^]/.test(pattern.slice(begin)) ? 3 : 2));
    if (end < 0)
        return null;
    const members = pattern.slice(begin + 1, end).replace(/^[!^]/, '');
    const isNegated = members.length < end - begin - 1;
    return { expression: `[${isNegated ? '^' : ''}${members.replace(/[\\\]^[&]/g, '\\$&')}]`, end };
}

/** Returns the regular expression that matches what fnmatch(3) does without any of its options. */
export function expressionOf(pattern) {
    const text = folded(pattern);
    let expression = '';
    for (let i = 0; i < text.length; ++i) {
        const set = text[i] === '[' ? setAt(text, i) : null;
        if (set) {
            expression += set.expression;
            i = set.end;
        } else if (text[i] === '*') {
            expression += '.*';
        } else if (text[i] === '?') {
            expression += '.';
        } else {
            const character = String.fromCodePoint(text.codePointAt(i));
            expression += character.replace(/[\\^$.*+?()[\]{}|/]/, '\\$&');
            i += character.length - 1;
        }
    }
    try {
        return new RegExp(`^${expression}$`, 'su');
    } catch {
        return /^\b$/; // a range such as [z-a], which matches nothing
    }
}

/** Returns the words of a text: what blanks separate, and what quotation marks hold together. */
function wordsOf(text) {
    return [...text.matchAll(/"([^"]*)"?|\S+/g)].map((match) => match[1] ?? match[0]);
}

/**
 * Returns a function that says whether a sensor is searched for: when `sensorctl` selects it by
 * one of the words, or when its names have all of the words as parts. Words such as `kind:fan`
 * limit the sensors to those kinds.
 */
export function searchFor(text) {
    const all = wordsOf(folded(text));
    const kinds = all.filter((word) => word.startsWith('kind:')).map((word) => word.slice(5));
    const words = all.filter((word) => !word.startsWith('kind:'));
    const expressions = words.map(expressionOf);
    return (sensor) => {
        if (kinds.length > 0 && !kinds.includes(sensor.kind))
            return false;
        const names = namesOf(sensor).map(folded);
        return words.length === 0 ||
            expressions.some((expression) => names.some((name) => expression.test(name))) ||
            words.every((word) => names.some((name) => name.includes(word)));
    };
}
