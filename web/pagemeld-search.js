// Finds pages for a query in search indexes. Pure functions without a document, in the frame in which an index ran.
//
// prepareIndex makes a lookup of an index, once. Its units are what can be found by a title: pages, the places of a page
// (entries of the index with a fragment), and texts that begin with a heading of their own, "Heading - text" with an
// en dash. findPages first gives every unit a weight for each word of the query, by postings alone, then compares the
// titles of the best pages with the query. Words are compared without case and accents.
"use strict";

const LETTERS = /[\p{L}\p{M}\p{N}_]+/gu;
const PARTS = /\p{Lu}+(?!\p{Ll})|\p{Lu}?\p{Ll}+|\p{N}+/gu;
const UNSPACED = /[\p{sc=Han}\p{sc=Hira}\p{sc=Kana}\p{sc=Hang}]/u; // scripts that don't separate all words
const WITHOUT_ACCENT = { ı: "i", ł: "l", ø: "o", đ: "d" }; // the others have an accent that can be taken off
const MAX_WORDS = 16;
const INHERITED = 0.3;
const PLACES_COMPARED = 10;
const TEXT_LENGTH = 300;
const LEAD_LENGTH = 80; // of a text before the first word found
const LACK = 4;
const CLOSELY_COMPARED = 100; // pages
const FIELDS = { title: 1, part: 0.85, heading: 0.7, text: 0.25 };

function fold(text) {
    const lower = text.toLowerCase();
    return /^[\0-\x7f]*$/.test(lower) ? lower : lower.normalize("NFD").replace(/[\u0300-\u036f]/g, "")
        .replace(/[ıłøđ]/g, (letter) => WITHOUT_ACCENT[letter]).normalize("NFC");
}

const keysOf = (text) => fold(text).match(LETTERS) ?? [];
const lettersOf = (text) => keysOf(text).join("").replaceAll("_", "");

// "JsonParser" has the parts "json" and "parser".
function partsOf(word) {
    const parts = word.match(PARTS) ?? [];
    return parts.length > 1 ? parts.map(fold) : [];
}

function push(map, key, value) {
    const list = map.get(key);
    if (list) {
        list.push(value);
    } else {
        map.set(key, [value]);
    }
}

// Takes the lists of an index and its prefixes, longest first. Yields now and then; returns the lookup.
function* prepareIndex({ pages, info, common, searchIndex, prefixes }) {
    const lookup = {
        pages, info, common, searchIndex,
        titles: [], // of units; those of entries first, then those of texts
        prefixes: [], // of entries
        owners: [], // of units: the unit of their page
        texts: [], // of units after the entries: the number of the text
        unitOfText: new Int32Array(info.length),
        places: new Map(), // units by the unit of their page
        textsOf: new Map(), // texts by the unit of their page
        wholes: new Map(), // units by the keys in their titles
        parts: new Map(), // units by the parts of these
        spellings: new Map(), // terms by key, where these differ
        keys: new Map(), // all keys by their first two letters
        unspaced: [], // keys
    };
    yield* addEntries(lookup, prefixes);
    yield* addHeadings(lookup);
    yield* addKeys(lookup);
    lookup.pageCount = lookup.owners.reduce((count, page, unit) => count + (page === unit), 0);
    lookup.lengths = Uint8Array.from(lookup.titles, (title) => Math.min(255, (title.match(LETTERS) ?? [""]).length));
    return lookup;
}

function addUnit(lookup, title, owner) {
    const unit = lookup.titles.push(title) - 1;
    lookup.owners.push(owner ?? unit);
    if (owner !== undefined) {
        push(lookup.places, owner, unit);
    }
    for (const word of title.match(LETTERS) ?? []) {
        push(lookup.wholes, fold(word), unit);
        partsOf(word).forEach((part) => push(lookup.parts, part, unit));
    }
    return unit;
}

