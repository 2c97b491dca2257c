// Finds pages for a query in search indexes. Functions without a document, run in the frame in which an index ran.
//
// prepareIndex makes a lookup of an index, once. Its units are what has a title: pages, their places (entries of the
// index with a fragment), and texts with a heading of their own, "Heading - text" with an en dash. findPages weighs the
// units for each word of a query by lists alone, then compares the titles of the best pages and places with the query.
// A key is a word without case and accents. The forms of a word are the keys that it can mean, with weights up to 1.
"use strict";

const WORDS = /[\p{L}\p{M}\p{N}_]+/gu;
const PARTS = /\p{Lu}+(?!\p{Ll})|\p{Lu}?\p{Ll}+|\p{N}+/gu; // of "JsonParser" or "utf_8"
const UNSPACED = "[\\p{sc=Han}\\p{sc=Hira}\\p{sc=Kana}\\p{sc=Hang}]"; // letters of words without spaces between them
const [TITLE, HEADING, TEXT] = [1, 0.7, 0.25]; // weights of a word by where it is
const [ELSEWHERE, IN_PAGE] = [0.1, 0.3]; // what a word elsewhere in the page counts for a place, and for the page
const [LACKED, INEXACT] = [3, 2]; // how much a page loses for the rarity of words that it lacks, or has in other forms
const [MAX_WORDS, PAGES_COMPARED, PLACES_COMPARED, PLACES_SHOWN] = [16, 60, 6, 3];
const [TEXT_LENGTH, LEAD_LENGTH] = [300, 80]; // the lead comes before the first word found

const sum = (values) => values.reduce((total, value) => total + value, 0);
const byScore = (a, b) => b.score - a.score;
const keysOf = (text) => fold(text).match(WORDS) ?? [];
const lettersOf = (text) => keysOf(text).join("").replaceAll("_", "");
const isUnspaced = (key) => RegExp(UNSPACED, "u").test(key);
const push = (map, key, value) => (map.get(key) ?? map.set(key, []).get(key)).push(value);

function fold(text) {
    const lower = text.toLowerCase();
    return /^[\0-\x7f]*$/.test(lower) ? lower
        : lower.normalize("NFD").replace(/[\u0300-\u036f]/g, "").replaceAll("ı", "i").normalize("NFC");
}

function partsOf(word) {
    const parts = word.match(PARTS) ?? [];
    return parts.length > 1 ? parts.map(fold) : [];
}

function addUnit({ titles, owners, lengths, places, named }, title, owner) {
    const unit = titles.push(title) - 1;
    const words = title.match(WORDS) ?? [];
    owners.push(owner);
    lengths.push(words.length);
    push(places, owner, unit);
    words.flatMap((word) => [fold(word), ...partsOf(word)]).forEach((key) => push(named, key, unit));
    return unit;
}

// Takes the lists of an index, and its prefixes, longest first. Yields now and then; returns the lookup.
function* prepareIndex({ pages, info, common, searchIndex }, allPrefixes) {
    const lookup = {
        pages, info, common,
        prefixes: [], // of entries
        titles: [], owners: [], lengths: [], // of units: title, unit of the page, words of the title
        unitOfText: new Int32Array(info.length),
        places: new Map(), textsOf: new Map(), // by unit of a page: its units, the page first; its texts
        named: new Map(), listed: new Map(), // by key: units whose title has it; texts
        near: new Map(), // keys by their first two letters
        forms: new Map(), mistyped: new Map(), // by word, as they are asked for
    };
    const { titles, owners, listed, named } = lookup;
    const units = new Map();
    for (const [path, title] of pages) {
        const prefix = allPrefixes.find((start) => path.startsWith(start)) ?? "";
        const page = prefix + path.slice(prefix.length).split("#", 1);
        units.set(page, units.get(page) ?? titles.length);
        addUnit(lookup, title, units.get(page));
        lookup.prefixes.push(prefix);
        yield;
    }
    for (const [text, [words, unit]] of info.entries()) {
        const heading = owners[unit] === unit ? words.slice(0, Math.max(0, words.indexOf(" \u2013 "))) : "";
        const isUnit = heading !== "" && heading !== titles[unit];
        lookup.unitOfText[text] = isUnit ? addUnit(lookup, heading, unit) : unit;
        push(lookup.textsOf, owners[unit], text);
        yield;
    }
    for (const term of Object.keys(searchIndex)) {
        const key = fold(term);
        const others = listed.get(key);
        listed.set(key, others ? others.concat(searchIndex[term]) : searchIndex[term]);
        yield;
    }
    const keys = [...listed.keys(), ...[...named.keys()].filter((key) => !listed.has(key))];
    for (const key of keys) {
        push(lookup.near, key.slice(0, 2), key);
        yield;
    }
    return { ...lookup, keys, owners: Int32Array.from(owners), pageCount: units.size };
}

