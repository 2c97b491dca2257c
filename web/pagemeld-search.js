// Finds pages for a query in search indexes. Functions without a document, run in the frame in which an index ran.
//
// A unit has a title: a page, a place in it (an entry with a fragment), or a text with a heading, "Heading - text" with
// an en dash. A key is a word without case and accents. The forms of a word are the keys that it can mean, by weight.
"use strict";

const WORDS = /[\p{L}\p{M}\p{N}_]+/gu;
const PARTS = /\p{Lu}+(?!\p{Ll})|\p{Lu}?\p{Ll}+|\p{N}+/gu; // of "JsonParser" or "utf_8"
const UNSPACED = "[\\p{sc=Han}\\p{sc=Hira}\\p{sc=Kana}\\p{sc=Hang}]"; // letters of words without spaces between them
const SPACED = `(?:(?!${UNSPACED})[\\p{L}\\p{M}\\p{N}_])+`;
const [TITLE, HEADING, TEXT] = [1, 0.7, 0.25]; // weights of a word by where it is
const LACKED = 4; // how much a page loses for words that it lacks
const [WORDS_KEPT, PAGES_COMPARED, PLACES_COMPARED, PLACES_SHOWN] = [16, 60, 6, 3];

const sum = (values) => values.reduce((total, value) => total + value, 0);
const byScore = (a, b) => b.score - a.score;
const push = (map, key, value) => (map.get(key) ?? map.set(key, []).get(key)).push(value);
const keysOf = (text) => fold(text).match(WORDS) ?? [];
const isUnspaced = ((pattern) => (key) => pattern.test(key))(RegExp(UNSPACED, "u")); // compiled once
const fold = (text) => text.normalize("NFD").toLowerCase().replace(/[\u0300-\u036f]/g, "").replaceAll("ı", "i").normalize("NFC");
const keysOfWord = (word) => [word, ...(word.match(PARTS)?.filter((part) => part !== word) ?? [])].map(fold);

