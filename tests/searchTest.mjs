// Tests the search of the page script without a page: node tests/searchTest.mjs
import assert from "node:assert/strict";
import fs from "node:fs";
import vm from "node:vm";

const search = vm.createContext({});
vm.runInContext(fs.readFileSync(new URL("../web/pagemeld-search.js", import.meta.url), "utf8"), search);

// An index as the tool writes it, with the terms that its texts and titles have.
function makeLookup(pages, texts, common = "the a by how to ye zo") {
    const searchIndex = Object.create(null);
    texts.forEach(([text, page], number) => {
        for (const term of new Set(`${text} ${pages[page][1]}`.toLowerCase().match(/[\p{L}\p{M}\p{N}_]+/gu))) {
            (searchIndex[term] ??= []).push(number);
        }
    });
    const commonWords = Object.fromEntries(common.split(" ").map((word) => [word, 1]));
    const index = { pages, info: texts, common: commonWords, searchIndex: { ...searchIndex } };
    const steps = search.prepareIndex(index, ["../../sea/Manual/"]);
    let step = steps.next();
    while (!step.done) {
        step = steps.next();
    }
    return step.value;
}

const entries = [
    ["json.html", "JsonParser", "Reads a stream of tokens. How to use it: pass a reader, then get the next value."],
    ["json.html#close", "JsonParser.close", "JsonParser.close() \u2013 Ends the reading of the underlying stream."],
    ["queue.html", "queue \u2014 A synchronized queue", "Useful in threaded programming when data are exchanged safely."],
    ["queue.html#put", "Queue.put", "Queue.put(item) \u2013 Put an item into the queue, to be taken by the consumer."],
    ["queue.html#get_nowait", "Queue.get_nowait", "Queue.get_nowait() \u2013 Equivalent to get(False)."],
    ["queue.html", "queue \u2014 A synchronized queue", "Waiting for consumers \u2013 Blocks until all items have been processed."],
    ["string.html", "String", "A sequence of letters."],
    ["buffer.html", "StringBufferInputStream", "The next letter of a String."],
    ["migrate.html", "Schema changes", "Tables follow the classes."],
    ["migrate.html#files", "Migration files", "Kept on disk. Repair happens by hand."],
    ["group.html", "Grouping rows", "Rows are grouped by a column, and counted."],
    ["theory.html", "Theory of harmony", "Intervals, and how the ear hears them. A consumer is not mentioned."],
    ["c.html", "C", "A language."], ["cplus.html", "Classes", "More than c."],
    ["cafe.html", "Cr\u00e8me br\u00fbl\u00e9e", "Sugar."], ["city.html", "\u0130stanbul ve I\u011fd\u0131r, k\u0131\u015f", "\u015eehir."], ["zone.html", "Zones", "Of time."],
    ["zh.html", "\u5168\u6587\u641c\u7d22\u5f15\u64ce", "\u5b89\u88c5\u7a0b\u5e8f\u7684\u6b65\u9aa4\u3002"],
    ["ja.html", "\u30b5\u30fc\u30d0\u30fcqt\u6587\u66f8\u306e\u691c\u7d22\u65b9\u6cd5", "\u30d7\u30ed\u30b0\u30e9\u30e0\u3092\u8d77\u52d5\u3057\u307e\u3059\u3002"],
    ["ko.html", "\uc804\uc790\ubb38\uc11c\ub97c \uc77d\uae30", "\ud504\ub85c\uadf8\ub7a8\uc744 \uc2dc\uc791\ud569\ub2c8\ub2e4."],
    ["../../sea/Manual/tide.html", "Tide tables", "Rise and fall."], ["tide.html", "Tide tables", "Rise and fall."],
    ["odd.html", "__proto__", "hasOwnProperty and constructor."],
];
const pages = entries.map(([path, title]) => [path, title]).filter(([path], i, all) => all.findIndex(([other]) => other === path) === i);
const lookup = makeLookup(pages, entries.map(([path, , text]) => [text, pages.findIndex(([other]) => other === path)]));
const find = (query, accepts = () => true) => search.findPages([lookup], query, accepts);
const describe = ({ pages }) => Array.from(pages, (page) => search.describePage(page));
const links = (query) => describe(find(query)).map(({ link }) => link);

