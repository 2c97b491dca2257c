// A unit has a title: a page, a place in it (an entry with a fragment), or a text with a heading ("Heading – text").
// A key is a word or a part of one, without case and accents. Forms are the keys that a word of a query can mean.
"use strict";

const WORDS = /[\p{L}\p{M}\p{N}_]+/gu;
const PARTS = /\p{Lu}+(?!\p{Ll})|\p{Lu}?\p{Ll}+|\p{N}+/gu; // of "JsonParser" or "utf_8"
const HAS_PARTS = /\S\p{Lu}|[_\p{Lo}\p{Lm}\p{N}]/u;
const UNSPACED = /([\p{sc=Han}\p{sc=Hira}\p{scx=Kana}\p{sc=Hang}]{1,2})/u; // of words without spaces
const [TITLE, HEADING, TEXT] = [1, 0.7, 0.25]; // weights

const byScore = (a, b) => b.score - a.score;
const recall = (map, key, make) => map.get(key) ?? map.set(key, make()).get(key);
const push = (map, key, value) => { recall(map, key, () => []).push(value); };
const unaccent = (text) => text.normalize("NFD").replace(/[\u0300-\u036f]/g, "").replaceAll("ı", "i").normalize("NFC");
const fold = (text) => (/[^\0-\x7f]/.test(text) ? unaccent(text) : text).toLowerCase();
const wordsOf = (text) => fold(text).match(WORDS) ?? [];
const lettersOf = (text) => wordsOf(text).join("").replaceAll("_", "");
const keysOf = (text) => wordsOf(text).concat(HAS_PARTS.test(text) ? (text.match(PARTS) ?? []).map(fold) : []);
// The units and texts that have a key.
const useOf = ({ uses }, key) => recall(uses, key, () => ({ key, units: [], texts: [] }));

// Takes an index, and its prefixes, longest first. Yields now and then, and returns the lookup.
function* prepareIndex({ pages, info, common, searchIndex }, allPrefixes) {
    const lookup = {
        pages, info, common, prefixes: [], titles: [], owners: [], fields: [], // of units: the title's weight
        unitOfText: [], texts: new Map(), units: new Map(), // by unit, by page
        uses: new Map(), groups: new Map(), weighed: new Map(), // by key, by letters, by word
    };
    const owners = new Map();
    yield* each(pages, ([path, title]) => {
        const prefix = allPrefixes.find((start) => path.startsWith(start)) ?? "";
        const page = path.slice(0, `${path}#`.indexOf("#", prefix.length));
        lookup.prefixes.push(prefix);
        addUnit(lookup, title, recall(owners, page, () => lookup.titles.length));
    });
    yield* each(info, ([words, entry]) => addText(lookup, words, entry));
    yield* each(Object.keys(searchIndex), (term) => {
        const use = useOf(lookup, fold(term));
        use.texts = use.texts.length > 0 ? use.texts.concat(searchIndex[term]) : searchIndex[term];
    });
    return lookup;
}

function* each(list, act) {
    for (let i = 0; i < list.length; i += 500) {
        list.slice(i, i + 500).forEach((item) => act(item));
        yield;
    }
}

function addUnit(lookup, title, owner) {
    const unit = lookup.titles.push(title) - 1;
    const keys = new Set(keysOf(title));
    lookup.owners.push(owner);
    lookup.fields.push((owner === unit ? TITLE : HEADING) * (0.7 + 0.3 / keys.size));
    push(lookup.units, owner, unit);
    keys.forEach((key) => useOf(lookup, key).units.push(unit));
    return unit;
}

// A text of a page is a unit of its own if it has a heading.
function addText(lookup, words, entry) {
    const { titles, owners, unitOfText, texts } = lookup;
    const end = owners[entry] === entry ? words.indexOf(" \u2013 ") : -1;
    const heading = end < 0 ? titles[entry] : words.slice(0, end);
    const unit = heading === titles[entry] ? entry : addUnit(lookup, heading, entry);
    push(texts, unit, unitOfText.push(unit) - 1);
}

