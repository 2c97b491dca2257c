// Finds pages for a query in search indexes, without a document: runs in the frame in which an index ran.
//
// A unit has a title: a page, a place in it (an entry with a fragment), or a text with a heading ("Heading – text").
// A key is a word, or a part of one, without case and accents. Forms are the keys that a word of a query can mean.
"use strict";

const WORDS = /[\p{L}\p{M}\p{N}_]+/gu;
const PARTS = /\p{Lu}+(?!\p{Ll})|\p{Lu}?\p{Ll}+|\p{N}+/gu; // of "JsonParser" or "utf_8"
const UNSPACED = /([\p{sc=Han}\p{sc=Hira}\p{sc=Kana}\p{sc=Hang}]{1,2})/u; // of words without spaces between them
const [TITLE, HEADING, TEXT] = [1, 0.7, 0.25]; // weights of a word by where it is
const [PAGES_COMPARED, PLACES_COMPARED, PLACES_SHOWN] = [60, 6, 3];

const byScore = (a, b) => b.score - a.score;
const push = (map, key, value) => { map.set(key, map.get(key) ?? []).get(key).push(value); };
const isUnspaced = (text) => UNSPACED.test(text);
const unaccent = (text) => text.normalize("NFD").replace(/[\u0300-\u036f]/g, "").replaceAll("ı", "i").normalize("NFC");
const fold = (text) => (/[^\0-\x7f]/.test(text) ? unaccent(text) : text).toLowerCase();
const wordsOf = (text) => fold(text).match(WORDS) ?? [];
const lettersOf = (text) => wordsOf(text).join("").replaceAll("_", "");
const keysOf = (text) => new Set([...wordsOf(text), ...(text.match(PARTS) ?? []).map(fold)]);

// Takes the lists of an index, and its prefixes, longest first. Yields now and then; returns the lookup.
function* prepareIndex({ pages, info, common, searchIndex }, allPrefixes) {
    const lookup = {
        pages, info, common, prefixes: [], titles: [], owners: [], fields: [], // of units: title, page, title's weight
        unitOfText: [], texts: new Map(), units: new Map(), // texts by unit, units by page
        named: new Map(), listed: new Map(), pieces: new Map(), // units and texts by key; keys by some of their letters
    };
    const owners = new Map();
    for (const [path, title] of pages) {
        const prefix = allPrefixes.find((start) => path.startsWith(start)) ?? "";
        const page = prefix + path.slice(prefix.length).split("#", 1);
        owners.set(page, owners.get(page) ?? lookup.titles.length);
        lookup.prefixes.push(prefix);
        addUnit(lookup, title, owners.get(page));
        yield;
    }
    yield* addTexts(lookup);
    yield* addKeys(lookup, searchIndex);
    return lookup;
}

function addUnit({ titles, owners, fields, named, units }, title, owner) {
    const unit = titles.push(title) - 1;
    const keys = keysOf(title);
    owners.push(owner);
    fields.push((owner === unit ? TITLE : HEADING) * (0.7 + 0.3 / keys.size));
    push(units, owner, unit);
    keys.forEach((key) => push(named, key, unit));
    return unit;
}

// The unit of a text is its entry, but a new one if it is of a page and has a heading.
function* addTexts(lookup) {
    const { info, titles, owners, unitOfText, texts } = lookup;
    for (const [text, [words, entry]] of info.entries()) {
        const [heading, ...rest] = owners[entry] === entry ? words.split(" \u2013 ") : [];
        const isNew = rest.length > 0 && heading !== titles[entry];
        unitOfText[text] = isNew ? addUnit(lookup, heading, entry) : entry;
        push(texts, unitOfText[text], text);
        yield;
    }
}

function* addKeys({ named, listed, pieces }, searchIndex) {
    for (const [term, texts] of Object.entries(searchIndex)) {
        const key = fold(term);
        listed.set(key, listed.get(key)?.concat(texts) ?? texts);
        yield;
    }
    for (const key of new Set([...named.keys(), ...listed.keys()])) {
        [key.slice(0, 1), key.slice(0, 2), `+${key.slice(3, 5)}`].forEach((piece) => push(pieces, piece, key));
        yield;
    }
}