// Kind, query, the page that comes first, and its first place if that matters.
const rows = [
    ["title", "String", "string.html"],
    ["title of two modules, the own one first", "tide tables", "tide.html"],
    ["growing", "Theory of har", "theory.html"],
    ["typo", "StringBuferInputStream", "buffer.html"],
    ["one edit in four letters", "tdie", "tide.html"], ["two in eight", "cosnmuer", "queue.html"],
    ["typing", "Theory of hramo", "theory.html"],
    ["first", "Zchema changes", "migrate.html"],
    ["parts", "json parser", "json.html"],
    ["inflected, to the plural", "schemas change", "migrate.html"],
    ["inflected, to the singular", "tide table", "tide.html"],
    ["short", "theo harm", "theory.html"],
    ["wordy", "how to use JsonParser", "json.html"],
    ["member", "get_nowait", "queue.html", "queue.html#get_nowait"],
    ["section", "migration files", "migrate.html", "migrate.html#files"],
    ["section without an address", "waiting for consumers", "queue.html", "queue.html#:~:text=Waiting%20for%20consumers"],
    ["body", "repair disk hand", "migrate.html", "migrate.html#files"],
    ["a common last word that does not grow", "group by", "group.html"],
    ["a common word that is all of the query", "the", "theory.html"],
    ["a whole word after which something is typed", "c++", "c.html"],
    ["without accents", "creme brulee", "cafe.html"],
    ["with an accent of its own", "bru\u0302le\u0301e", "cafe.html"],
    ["Turkish, dotted", "istanbul", "city.html"], ["Turkish, dotless, too short for an edit", "kis", "city.html"],
    ["Chinese, in a run", "\u641c\u7d22", "zh.html"], ["Chinese, in two runs", "\u5b89\u88c5\u6b65\u9aa4", "zh.html"],
    ["Japanese", "\u691c\u7d22", "ja.html"], ["Japanese, in a text", "\u8d77\u52d5", "ja.html"],
    ["Latin letters in a run", "qt", "ja.html"],
    ["Korean", "\ubb38\uc11c", "ko.html"],
    ["names of every object", "__proto__", "odd.html"], ["names of every object", "constructor", "odd.html"],
];
for (const [kind, query, page, place] of rows) {
    const [first] = describe(find(query));
    assert.equal(first?.link, page, `${kind}: ${query}`);
    if (place) {
        assert.equal(first.places[0]?.link, place, `the place of ${kind}: ${query}`);
    }
    const letters = [...query];
    const grown = letters.map((_, i) => find(letters.slice(0, i + 1).join(""))).at(-1);
    const other = makeLookup(pages, lookup.info);
    assert.deepEqual(describe(grown), describe(search.findPages([other], query, () => true)), `letter by letter: ${query}`);
}

const first = (query) => describe(find(query))[0];
assert.equal(first("get_nowait").isPlaceMeant, true, "Enter opens the member");
assert.equal(first("String").isPlaceMeant, false, "Enter opens the page");
assert.deepEqual(Array.from(first("tide rising").pieces), ["Rise and fall."], "no form of a word, no mark");
assert.deepEqual(Array.from(first("sequences letter").pieces), ["A ", "sequence", " of ", "letters", "."], "marked forms");
assert.deepEqual(Array.from(first("\u641c\u7d22\u5b89\u88c5 \u6b65\u9aa4").pieces).includes("\u6b65\u9aa4"), true, "a mark in a run");
for (const query of ["qqqqqq", "", "+++", "gte", "gorupde"]) { // edits in three letters, two in seven
    assert.equal(find(query).pages.length, 0, `nothing found: ${query}`);
}
assert.deepEqual(links("tide zebra").slice(0, 2), ["tide.html", "../../sea/Manual/tide.html"], "most words, not all");
assert.deepEqual(links("ye zo"), [], "several common words don't grow");
assert.equal(find("tide zebra").pages[0].isWhole, false);
assert.equal(find("\u30b5\u30fc\u30d0\u30fc").pages[0].isWhole, true, "a long vowel is part of a run");
assert.deepEqual(links("zebra tide"), links("tide zebra"));
const accepted = find("tide", ({ prefixes }, page) => prefixes[page] !== "");
assert.deepEqual(describe(accepted).map(({ link }) => link), ["../../sea/Manual/tide.html"], "those that are accepted");

const other = makeLookup([["a.html", "Tide gauge"]], [["Reads the tide.", 0]]);
const joined = search.findPages([lookup, other], "tide gauge", () => true);
assert.deepEqual(describe(joined).map(({ link }) => link).slice(0, 2), ["a.html", "tide.html"], "two sets");