// Common words are left out unless there are no others. The last is open, to grow, while the query ends with it.
function splitQuery(text, common) {
    const all = [...new Set(wordsOf(text).flatMap((word) => word.split(UNSPACED)))].filter(Boolean);
    const rare = all.filter((key) => !Object.hasOwn(common, key));
    const canGrow = (rare.length > 0 || all.length === 1) && fold(text).endsWith(all.at(-1));
    return (rare.length > 0 ? rare : all).map((key) => ({ key, isOpen: canGrow && key === all.at(-1),
        stem: key.slice(0, Math.max(3, Math.ceil(0.7 * key.length))) }));
}

// Whether edits (a letter added, left out, replaced, or swapped) make a word a key, or its beginning.
function isNear(word, key, isOpen, edits, i = 0, j = 0) {
    while (i < word.length && word[i] === key[j]) {
        i++;
        j++;
    }
    if (edits === 0 || i === word.length) {
        return i === word.length && (isOpen || key.length - j <= edits);
    }
    const isAfter = (m, n) => isNear(word, key, isOpen, edits - 1, i + m, j + n);
    return isAfter(1, 1) || isAfter(1, 0) || isAfter(0, 1)
        || (word[i] === key[j + 1] && word[i + 1] === key[j] && isAfter(2, 2));
}

// How well a key is a form of a word: equal, begun, inflected, or mistyped.
function weighForm(key, { key: word, stem, isOpen }, isLenient) {
    const isMistyped = (edits) => isLenient && word.length >= 4 * edits && isNear(word, key, isOpen, edits);
    const share = Math.min(key.length / word.length, word.length / key.length);
    return key === word ? 1
        : key.startsWith(word) && (isOpen || word.length > 2) ? (isOpen ? 0.8 : 0.6)
        : share > 0.6 && key.startsWith(stem) ? 0.8 * share
        : isMistyped(1) ? 0.5
        : isMistyped(2) ? 0.3 : 0;
}

// A mistyped word is right at its beginning, or about its fourth letter.
function findCandidates({ uses, groups }, word, isLenient) {
    const isPart = UNSPACED.test(word);
    if (isPart || word.length === 1) {
        return [...uses.values()].filter(({ key }) => (isPart ? key.includes(word) : key.startsWith(word)));
    }
    const groupBy = (place) => {
        const group = new Map();
        uses.forEach((use) => push(group, use.key.slice(place, place + 2), use));
        return group;
    };
    const find = (place, start) => recall(groups, place, () => groupBy(place)).get(word.slice(start, start + 2)) ?? [];
    return isLenient ? find(0, 0).concat(find(3, 2), find(3, 3), find(3, 4)) : find(0, 0);
}

// Weighs units, and pages by the form alone. Nearly every text has a word that one or two letters begin.
function weighWord(lookup, word, isLenient) {
    const { owners, fields, unitOfText, units } = lookup;
    const [forms, scores, held] = [new Set(), new Float32Array(owners.length), new Float32Array(owners.length)];
    const isPart = UNSPACED.test(word.key);
    let count = 0;
    const raise = (unit, weight, field) => {
        count += held[owners[unit]] > 0 ? 0 : 1;
        scores[unit] = Math.max(scores[unit], weight * field);
        held[owners[unit]] = Math.max(held[owners[unit]], weight);
    };
    for (const use of findCandidates(lookup, word.key, isLenient)) {
        const weight = isPart ? 0.9 : weighForm(use.key, word, isLenient);
        if (weight > 0 && !forms.has(use.key)) {
            forms.add(use.key);
            use.units.forEach((unit) => raise(unit, weight, fields[unit]));
            for (const text of word.key.length > 2 || weight > 0.8 ? use.texts : []) {
                raise(unitOfText[text], weight, TEXT);
            }
        }
    }
    return { ...word, forms, scores, held, rarity: Math.log(1 + units.size / (1 + count)) };
}

// Returns 4 if the title is the query, 3 and more if it ends with it, 2.5 and more if it holds it.
function compareTitle({ words, letters }, title, score) {
    const own = lettersOf(title);
    const isEnd = own.endsWith(letters);
    if (isEnd || (letters.length > 3 && own.includes(letters))) {
        return own === letters ? 4 : (isEnd ? 3 : 2.5) + letters.length / own.length / 2;
    }
    const isMeant = (key) => words.some(({ forms }) => forms.has(key));
    return 2 * score * wordsOf(title).filter(isMeant).length / Math.max(1, wordsOf(title).length);
}