// The words searched for: common ones only if there are no others. The last is open, to grow, if the query ends with it.
function splitQuery(text, common) {
    const all = [...new Set(wordsOf(text).flatMap((word) => word.split(UNSPACED)))].filter((key) => key !== "");
    const rare = all.filter((key) => !Object.hasOwn(common, key));
    const canGrow = (rare.length > 0 || all.length === 1) && fold(text).endsWith(all.at(-1));
    return (rare.length > 0 ? rare : all).map((key) => ({ key, isOpen: canGrow && key === all.at(-1) }));
}

// Whether a number of edits (a letter added, left out, replaced, or swapped) makes a word a key, or its beginning.
function isNear(word, key, isOpen, edits) {
    let i = 0;
    while (i < word.length && word[i] === key[i]) {
        i++;
    }
    if (edits === 0 || i === word.length) {
        return i === word.length && (isOpen || key.length - i <= edits);
    }
    const isAfter = (m, n) => isNear(word.slice(i + m), key.slice(i + n), isOpen, edits - 1);
    return isAfter(1, 1) || isAfter(1, 0) || isAfter(0, 1)
        || (word[i] === key[i + 1] && word[i + 1] === key[i] && isAfter(2, 2));
}

// How well a key is a form of a word: equal, begun, inflected (the same but for the last letters), or mistyped.
function weighForm(key, { key: word, isOpen }, isLenient) {
    const share = Math.min(word.length, key.length) / Math.max(word.length, key.length);
    const stem = word.slice(0, Math.max(3, Math.ceil(0.7 * word.length)));
    const canBeNear = (edits) => word.length >= 4 * edits && (isOpen || Math.abs(key.length - word.length) <= edits);
    const isMistyped = (edits) => isLenient && canBeNear(edits) && isNear(word, key, isOpen, edits);
    return key === word ? 1
        : key.startsWith(word) && (isOpen || word.length > 2) ? (isOpen ? 0.6 : 0.4) + 0.4 * share
        : key.startsWith(stem) && share > 0.6 ? 0.8 * share
        : isMistyped(1) ? 0.5
        : isMistyped(2) ? 0.3 : 0;
}

// The keys that may be forms. A mistyped word is right at its beginning, or about its fourth letter.
function findCandidates({ named, listed, pieces }, key, isLenient) {
    if (isUnspaced(key)) {
        return [...named.keys(), ...listed.keys()].filter((other) => other.includes(key));
    }
    const middles = isLenient ? [2, 3, 4].map((start) => `+${key.slice(start, start + 2)}`) : [];
    return [key.slice(0, 2), ...middles].flatMap((piece) => pieces.get(piece) ?? []);
}

// Weighs units for a word, and pages by the form alone. One or two letters begin a word of nearly every text.
function weighWord(lookup, word, isLenient) {
    const { named, listed, owners, fields, unitOfText, units } = lookup;
    const [forms, scores, held] = [new Map(), new Float32Array(owners.length), new Float32Array(owners.length)];
    const raise = (unit, weight, field) => {
        scores[unit] = Math.max(scores[unit], weight * field);
        held[owners[unit]] = Math.max(held[owners[unit]], weight);
    };
    for (const key of findCandidates(lookup, word.key, isLenient)) {
        const weight = isUnspaced(word.key) ? 0.8 : weighForm(key, word, isLenient);
        if (weight > 0 && !forms.has(key)) {
            forms.set(key, weight);
            named.get(key)?.forEach((unit) => raise(unit, weight, fields[unit]));
            const texts = word.key.length > 2 || weight > 0.7 ? listed.get(key) : [];
            texts?.forEach((text) => raise(unitOfText[text], weight, TEXT));
        }
    }
    return { forms, scores, held, rarity: Math.log(1 + units.size / (1 + held.filter(Boolean).length)) };
}

// How close a title is to the query: 4 if it is it, from 3 on if it ends with it, from 2.5 on if it holds it, else less.
function compareTitle({ words, letters }, title, score) {
    const own = lettersOf(title);
    const isEnd = own.endsWith(letters);
    if (isEnd || (letters.length > 3 && own.includes(letters))) {
        return own === letters ? 4 : (isEnd ? 3 : 2.5) + letters.length / own.length / 2;
    }
    const isMeant = (key) => words.some(({ forms }) => forms.has(key));
    return 2 * score * wordsOf(title).filter(isMeant).length / Math.max(1, wordsOf(title).length);
}

