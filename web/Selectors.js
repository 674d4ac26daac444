// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Sensors by what users type into the search.

/**
 * Returns text without letter case, which no comparison regards. Like the terminal, it has no other
 * letter for a capital sigma at the end of a word.
 */
const folded = (text) => text.replaceAll('Σ', 'σ').toLowerCase();

const address = new RegExp('(-(?:i2c|isa|pci|spi|virtual|acpi|hid|mdio|scsi)(?:-[0-9*?]*)?-)' +
    '(?:0[xX])?0*([0-9a-fA-F]+)$');

/**
 * Returns the name of a chip with its address as libsensors compares it, without leading zeros. A
 * name that does not end with a bus of libsensors and an address stays as it is.
 */
const withPlainAddress = (chip) => chip.replace(address, '$1$2');

/**
 * Returns the names by which `sensorctl` selects the sensor, in lower case. The first is that of
 * the chip with its plain address.
 */
export function namesOf({ chip, label, deviceId }) {
    const name = label ?? '';
    // The identifier has the description, of which the label lacks the blanks at the end.
    const afterLabel = deviceId.startsWith(name) ? deviceId.slice(name.length) : '';
    const isNamed = /^[ \t]*:/.test(afterLabel);
    const path = isNamed ? afterLabel.slice(afterLabel.indexOf(':') + 1) : deviceId;
    const rest = path.replace(/^(\/hwmon)?\//, '');
    const feature = rest.startsWith(`${chip}/`) ? rest.slice(chip.length + 1) : rest;
    return [withPlainAddress(chip), chip, name, feature, path, deviceId, `${chip}/${name}`,
        `${chip}/${feature}`].map(folded);
}

/** The character classes of POSIX, for characters in lower case. */
const classes = {
    alnum: /[a-z0-9]/, alpha: /[a-z]/, blank: /[ \t]/, cntrl: /[\0-\x1f\x7f]/, digit: /[0-9]/,
    graph: /[!-~]/, lower: /[a-z]/, print: /[ -~]/, punct: /[!-/:-@[-`{-~]/, space: /\s/,
    upper: /[a-z]/, xdigit: /[0-9a-f]/,
};

/** Returns the test of the set of characters that begins at `[`, and its end; null for no set. */
function setAt(pattern, begin) {
    const isNegated = pattern[begin + 1] === '!' || pattern[begin + 1] === '^';
    const first = begin + (isNegated ? 2 : 1);
    const tests = [];
    let i = first;
    while (i < pattern.length && (pattern[i] !== ']' || i === first)) {
        const named = /^\[:([a-z]+):\]/.exec(pattern.slice(i, i + 10).join(''));
        const [low, dash, high] = pattern.slice(i, i + 3);
        if (named) {
            tests.push((character) => classes[named[1]]?.test(character) ?? false);
            i += named[0].length;
        } else if (dash === '-' && high !== undefined && high !== ']') {
            tests.push((character) => low <= character && character <= high);
            i += 3;
        } else {
            tests.push((character) => character === low);
            ++i;
        }
    }
    const test = (character) => tests.some((each) => each(character)) !== isNegated;
    return i < pattern.length ? { test, end: i } : null;
}

const star = null;

/** Returns a test for each character that the pattern matches, and `star`. */
function elementsOf(text) {
    const pattern = [...text];
    const elements = [];
    for (let i = 0; i < pattern.length; ++i) {
        const expected = pattern[i];
        const set = expected === '[' ? setAt(pattern, i) : null;
        if (set) {
            elements.push(set.test);
            i = set.end;
        } else if (expected === '*') {
            elements.push(star);
        } else if (expected === '?') {
            elements.push(() => true);
        } else {
            elements.push((character) => character === expected);
        }
    }
    return elements;
}

/**
 * Returns a function that says whether a name in lower case matches, as fnmatch(3) does with
 * FNM_CASEFOLD and FNM_NOESCAPE. It goes back to the last `*` only, so that no pattern takes long.
 */
export function matcherOf(pattern) {
    const elements = elementsOf(folded(pattern));
    return (name) => {
        const characters = [...name];
        let element = 0;
        let begin = -1; // of the elements after the last star
        let next = 0; // the character from which they are tried again
        for (let i = 0; i < characters.length;) {
            if (elements[element] === star && element < elements.length) {
                begin = ++element;
                next = i;
            } else if (elements[element]?.(characters[i])) {
                ++element;
                ++i;
            } else if (begin >= 0) {
                element = begin;
                i = ++next;
            } else {
                return false;
            }
        }
        return elements.slice(element).every((each) => each === star);
    };
}

/** Returns a function that says whether a name in lower case is the selector or matches it. */
function testOf(selector) {
    const matches = /[*?[]/.test(selector) ? matcherOf(selector) : () => false;
    return (name) => name === selector || matches(name);
}

/** Returns a function that says whether `sensorctl` selects a sensor with these names. */
export function selectorOf(text) {
    const selector = folded(text);
    const isName = testOf(selector);
    const isPlainChip = testOf(withPlainAddress(selector));
    return ([plainChip, ...names]) => isPlainChip(plainChip) || names.some(isName);
}

/** Returns the words of a text: what blanks separate, and what quotation marks hold together. */
function wordsOf(text) {
    return [...text.matchAll(/"([^"]*)"?|\S+/g)].map((match) => match[1] ?? match[0]);
}

/**
 * Returns a function that says whether a sensor is searched for: when `sensorctl` selects it by
 * one of the words, or when each word is a part of one of its names. Words such as `kind:fan`
 * limit the sensors to those kinds.
 */
export function searchFor(text) {
    const all = wordsOf(folded(text));
    const kinds = all.filter((word) => word.startsWith('kind:')).map((word) => word.slice(5));
    const words = all.filter((word) => !word.startsWith('kind:'));
    const selectors = words.map(selectorOf);
    return ({ kind, names }) => (kinds.length === 0 || kinds.includes(kind)) &&
        (words.length === 0 || selectors.some((selects) => selects(names)) ||
            words.every((word) => names.some((name) => name.includes(word))));
}