// The words that are searched for. The last one is open, the beginning of others, while the query ends with it.
function splitQuery(text, common) {
    const all = [...new Set(keysOf(text))].slice(0, MAX_WORDS);
    const rare = all.filter((key) => !Object.hasOwn(common, key));
    const isOpen = (key) => key === all.at(-1) && fold(text).endsWith(key) && (rare.length > 0 || all.length === 1);
    return (rare.length > 0 ? rare : all).map((key) => ({ key, isOpen: isOpen(key) }));
}

// The weight of a key as a form of a word: equal, inflected (all but the last letters are the same), or begun.
function weighForm(key, word, isOpen) {
    let shared = 0;
    while (shared < word.length && word.charCodeAt(shared) === key.charCodeAt(shared)) {
        shared++;
    }
    const share = shared / Math.max(word.length, key.length);
    const isInflected = shared > 2 && word.length - shared < 4 && key.length - shared < 4 && share > 0.6;
    const isBegun = shared === word.length && (isOpen || shared > 2);
    return share === 1 ? 1 : Math.max(isInflected ? 0.8 * share : 0, isBegun ? (isOpen ? 0.5 : 0.3) + 0.3 * share : 0);
}

function findForms({ keys, near }, { key: word, isOpen }) {
    const alike = word.length > 1 ? near.get(word.slice(0, 2)) ?? [] : keys.filter((key) => key.startsWith(word));
    const forms = new Map(isUnspaced(word) ? keys.filter((key) => key.includes(word)).map((key) => [key, 0.8]) : []);
    for (const key of alike) {
        const weight = weighForm(key, word, isOpen);
        if (weight > (forms.get(key) ?? 0)) {
            forms.set(key, weight);
        }
    }
    return forms;
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
    const steps = word[i] === key[j + 1] && word[i + 1] === key[j] ? [[1, 1], [1, 0], [0, 1], [2, 2]] : [[1, 1], [1, 0], [0, 1]];
    return steps.some(([m, n]) => isNear(word, i + m, key, j + n, isOpen, edits - 1));
}

// The keys that a mistyped word can mean: by one edit from four letters on, two from eight on. An edit leaves the first
// two letters as they are, or those after the third. Of a word without spaces, the keys that hold half of its pairs.
function findMistyped({ keys }, { key: word, isOpen }) {
    const pairs = isUnspaced(word) ? Array.from(word.slice(1), (letter, i) => word[i] + letter) : [];
    const most = word.length < 4 ? 0 : word.length < 8 ? 1 : 2;
    const [start, middle] = [word.slice(0, 2), word.slice(3, 6)];
    const weigh = (key) => (0.3 * word.length / Math.max(word.length, key.length) + 0.7) *
        (!isNear(word, 0, key, 0, isOpen, most) ? 0 : isNear(word, 0, key, 0, isOpen, 1) ? 0.5 : 0.3);
    const near = pairs.length > 1 ? keys.map((key) => [key, pairs.filter((pair) => key.includes(pair)).length / pairs.length / 2])
        : keys.filter((key) => most > 0 && (key.startsWith(start) || key.includes(middle))).map((key) => [key, weigh(key)]);
    return near.filter(([, weight]) => weight >= 0.2);
}

// Raises the weights of units for a word, those of pages by the form alone.
function weighWord({ lookup: { listed, named, owners, lengths, unitOfText }, texts, words }, number, newForms) {
    const { units, pages, forms } = words[number];
    const raise = (unit, weight, field) => {
        units[unit] = Math.max(units[unit], weight * field);
        pages[owners[unit]] = Math.max(pages[owners[unit]], weight);
    };
    for (const [key, weight] of newForms) {
        forms.set(key, Math.max(weight, forms.get(key) ?? 0));
        for (const unit of named.get(key) ?? []) {
            raise(unit, weight, (owners[unit] === unit ? TITLE : HEADING) * (0.7 + 0.3 / lengths[unit]));
        }
        for (const text of listed.get(key) ?? []) {
            texts[text] |= 1 << number;
            raise(unitOfText[text], weight, TEXT);
        }
    }
}