function* addEntries(lookup, prefixes) {
    const units = new Map();
    for (const [path, title] of lookup.pages) {
        const prefix = prefixes.find((start) => path.startsWith(start)) ?? "";
        const end = path.indexOf("#", prefix.length);
        lookup.prefixes.push(prefix);
        const unit = addUnit(lookup, title, end < 0 ? undefined : units.get(path.slice(0, end)));
        if (end < 0) {
            units.set(path, unit);
        }
        yield;
    }
}

function* addHeadings(lookup) {
    const { info, owners, titles, unitOfText } = lookup;
    for (let text = 0; text < info.length; text++) {
        const [words, unit] = info[text];
        const end = owners[unit] === unit ? words.indexOf(" \u2013 ") : -1;
        const heading = words.slice(0, Math.max(end, 0));
        unitOfText[text] = unit;
        push(lookup.textsOf, owners[unit], text);
        if (heading && heading !== titles[unit] && heading.length < 120) {
            unitOfText[text] = addUnit(lookup, heading, unit);
            lookup.texts[unitOfText[text]] = text;
        }
        yield;
    }
}

function* addKeys({ searchIndex, wholes, parts, spellings, keys, unspaced }) {
    const add = (key) => {
        push(keys, key.slice(0, 2), key);
        if (UNSPACED.test(key)) {
            unspaced.push(key);
        }
    };
    const isNew = (key) => !Object.hasOwn(searchIndex, key) && !spellings.has(key);
    for (const term of Object.keys(searchIndex)) {
        const key = fold(term);
        if (key === term || isNew(key)) {
            add(key);
        }
        if (key !== term) {
            push(spellings, key, term);
        }
        yield;
    }
    for (const key of wholes.keys()) {
        if (isNew(key)) {
            add(key);
        }
        yield;
    }
    for (const key of parts.keys()) {
        if (isNew(key) && !wholes.has(key)) {
            add(key);
        }
        yield;
    }
}

const keysNear = ({ keys }, start) => (start.length > 1 ? [keys.get(start.slice(0, 2)) ?? []]
    : [...keys].filter(([first]) => first.startsWith(start)).map(([, list]) => list)).flat();

// The words that are searched for. The last one is open, the beginning of others, while the query ends with it.
function splitQuery(query, common) {
    const all = [...new Set(keysOf(query))].slice(0, MAX_WORDS);
    const rare = all.filter((word) => !Object.hasOwn(common, word));
    const kept = rare.length > 0 ? rare : all;
    const isOpen = (word) => word === all.at(-1) && fold(query).endsWith(word);
    return kept.map((word, i) => ({
        text: word,
        isOpen: isOpen(word),
        joined: [kept.slice(i - 1, i + 1), kept.slice(i, i + 2)].filter((pair) => pair.length === 2)
            .flatMap((pair) => [pair.join(""), pair.join("_")].map((text) => ({ text, isOpen: isOpen(pair[1]) }))),
    }));
}

function sharedLength(a, b) {
    let length = 0;
    while (length < a.length && a[length] === b[length]) {
        length++;
    }
    return length;
}

// The weight of a key for a word: 1 if they are equal, less if one is an inflected form or the beginning.
function weigh(key, { text, isOpen }) {
    const shared = sharedLength(text, key);
    const share = shared / Math.max(text.length, key.length);
    const isInflected = shared > 2 && text.length - shared < 4 && key.length - shared < 4 && share > 0.6;
    const isBegun = shared === text.length && (isOpen || shared > 2);
    return share === 1 ? 1 : Math.max(isInflected ? 0.8 * share : 0, isBegun ? (isOpen ? 0.5 : 0.3) + 0.3 * share : 0);
}

// The keys that can be meant by a word, with their weights.
function findForms(lookup, word) {
    const forms = new Map();
    const add = (form, most) => keysNear(lookup, form.text).forEach((key) => {
        const weight = most * weigh(key, form);
        if (weight > (forms.get(key) ?? 0)) {
            forms.set(key, weight);
        }
    });
    add(word, 1);
    word.joined.forEach((form) => add(form, 0.95));
    return forms;
}