// The sum of what words weigh, each by its share of the rarity of all.
function addUp(words, name, length) {
    const whole = words.reduce((total, { rarity }) => total + rarity, 0);
    const sums = new Float32Array(length);
    for (const { rarity, [name]: weights } of words) {
        weights.forEach((weight, i) => { sums[i] += rarity / whole * weight; });
    }
    return sums;
}

// The pages that hold at least .4 as much of the query as any does; of equal ones the own module's come first.
function scorePages(asked, accepts) {
    const { words, lookup, lookup: { owners, units, prefixes } } = asked;
    const [scores, held] = ["scores", "held"].map((name) => addUp(words, name, owners.length));
    const best = new Float32Array(owners.length);
    scores.forEach((score, unit) => { best[owners[unit]] = Math.max(best[owners[unit]], score); });
    const least = 0.4 * held.reduce((a, b) => Math.max(a, b), 0);
    const found = [...units.keys()].filter((page) => held[page] > least && accepts(lookup, page));
    return found.map((page) => {
        const factor = held[page] ** 3;
        const score = best[page] * factor + (prefixes[page] === "" ? 1e-6 : 0);
        return { asked, scores, page, factor, score, isWhole: words.every((word) => word.held[page] > 0) };
    });
}

// Adds the best places to a result, and to its score how close the titles are to the query.
function compareTitles(result) {
    const { asked, asked: { lookup }, scores, page, factor } = result;
    const compare = (unit) => compareTitle(asked, lookup.titles[unit], scores[unit]);
    const holding = lookup.units.get(page).filter((unit) => unit !== page && scores[unit] > 0);
    const best = holding.sort((a, b) => scores[b] - scores[a]).slice(0, PLACES_COMPARED);
    const places = best.map((unit) => ({ unit, score: scores[unit] + compare(unit) })).sort(byScore);
    const first = places.length > 0 ? compare(places[0].unit) : 0;
    const score = result.score + Math.max(compare(page), first < 2 ? 0 : HEADING * first) * factor;
    return { ...result, score, places, isPlaceMeant: first >= Math.max(3, compare(page)) };
}

// Returns the words searched for, and the pages found in the lookups, best first, of those that the caller accepts.
function findPages(lookups, text, accepts) {
    const words = splitQuery(text, lookups[0].common);
    const find = (isLenient) => lookups.flatMap((lookup) => {
        const weighed = words.map((word) => ({ ...word, ...weighWord(lookup, word, isLenient) }));
        return scorePages({ lookup, letters: lettersOf(text), words: weighed }, accepts);
    }).sort(byScore);
    const exact = find(false);
    const pages = exact.some(({ isWhole }) => isWhole) ? exact : find(true);
    const best = pages.slice(0, PAGES_COMPARED).map(compareTitles).sort(byScore);
    return { words, pages: best.concat(pages.slice(PAGES_COMPARED)) };
}

// Splits a text. Every second piece is a word found; of words without spaces between them, what the query has of them.
function splitText(text, words) {
    const keys = RegExp(words.map(({ key }) => key).join("|"), "giu");
    const isFound = (word) => [...keysOf(word)].some((key) => words.some(({ forms }) => forms.has(key)));
    const mark = (word) => (isFound(word) ? word.replace(isUnspaced(word) ? keys : word, "\0$&\0") : word);
    return text.replace(WORDS, mark).split("\0");
}

// What is shown of a result: a link, a text with its words, and the best places, without an address by their headings.
function describePage(result) {
    const { asked: { words, lookup }, scores, page, places, isPlaceMeant } = compareTitles(result);
    const { titles, pages, units, texts, info } = lookup;
    const linkTo = (unit) => ({ title: titles[unit],
        link: pages[unit]?.[0] ?? `${pages[page][0]}#:~:text=${encodeURIComponent(titles[unit]).replaceAll("-", "%2D")}` });
    const best = units.get(page).filter((unit) => texts.has(unit)).reduce((a, b) => (scores[b] > scores[a] ? b : a), page);
    const pieces = (texts.get(best) ?? []).map((text) => splitText(info[text][0], words));
    return { ...linkTo(page), isPlaceMeant, places: places.slice(0, PLACES_SHOWN).map(({ unit }) => linkTo(unit)),
        pieces: pieces.reduce((a, b) => (b.length > a.length ? b : a), []) };
}