// How many of a title's keys are those of the query, in its order: the longest common sequence, by weight of forms.
function countShared(keys, sequence, words) {
    let row = sequence.map(() => 0);
    for (const key of keys) {
        const next = [];
        sequence.forEach((word, i) => {
            next[i] = Math.max(row[i], next[i - 1] ?? 0, (row[i - 1] ?? 0) + (words[word].forms.get(key) ?? 0));
        });
        row = next;
    }
    return row.at(-1);
}

// How close a title is to the query: 4 if it is the query, 3 to 4 if it ends with it, 2 to 3 if it begins with it or
// holds it, else up to 2 for words in common.
function compareTitle({ lookup, words }, unit, { letters, ending, sequence, rarity, total }) {
    const title = lookup.titles[unit];
    const name = title.replace(/.\s*\(.*$/s, "");
    const own = lettersOf(title);
    const share = letters.length / own.length / 2;
    if (own === letters || lettersOf(name) === letters) {
        return 4;
    }
    if (` ${keysOf(name).join(" ")}`.endsWith(ending)) {
        return 3 + share;
    }
    if (own.includes(letters) && letters.length > 3) {
        return (own.startsWith(letters) ? 2.8 : 2.3) + share;
    }
    const isMeant = (key) => words.some(({ forms }) => forms.has(key));
    const keys = keysOf(title).filter((key) => isMeant(key) || !Object.hasOwn(lookup.common, key));
    const held = sum(rarity.filter((_, word) => keys.some((key) => words[word].forms.has(key)))) / total;
    const shared = countShared(keys, sequence, words);
    return 1.5 * shared / Math.max(1, keys.length) * held + 0.5 * shared / sequence.length;
}

// The pages that hold half of the rarity that any page holds. One that lacks words loses the more, the rarer they are. Of equal
// pages, those of the own module come first.
function scorePages(weighed, { rarity, rarest, total }, accepts) {
    const { lookup, lookup: { owners } } = weighed;
    const [units, pages, best, lost, held] = Array.from({ length: 5 }, () => new Float32Array(owners.length));
    weighed.words.forEach((word, number) => {
        for (let unit = 0; unit < owners.length; unit++) {
            const inPage = word.pages[owners[unit]];
            units[unit] += rarity[number] / total * Math.max(word.units[unit], inPage * ELSEWHERE);
            pages[unit] += rarity[number] / total * inPage * IN_PAGE;
            lost[unit] += rarity[number] / rarest * (inPage > 0 ? INEXACT * (1 - inPage) : LACKED);
            held[unit] += inPage > 0 ? rarity[number] / total : 0;
        }
    });
    units.forEach((score, unit) => { best[owners[unit]] = Math.max(best[owners[unit]], score); });
    const least = held.reduce((most, share) => Math.max(most, share), 0) / 2;
    const isFound = (page, unit) => page === unit && held[page] > 0 && held[page] >= least && accepts(lookup, page);
    weighed.scores = units;
    return Array.from(owners.filter(isFound), (page) => {
        const factor = Math.exp(-lost[page]);
        const score = (pages[page] + best[page]) * factor + (lookup.prefixes[page] === "" ? 1e-6 : 0);
        return { weighed, page, factor, score, isWhole: held[page] > 0.999 && !rarity.includes(0) };
    });
}

// Adds the best places to a result, and to their scores and its own how close the titles are to the query.
function compareTitles(result, query) {
    const { weighed, page } = result;
    const compare = (unit) => ({ unit, closeness: compareTitle(weighed, unit, query) });
    const isHolding = (unit) => unit !== page && weighed.words.some(({ units }) => units[unit] > 0);
    const best = weighed.lookup.places.get(page).filter(isHolding).sort((a, b) => weighed.scores[b] - weighed.scores[a]);
    const places = best.slice(0, PLACES_COMPARED).map(compare);
    places.forEach((place) => { place.score = weighed.scores[place.unit] + place.closeness; });
    const { closeness } = compare(page);
    const [first] = places.sort(byScore);
    const score = result.score + Math.max(closeness, HEADING * (first?.closeness ?? 0)) * result.factor;
    return { ...result, score, places, isPlaceMeant: first?.closeness >= Math.max(3, closeness) };
}

// What is known of a query once its words are weighed.
function describeQuery(text, words, weighed) {
    const keys = words.map(({ key }) => key);
    const countHeld = ({ pages }) => pages.filter((weight) => weight > 0).length;
    const pageCount = sum(weighed.map(({ lookup }) => lookup.pageCount));
    const held = words.map((_, i) => sum(weighed.map((each) => countHeld(each.words[i]))));
    const rarity = held.map((count) => (count > 0 ? Math.log(1 + pageCount / count) : 0));
    const sequence = keysOf(text).map((key) => keys.indexOf(key)).filter((number) => number >= 0);
    const isCommon = keys.every((key) => Object.hasOwn(weighed[0].lookup.common, key));
    return { keys, rarity, sequence, isCommon, total: sum(rarity), rarest: Math.log(1 + pageCount),
        letters: lettersOf(text), ending: ` ${keysOf(text).join(" ")}` };
}

// Returns the pages found in the lookups, best first, of those that the caller accepts; and the query for describePage.
function findPages(lookups, text, accepts = () => true) {
    const words = splitQuery(text, lookups[0].common);
    const weighed = lookups.map((lookup) => ({
        lookup,
        texts: new Uint32Array(lookup.unitOfText.length), // a bit for each word
        words: words.map(() => ({ forms: new Map(),
            units: new Float32Array(lookup.titles.length), pages: new Float32Array(lookup.titles.length) })),
    }));
    const find = (cache, findKeys) => {
        const search = ({ lookup }, word, name) => lookup[cache].get(name) ?? lookup[cache].set(name, findKeys(lookup, word)).get(name);
        weighed.forEach((each) => words.forEach((word, i) => weighWord(each, i, search(each, word, `${word.key}${word.isOpen ? "*" : ""}`))));
        const query = describeQuery(text, words, weighed);
        return { query, pages: weighed.flatMap((each) => scorePages(each, query, accepts)).sort(byScore) };
    };
    const exact = find("forms", findForms);
    const { query, pages } = exact.pages.some(({ isWhole }) => isWhole) ? exact : find("mistyped", findMistyped);
    const best = pages.slice(0, PAGES_COMPARED).map((result) => compareTitles(result, query)).sort(byScore);
    return { query, pages: [...best, ...pages.slice(PAGES_COMPARED)] };
}

// Cuts a text around the first word found and splits it. Every second piece is a word found.
function cutText(text, { words }, { keys }) {
    const runs = keys.filter(isUnspaced);
    const pattern = RegExp([...runs, `(?:(?!${UNSPACED})[\\p{L}\\p{M}\\p{N}_])+`, UNSPACED].join("|"), "giu");
    const isForm = (key) => runs.includes(key) || words.some(({ forms }) => forms.has(key));
    const isFound = (word) => [fold(word), ...partsOf(word)].some(isForm);
    const marked = text.replace(pattern, (word) => (isFound(word) ? `\0${word}\0` : word));
    const first = marked.indexOf("\0");
    const end = first > LEAD_LENGTH ? marked.slice(first - LEAD_LENGTH).replace(/^\S{0,40}\s/, "\u2026 ") : marked;
    return (end.length > TEXT_LENGTH ? end.slice(0, TEXT_LENGTH).replace(/\s\S{0,40}$/, " \u2026") : end).split("\0");
}

// What is shown of a result: a link, its title, the text that holds the most words, and the best places. The first
// place is meant if its title is the query or ends with it. A place without an address is led to by its heading.
function describePage(found, query) {
    const { weighed, page, places, isPlaceMeant } = found.places ? found : compareTitles(found, query);
    const { lookup: { titles, pages, textsOf, unitOfText, info }, texts } = weighed;
    const worth = (text) => (unitOfText[text] === places[0]?.unit ? 0.5 : 0) +
        sum(query.rarity.filter((_, number) => texts[text] & (1 << number)));
    const text = textsOf.get(page)?.reduce((a, b) => (worth(b) > worth(a) ? b : a));
    const linkTo = (unit) => ({ title: titles[unit],
        link: pages[unit]?.[0] ?? `${pages[page][0]}#:~:text=${encodeURIComponent(titles[unit]).replaceAll("-", "%2D")}` });
    const shown = places.filter(({ score }) => score > 0.6 * places[0].score).slice(0, PLACES_SHOWN);
    return { ...linkTo(page), isPlaceMeant, places: shown.map(({ unit }) => linkTo(unit)),
        pieces: cutText(info[text]?.[0] ?? "", weighed, query) };
}