// What titles and queries are compared by, without what is in parentheses: "get(item)".
function describeName(text) {
    const keys = keysOf(text.replace(/(?<=.)\s*\(.*/s, ""));
    return { keys, letters: keys.join("").replaceAll("_", ""), spaced: ` ${keys.join(" ")}` };
}

// Takes the lists of an index, and its prefixes, longest first. Yields now and then; returns the lookup.
function* prepareIndex({ pages, info, common, searchIndex }, allPrefixes) {
    const [prefixes, titles, owners, fields] = [[], [], [], []]; // of entries; of units: title, page, weight of the title
    const [named, listed] = [new Map(), new Map()]; // by key: units whose title has it; texts
    const [units, places, textsOf] = [new Map(), new Map(), new Map()]; // by page: its unit; by that: all its units; texts
    const addUnit = (title, owner) => {
        const unit = titles.push(title) - 1;
        const words = title.match(WORDS) ?? [];
        owners.push(owner);
        fields.push((owner === unit ? TITLE : HEADING) * (0.7 + 0.3 / words.length));
        push(places, owner, unit);
        words.flatMap(keysOfWord).forEach((key) => push(named, key, unit));
        return unit;
    };
    for (const [path, title] of pages) {
        const prefix = allPrefixes.find((start) => path.startsWith(start)) ?? "";
        const page = prefix + path.slice(prefix.length).split("#", 1);
        units.set(page, units.get(page) ?? titles.length);
        prefixes.push(prefix);
        addUnit(title, units.get(page));
        yield;
    }
    const unitOfText = new Int32Array(info.length);
    for (const [text, [words, unit]] of info.entries()) {
        const heading = owners[unit] === unit ? words.slice(0, Math.max(0, words.indexOf(" \u2013 "))) : "";
        unitOfText[text] = heading !== "" && heading !== titles[unit] ? addUnit(heading, unit) : unit;
        push(textsOf, owners[unit], text);
        yield;
    }
    for (const [term, texts] of Object.entries(searchIndex)) {
        const key = fold(term);
        listed.set(key, listed.get(key)?.concat(texts) ?? texts);
    }
    const keys = [...listed.keys(), ...[...named.keys()].filter((key) => !listed.has(key))];
    return { pages, info, common, prefixes, titles, named, listed, places, textsOf, unitOfText, keys: `\n${keys.join("\n")}\n`,
        pageCount: units.size, owners: Int32Array.from(owners), fields: Float32Array.from(fields), weighed: {} };
}

// The words that are searched for: two letters each of runs without spaces. The last word is open, the beginning of
// others, while the query ends with it. Common words are left out unless there are no others.
function splitQuery(text, common) {
    const split = (run) => (run.length < 3 || !isUnspaced(run) ? run : Array.from(run.slice(1), (letter, i) => run[i] + letter));
    const all = [...new Set((fold(text).match(RegExp(`${UNSPACED}+|${SPACED}`, "gu")) ?? []).flatMap(split))];
    const rare = all.filter((key) => !Object.hasOwn(common, key));
    const isOpen = (key) => key === all.at(-1) && fold(text).endsWith(key) && (rare.length > 0 || all.length === 1);
    return (rare.length > 0 ? rare : all).map((key) => ({ key, isOpen: isOpen(key) }));
}

// The keys that hold a piece. One that begins with a line feed is the beginning of a key.
function keysWith({ keys }, piece) {
    const found = [];
    for (let at = keys.indexOf(piece), end; at >= 0; at = keys.indexOf(piece, end)) {
        end = keys.indexOf("\n", at + 1);
        found.push(keys.slice(keys.lastIndexOf("\n", at) + 1, end));
    }
    return found;
}

// Whether a number of edits at most (a letter added, left out, replaced, or swapped with the next) makes the rest of a
// key of the rest of a word; of an open word, the beginning of that rest.
function isNear(word, i, key, j, isOpen, edits) {
    while (i < word.length && word.charCodeAt(i) === key.charCodeAt(j)) {
        i++;
        j++;
    }
    if (edits === 0 || i === word.length) {
        return i === word.length && (isOpen || key.length - j <= edits);
    }
    const isAfter = (m, n) => isNear(word, i + m, key, j + n, isOpen, edits - 1);
    return isAfter(1, 1) || isAfter(1, 0) || isAfter(0, 1) || (word[i] === key[j + 1] && word[i + 1] === key[j] && isAfter(2, 2));
}

// The weight of a key as a form of a word: equal, begun, inflected (all but the last letters are the same), or mistyped
// by one edit from four letters on, two from eight on.
function weighForm(key, { key: word, isOpen }, isLenient) {
    const share = Math.min(word.length, key.length) / Math.max(word.length, key.length);
    const stem = word.slice(0, Math.max(3, Math.ceil(0.7 * word.length)));
    const begun = (isOpen || word.length > 2) && key.startsWith(word) ? (isOpen ? 0.5 : 0.3) + 0.3 * share : 0;
    const inflected = share > 0.6 && word.length > 2 && key.startsWith(stem) ? 0.8 * share : 0;
    const isMistyped = (edits) => isLenient && word.length >= 4 * edits && isNear(word, 0, key, 0, isOpen, edits);
    const mistyped = (isMistyped(1) ? 0.5 : isMistyped(2) ? 0.3 : 0) * (0.7 + 0.3 * share);
    return key === word ? 1 : Math.max(begun, inflected, mistyped);
}

// Weighs units for a word, and pages by the form alone. A mistyped word has its first two letters, or those after the
// third. A beginning of one or two letters counts in titles only: nearly every text has a word that begins so.
function weighWord(lookup, word, isLenient) {
    const { named, listed, owners, fields, unitOfText } = lookup;
    const [forms, units, pages] = [new Map(), new Float32Array(owners.length), new Float32Array(owners.length)];
    const raise = (unit, weight, field) => {
        units[unit] = Math.max(units[unit], weight * field);
        pages[owners[unit]] = Math.max(pages[owners[unit]], weight);
    };
    const start = isUnspaced(word.key) ? word.key : `\n${word.key.slice(0, 2)}`;
    const middle = isLenient && word.key.length > 3 ? keysWith(lookup, word.key.slice(3, 6)) : [];
    for (const key of [...keysWith(lookup, start), ...middle]) {
        const weight = isUnspaced(word.key) ? 0.8 : weighForm(key, word, isLenient);
        if (weight > 0 && !forms.has(key)) {
            forms.set(key, weight);
            named.get(key)?.forEach((unit) => raise(unit, weight, fields[unit]));
            if (word.key.length > 2 || weight > 0.7) {
                listed.get(key)?.forEach((text) => raise(unitOfText[text], weight, TEXT));
            }
        }
    }
    return { key: word.key, forms, units, pages, count: pages.reduce((total, weight) => total + (weight > 0 ? 1 : 0), 0) };
}

// How close a title is to the query: 4 if it is it, from 3 on if it ends with it, from 2 on if it holds it, else less.
function compareTitle({ lookup, words }, unit, { letters, spaced }) {
    const own = describeName(lookup.titles[unit]);
    const share = letters.length / own.letters.length / 2;
    if (own.letters === letters || own.spaced.endsWith(spaced)) {
        return own.letters === letters ? 4 : 3 + share;
    }
    if (letters.length > 3 && own.letters.includes(letters)) {
        return (own.letters.startsWith(letters) ? 2.8 : 2.3) + share;
    }
    const meant = own.keys.filter((key) => words.some(({ forms }) => forms.has(key)));
    const weights = words.map(({ forms }) => Math.max(0, ...meant.map((key) => forms.get(key) ?? 0)));
    return sum(weights) / words.length * (0.5 + 1.5 * meant.length / own.keys.length || 0);
}

// The pages that hold nearly half as much of the query as any does, by rarity; of equal ones the own module's first.
function scorePages(weighed, accepts) {
    const { words, lookup, lookup: { owners, places, prefixes, pageCount } } = weighed;
    const rarity = words.map(({ count }) => Math.log(1 + pageCount / Math.max(1, count)));
    const [scores, lacked] = [new Float32Array(owners.length), new Float32Array(owners.length).fill(1)];
    words.forEach(({ units, pages }, i) => {
        const share = rarity[i] / sum(rarity);
        for (let unit = 0; unit < owners.length; unit++) {
            scores[unit] += share * units[unit];
            lacked[unit] -= share * pages[unit];
        }
    });
    const most = 0.6 + 0.4 * lacked.reduce((least, share) => Math.min(least, share), 0.999);
    const found = owners.filter((page, unit) => page === unit && lacked[page] <= most && accepts(lookup, page));
    return Array.from(found, (page) => {
        const factor = Math.exp(-LACKED * lacked[page]);
        const best = places.get(page).reduce((most, unit) => Math.max(most, scores[unit]), 0);
        const isWhole = words.every(({ pages }) => pages[page] > 0);
        return { weighed, scores, page, factor, isWhole, score: best * factor + (prefixes[page] === "" ? 1e-6 : 0) };
    });
}

// Adds the best places to a result, and to their scores and its own how close the titles are to the query.
function compareTitles(result, query) {
    const { weighed, weighed: { lookup }, scores, page } = result;
    const holding = lookup.places.get(page).filter((unit) => unit !== page && scores[unit] > 0);
    const places = holding.sort((a, b) => scores[b] - scores[a]).slice(0, PLACES_COMPARED)
        .map((unit) => ({ unit, score: scores[unit] + compareTitle(weighed, unit, query) })).sort(byScore);
    const own = compareTitle(weighed, page, query);
    const first = places.length > 0 ? places[0].score - scores[places[0].unit] : 0;
    const score = result.score + Math.max(own, first < 2 ? 0 : HEADING * first) * result.factor;
    return { ...result, score, places, isPlaceMeant: first >= Math.max(3, own) };
}

// Returns the pages found in the lookups, best first, of those that the caller accepts; and the query for describePage.
function findPages(lookups, text, accepts = () => true) {
    const words = splitQuery(text, lookups[0].common);
    const recall = (lookup, word, name) => (lookup.weighed[name] ??= weighWord(lookup, word, name.endsWith("~")));
    const weigh = (lookup, end) => words.map((word) => recall(lookup, word, `${word.key} ${word.isOpen}${end}`));
    const find = (end) => lookups.flatMap((lookup) => scorePages({ lookup, words: weigh(lookup, end) }, accepts)).sort(byScore);
    lookups.filter(({ weighed }) => Object.keys(weighed).length > WORDS_KEPT).forEach((lookup) => { lookup.weighed = {}; });
    const query = describeName(text);
    const exact = find("");
    const pages = exact.some(({ isWhole }) => isWhole) ? exact : find("~");
    const best = pages.slice(0, PAGES_COMPARED).map((result) => compareTitles(result, query)).sort(byScore);
    return { query, pages: [...best, ...pages.slice(PAGES_COMPARED)] };
}

// Splits a text. Every second piece is a word found.
function splitText(text, forms) {
    const pattern = RegExp([...[...forms].filter(isUnspaced), SPACED].join("|"), "giu");
    const isFound = (word) => keysOfWord(word).some((key) => forms.has(key));
    return text.replace(pattern, (word) => (isFound(word) ? `\0${word}\0` : word)).split("\0");
}

// What is shown of a result: a link, its title, the text of the best unit with the most words, and the best places. The
// first place is meant if its title is the query or ends with it. A place without an address is led to by its heading.
function describePage(found, query) {
    const { weighed, scores, page, places, isPlaceMeant } = found.places ? found : compareTitles(found, query);
    const { titles, pages, textsOf, unitOfText, info } = weighed.lookup;
    const forms = new Set(weighed.words.flatMap((word) => (isUnspaced(word.key) ? word.key : [...word.forms.keys()])));
    const most = Math.max(...(textsOf.get(page) ?? []).map((text) => scores[unitOfText[text]]));
    const best = textsOf.get(page)?.filter((text) => scores[unitOfText[text]] === most) ?? [];
    const linkTo = (unit) => ({ title: titles[unit],
        link: pages[unit]?.[0] ?? `${pages[page][0]}#:~:text=${encodeURIComponent(titles[unit]).replaceAll("-", "%2D")}` });
    const shown = places.filter(({ score }) => score > 0.6 * places[0].score).slice(0, PLACES_SHOWN);
    return { ...linkTo(page), isPlaceMeant, places: shown.map(({ unit }) => linkTo(unit)),
        pieces: best.map((text) => splitText(info[text][0], forms)).reduce((a, b) => (b.length > a.length ? b : a), []) };
}