// Pages hold at least .4 as much of the query as any does; of equal ones the own module's come first.
function scorePages(asked, accepts) {
    const { words, lookup, lookup: { owners, units, prefixes } } = asked;
    const [scores, held, best] = [0, 0, 0].map(() => new Float32Array(owners.length));
    const whole = words.reduce((total, { rarity }) => total + rarity, 0);
    for (const word of words) {
        for (let unit = 0; unit < owners.length; unit++) {
            scores[unit] += word.rarity / whole * word.scores[unit];
            held[unit] += word.rarity / whole * word.held[unit];
        }
    }
    scores.forEach((score, unit) => { best[owners[unit]] = Math.max(best[owners[unit]], score); });
    const least = 0.4 * held.reduce((a, b) => Math.max(a, b), 0);
    const found = [...units.keys()].filter((page) => held[page] > least && accepts(lookup, page));
    return found.map((page) => {
        const factor = held[page] ** 3;
        const score = best[page] * factor + (prefixes[page] === "" ? 1e-6 : 0);
        return { asked, scores, page, factor, score, isWhole: words.every((word) => word.held[page] > 0) };
    });
}

// Adds the best places, and to the score how close titles are to the query.
function compareTitles(result) {
    const { asked, asked: { lookup }, scores, page, factor } = result;
    const compare = (unit) => compareTitle(asked, lookup.titles[unit], scores[unit]);
    const holding = lookup.units.get(page).filter((unit) => unit !== page && scores[unit] > 0);
    const best = holding.sort((a, b) => scores[b] - scores[a]).slice(0, 6);
    const places = best.map((unit) => ({ unit, score: scores[unit] + compare(unit) })).sort(byScore);
    const first = places.length > 0 ? compare(places[0].unit) : 0;
    const score = result.score + Math.max(compare(page), first < 2 ? 0 : HEADING * first) * factor;
    return { ...result, score, places, isPlaceMeant: first >= Math.max(3, compare(page)) };
}

// Returns the words searched for, and the pages found, best first.
function findPages(lookups, text, accepts) {
    const words = splitQuery(text, lookups[0].common);
    const find = (isLenient) => lookups.flatMap((lookup) => {
        const weigh = (word) => weighWord(lookup, word, isLenient);
        const weighOnce = (word) => recall(lookup.weighed, `${word.key} ${isLenient}`, () => weigh(word));
        const known = words.map((word) => (word.isOpen ? weigh(word) : weighOnce(word))); // the others do not grow
        return scorePages({ lookup, letters: lettersOf(text), words: known }, accepts);
    });
    lookups.filter(({ weighed }) => weighed.size > 9).forEach(({ weighed }) => weighed.clear());
    const exact = find(false);
    const pages = (exact.some(({ isWhole }) => isWhole) ? exact : find(true)).sort(byScore);
    return { words, pages: pages.slice(0, 60).map(compareTitles).sort(byScore).concat(pages.slice(60)) };
}

// Every second piece is a word found, or a part of one where words have no spaces between them.
function splitText(text, words) {
    const keys = RegExp(words.map(({ key }) => key).join("|"), "giu");
    const isFound = (word) => keysOf(word).some((key) => words.some(({ forms }) => forms.has(key)));
    const mark = (word) => (isFound(word) ? word.replace(UNSPACED.test(word) ? keys : word, "\0$&\0") : word);
    return text.replace(WORDS, mark).split("\0");
}

// What is shown of a result. A place without an address is linked by its heading.
function describePage(result) {
    const { asked: { words, lookup }, scores, page, places, isPlaceMeant } = compareTitles(result);
    const { titles, pages, units, texts, info } = lookup;
    const linkTo = (unit) => ({ title: titles[unit],
        link: pages[unit]?.[0] ?? `${pages[page][0]}#:~:text=${encodeURIComponent(titles[unit]).replaceAll("-", "%2D")}` });
    const best = units.get(page).filter((unit) => texts.has(unit)).reduce((a, b) => (scores[b] > scores[a] ? b : a), page);
    const pieces = (texts.get(best) ?? []).map((text) => splitText(info[text][0], words));
    return { ...linkTo(page), isPlaceMeant, places: places.slice(0, 3).map(({ unit }) => linkTo(unit)),
        pieces: pieces.reduce((a, b) => (b.length > a.length ? b : a), []) };
}