function letterBits(word) {
    let bits = 0;
    for (let i = 0; i < word.length; i++) {
        bits |= 1 << (word.charCodeAt(i) & 31);
    }
    return bits;
}

function countBits(bits) {
    let count = 0;
    for (let rest = bits; rest !== 0; rest &= rest - 1) {
        count++;
    }
    return count;
}

// The edits that make a key of a word: letters that are added, left out, replaced or swapped with the next. Of an open
// word, those that make the beginning of the key. More than most if there are more.
function countEdits(word, key, isOpen, most) {
    const far = most + 1;
    let [before, last, row] = [[], Array.from({ length: key.length + 1 }, (_, j) => j), []];
    for (let i = 1; i <= word.length; i++) {
        const end = Math.min(key.length, i + most);
        let least = row[Math.max(i - far, 0)] = i > most ? far : i;
        for (let j = Math.max(1, i - most); j <= end; j++) {
            const isSame = word[i - 1] === key[j - 1];
            const isSwapped = i > 1 && j > 1 && word[i - 1] === key[j - 2] && word[i - 2] === key[j - 1];
            row[j] = Math.min(last[j - 1] + !isSame, row[j - 1] + 1, (last[j] ?? far) + 1, isSwapped ? before[j - 2] + 1 : far);
            least = Math.min(least, row[j]);
        }
        if (least > most) {
            return far;
        }
        [before, last, row] = [last, row, []];
    }
    return isOpen ? Math.min(...last.slice(word.length - most).filter((n) => n !== undefined)) : last[key.length] ?? far;
}

// Also the keys that a mistyped word can mean: one edit from four letters on, two from eight on.
function addMistyped(lookup, { text, isOpen }, forms) {
    const most = text.length < 4 ? 0 : text.length < 8 ? 1 : 2;
    lookup.allKeys ??= [...lookup.keys.values()].flat();
    lookup.bits ??= Int32Array.from(lookup.allKeys, letterBits);
    const bits = letterBits(text);
    for (let i = 0; most > 0 && i < lookup.allKeys.length; i++) {
        const key = lookup.allKeys[i];
        const tooLong = !isOpen && key.length > text.length + most;
        if (key.length < text.length - most || tooLong || countBits(bits & ~lookup.bits[i]) > most || forms.has(key)) {
            continue;
        }
        const edits = countEdits(text, key, isOpen, most);
        if (edits <= most) {
            const beyond = Math.max(0, key.length - text.length - most);
            forms.set(key, (0.7 - 0.2 * edits) * (0.7 + 0.3 * text.length / (text.length + beyond)));
        }
    }
}

// Weighs units and texts of a lookup for the words whose forms are given.
function weighUnits(lookup, forms) {
    const { titles: { length }, owners, lengths, unitOfText, searchIndex } = lookup;
    const texts = new Uint32Array(unitOfText.length); // a bit for each word
    const units = forms.map(() => new Float32Array(length)); // by word
    const pages = forms.map(() => new Float32Array(length)); // by word, at the unit of the page
    const held = forms.map(() => 0); // pages by word
    forms.forEach((keys, word) => {
        const [ofUnit, ofPage, bit] = [units[word], pages[word], 1 << word];
        const raise = (unit, weight) => {
            if (weight > ofUnit[unit]) {
                ofUnit[unit] = weight;
            }
        };
        const raiseTitle = (weight) => (unit) => {
            const field = owners[unit] === unit ? FIELDS.title : FIELDS.heading;
            raise(unit, weight * field * (0.7 + 0.3 / lengths[unit]));
        };
        for (const [key, weight] of keys) {
            lookup.wholes.get(key)?.forEach(raiseTitle(weight));
            lookup.parts.get(key)?.forEach(raiseTitle(weight * FIELDS.part));
            const terms = [key, ...(lookup.spellings.get(key) ?? [])];
            for (const term of terms) {
                for (const text of Object.hasOwn(searchIndex, term) ? searchIndex[term] : []) {
                    texts[text] |= bit;
                    raise(unitOfText[text], weight * FIELDS.text);
                }
            }
        }
        for (let unit = 0; unit < length; unit++) {
            const weight = ofUnit[unit];
            if (weight > 0) {
                const page = owners[unit];
                held[word] += ofPage[page] === 0;
                ofPage[page] = Math.max(ofPage[page], weight);
            }
        }
    });
    return { lookup, forms, texts, units, pages, held };
}

const sum = (values) => values.reduce((total, value) => total + value, 0);

// How much of a title's words are those of the query, in its order: the longest common sequence, by weight of forms.
function sharedSequence(keys, sequence, formOf) {
    let row = new Float32Array(sequence.length + 1);
    for (const key of keys) {
        const next = new Float32Array(sequence.length + 1);
        sequence.forEach((word, i) => {
            next[i + 1] = Math.max(row[i + 1], next[i], row[i] + (formOf(word).get(key) ?? 0));
        });
        row = next;
    }
    return row[sequence.length];
}

// How close a title is to the query: 4 if it is the query, 3 if it ends with its words, 2 to 3 if it begins with it,
// else up to 2 for words in common.
function compareTitle(title, query, { lookup, forms }) {
    const name = title.replace(/\s*\(.*$/s, "") || title;
    const letters = lettersOf(title);
    if (letters === query.letters || lettersOf(name) === query.letters) {
        return 4;
    }
    if (keysOf(name).slice(-query.sequence.length).join(" ") === query.sequence.join(" ")) {
        return 3 + query.letters.length / letters.length / 2;
    }
    if (letters.startsWith(query.letters)) {
        return 2.6 + query.letters.length / letters.length / 2;
    }
    if (letters.includes(query.letters) && query.letters.length > 3) {
        return 2.2 + query.letters.length / letters.length / 2;
    }
    const isMeant = (key) => forms.some((keys) => keys.has(key));
    const keys = (title.match(LETTERS) ?? []).flatMap((word) => (isMeant(fold(word)) ? [fold(word)] : partsOf(word).concat(partsOf(word).length ? [] : fold(word))))
        .filter((key) => isMeant(key) || !Object.hasOwn(lookup.common, key));
    const shared = sharedSequence(keys, query.sequence, (word) => forms[query.numbers.get(word)]);
    const held = sum(query.rarity.filter((_, word) => keys.some((key) => forms[word].has(key)))) / sum(query.rarity);
    return 1.5 * (shared / Math.max(1, keys.length)) * held + 0.5 * shared / query.sequence.length;
}

// Weighs units and texts of a lookup for the words whose forms are given.
function weighUnits(lookup, forms) {
    const { titles: { length }, owners, lengths, unitOfText, searchIndex } = lookup;
    const weighed = {
        lookup, forms,
        texts: new Uint32Array(unitOfText.length), // a bit for each word
        units: forms.map(() => new Float32Array(length)), // by word
        pages: forms.map(() => new Float32Array(length)), // by word: the most of the page's units, at the page
        held: forms.map(() => 0), // pages, by word
    };
    forms.forEach((keys, word) => {
        const ofUnit = weighed.units[word];
        const raise = (unit, weight) => {
            if (weight > ofUnit[unit]) {
                ofUnit[unit] = weight;
            }
        };
        const raiseTitle = (weight) => (unit) => {
            const field = owners[unit] === unit ? FIELDS.title : FIELDS.heading;
            raise(unit, weight * field * (0.7 + 0.3 / lengths[unit]));
        };
        for (const [key, weight] of keys) {
            lookup.wholes.get(key)?.forEach(raiseTitle(weight));
            lookup.parts.get(key)?.forEach(raiseTitle(weight * FIELDS.part));
            const terms = [key, ...(lookup.spellings.get(key) ?? [])];
            for (const term of terms) {
                for (const text of Object.hasOwn(searchIndex, term) ? searchIndex[term] : []) {
                    weighed.texts[text] |= 1 << word;
                    raise(unitOfText[text], weight * FIELDS.text);
                }
            }
        }
        raisePages(weighed, word);
    });
    weighed.hasWhole = owners.some((page, unit) => page === unit && weighed.pages.every((weights) => weights[page] > 0));
    return weighed;
}

function raisePages({ lookup: { owners }, units, pages, held }, word) {
    const [ofUnit, ofPage] = [units[word], pages[word]];
    for (let unit = 0; unit < ofUnit.length; unit++) {
        const weight = ofUnit[unit];
        if (weight > 0) {
            const page = owners[unit];
            held[word] += ofPage[page] === 0;
            ofPage[page] = Math.max(ofPage[page], weight);
        }
    }
}

// What a unit alone is worth; what its page's title holds counts less.
function scoreUnit({ units }, rarity, unit, page) {
    let score = 0;
    for (let word = 0; word < rarity.length; word++) {
        score += rarity[word] * Math.max(units[word][unit], units[word][page] * INHERITED);
    }
    return score;
}

// The pages that hold half of the query's rarity at least. A page that lacks words loses the more, the rarer they are.
function scorePages(weighed, { rarity, rarest }, accepts) {
    const { lookup, pages } = weighed;
    const { owners } = lookup;
    const total = sum(rarity);
    const best = new Float32Array(owners.length);
    for (let unit = 0; unit < owners.length; unit++) {
        const page = owners[unit];
        best[page] = Math.max(best[page], scoreUnit(weighed, rarity, unit, page));
    }
    const found = [];
    for (let page = 0; page < owners.length; page++) {
        let [lacked, weight] = [0, 0];
        for (let word = 0; word < rarity.length && best[page] > 0; word++) {
            lacked += pages[word][page] > 0 ? 0 : rarity[word];
            weight += pages[word][page] * rarity[word];
        }
        if (weight > 0 && lacked <= total / 2 && accepts(lookup, page)) {
            const factor = Math.exp(-LACK * lacked / rarest);
            found.push({ weighed, page, factor, isWhole: lacked === 0, score: (weight + best[page]) / total * factor });
        }
    }
    return found;
}

const byScore = (a, b) => b.score - a.score;

// Adds the places of a result, best first, and how close they and its title are to the query.
function compareTitles(result, query) {
    const { weighed, page } = result;
    const { lookup: { places, titles }, units } = weighed;
    result.places = (places.get(page) ?? []).filter((unit) => units.some((weights) => weights[unit] > 0))
        .map((unit) => ({ unit, score: scoreUnit(weighed, query.rarity, unit, page) / sum(query.rarity) }))
        .sort(byScore).slice(0, PLACES_COMPARED);
    result.places.forEach((place) => {
        place.closeness = compareTitle(titles[place.unit], query, weighed);
        place.score += place.closeness;
    });
    result.places.sort(byScore);
    result.closeness = compareTitle(titles[page], query, weighed);
    result.score += Math.max(result.closeness, FIELDS.heading * (result.places[0]?.closeness ?? 0)) * result.factor;
}

// Returns the pages found, best first: the own module is that without a prefix. Pages that the caller does not accept
// are left out. The words are what was searched for; isCommon says that there are only words that searches leave out.
function findPages(lookups, query, accepts = () => true) {
    const words = splitQuery(query, lookups[0].common);
    const forms = lookups.map((lookup) => words.map((word) => findForms(lookup, word)));
    const weigh = () => lookups.map((lookup, i) => weighUnits(lookup, forms[i]));
    let weighed = weigh();
    const heldBy = (word) => sum(weighed.map(({ held }) => held[word]));
    if (words.some((_, word) => heldBy(word) === 0) || !weighed.some(({ hasWhole }) => hasWhole)) {
        lookups.forEach((lookup, i) => words.forEach((word, j) => addMistyped(lookup, word, forms[i][j])));
        weighed = weigh();
    }
    const pageCount = sum(lookups.map((lookup) => lookup.pageCount));
    const details = {
        letters: lettersOf(query),
        sequence: keysOf(query).filter((key) => words.some(({ text }) => text === key)),
        numbers: new Map(words.map(({ text }, word) => [text, word])),
        rarity: words.map((_, word) => Math.log(1 + pageCount / (1 + heldBy(word)))),
        rarest: Math.log(1 + pageCount),
    };
    const pages = weighed.flatMap((each) => scorePages(each, details, accepts)).sort(byScore);
    const best = pages.splice(0, CLOSELY_COMPARED);
    best.forEach((result) => compareTitles(result, details));
    return { details, pages: [...best.sort(byScore), ...pages], isCommon: false };
}

// The places of a result that are worth showing.
function pickPlaces({ places }, most) {
    return places.filter(({ score }) => score > 0.6 * places[0].score).slice(0, most);
}

// The text of a page that holds most of the words, those of its best place first.
function chooseText({ weighed: { lookup, texts }, page, places }, { rarity }) {
    const valueOf = (text) => sum(rarity.filter((_, word) => texts[text] & (1 << word))) +
        (lookup.unitOfText[text] === places[0]?.unit ? 0.5 : 0);
    const best = (lookup.textsOf.get(page) ?? []).reduce((a, b) => (valueOf(b) > valueOf(a) ? b : a), -1);
    return lookup.info[best]?.[0] ?? "";
}

// Splits a text, cut around the first word found, into pieces. Every second one is a word found.
function cutText(text, { forms }, { sequence }) {
    const runs = sequence.filter((word) => UNSPACED.test(word));
    const one = UNSPACED.source;
    const word = new RegExp(`${runs.map((run) => `${run}|`).join("")}(?:(?!${one})[\\p{L}\\p{M}\\p{N}_])+|${one}`, "giu");
    const isFound = (piece) => runs.includes(fold(piece)) || forms.some((keys) => keys.has(fold(piece)) || partsOf(piece).some((part) => keys.has(part)));
    const first = [...text.matchAll(word)].find(([piece]) => isFound(piece))?.index ?? 0;
    const end = first > LEAD_LENGTH ? text.slice(first - LEAD_LENGTH).replace(/^\S{0,40}\s/, "\u2026 ") : text;
    const cut = end.length > TEXT_LENGTH ? end.slice(0, TEXT_LENGTH).replace(/\s\S{0,40}$/, " \u2026") : end;
    const pieces = [""];
    let last = 0;
    for (const { 0: piece, index } of cut.matchAll(word)) {
        if (isFound(piece)) {
            pieces.push(cut.slice(last, index), piece);
            last = index + piece.length;
        }
    }
    pieces.shift();
    return [...pieces, cut.slice(last)];
}

// A place as a link: a text with a heading of its own has the heading as text fragment.
function linkOf({ pages, titles, owners }, unit) {
    const heading = encodeURIComponent(titles[unit]).replaceAll("-", "%2D");
    return unit < pages.length ? pages[unit][0] : `${pages[owners[unit]][0]}#:~:text=${heading}`;
}

// What is shown of a result: links, titles, and the pieces of a text. isAsked says that the first place is meant.
function describePage(result, details) {
    if (!result.places) {
        compareTitles(result, details);
    }
    const { weighed, page, places: [first], closeness } = result;
    const { lookup } = weighed;
    return {
        link: linkOf(lookup, page),
        title: lookup.titles[page],
        pieces: cutText(chooseText(result, details), weighed, details),
        places: pickPlaces(result, 3).map(({ unit }) => ({ link: linkOf(lookup, unit), title: lookup.titles[unit] })),
        isAsked: first?.closeness >= 3 && first.closeness >= closeness,
    };
}
