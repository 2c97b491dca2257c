// Measures the page script in a real browser: node benchmarks/reader.mjs PAGEMELD [OTHER]
//
// PAGEMELD is the built program. OTHER is another page script to measure beside it, loaded after both outputs at the
// end of a page, with a search input of its own. Prints the table of docs/PERFORMANCE.md.
import { execFileSync } from "node:child_process";
import { cpSync, mkdirSync, mkdtempSync, readFileSync, rmSync, statSync, writeFileSync } from "node:fs";
import { tmpdir } from "node:os";
import path from "node:path";
import { fileURLToPath, pathToFileURL } from "node:url";
import { openPage } from "../tests/browser/browsers.mjs";

const [pagemeld, other] = process.argv.slice(2);
const web = fileURLToPath(new URL("../web", import.meta.url));
const root = mkdtempSync(path.join(tmpdir(), "pagemeld-reader-"));
const moduleCount = 4;
const rounds = 9;

let state = 1;
function random() { // the same numbers everywhere
    state = (Math.imul(state, 1664525) + 1013904223) >>> 0;
    return state / 2 ** 32;
}
const syllables = "ba ce di fo gu ha je ki lo mu na pe ri so tu va we xi yo zu an er in or un st".split(" ");
const count = (length, make) => Array.from({ length }, (_, i) => make(i));
const words = makeWords();
// The word of rank r comes 1 / r times as often as the first.
const drawWord = () => words[Math.floor(words.length ** random())];

function makeWords() {
    const made = new Set();
    while (made.size < 100000) {
        const length = 2 + Math.floor(random() * 3);
        made.add(count(length, () => syllables[Math.floor(random() * syllables.length)]).join(""));
    }
    return [...made];
}

// 100,000 terms in all modules and 20,000 pages, each of 5 texts of 27 words. The first 50 words are common.
function makeIndex(module) {
    const index = { pages: [], info: [], common: {}, searchIndex: {} };
    words.slice(0, 50).forEach((word) => { index.common[word] = 1; });
    for (let page = 0; page < 20000 / moduleCount; page++) {
        index.pages.push([`d${page % 40}/page${page}.html`, count(3, drawWord).join(" ")]);
        for (let i = 0; i < 5; i++) {
            const text = [words[(index.info.length * moduleCount + module) % words.length], ...count(26, drawWord)];
            const rare = new Set(text.filter((word) => !(word in index.common)));
            rare.forEach((word) => (index.searchIndex[word] ??= []).push(index.info.length));
            index.info.push([text.join(" "), page]);
        }
    }
    return index;
}

// 26,000 entries in all modules: in each one group of 1,000 pages, and 24 of 46 pages with 4 sections each.
function makeToc(module) {
    const node = (link, title, children = null) => ({ link, title, children });
    const section = (link) => (i) => node(`${link}#s${i}`, `Section ${i}`);
    const page = (group) => (i) => {
        const link = `d${group}/page${group + 40 * i}.html`;
        return node(link, `Page ${i}`, group === 0 ? null : count(4, section(link)));
    };
    const group = (i) => node("null", `Group ${module}.${i}`, count(i === 0 ? 1000 : 46, page(i)));
    return node("index.html", "Everything", count(25, group));
}

const scripts = { bare: "", page1: '<script src="../docdata/pagemeld.js" defer></script>' };
if (other) {
    scripts.other = ["docdata/global_toc.js", "docdata/global_index.js", "other.js"]
        .map((name) => `<script src="../${name}"></script>`).join("");
}

// Combines modules and lays pages without a script and with each into one of them.
function makeSite(name, makeIndex) {
    const directories = count(moduleCount, (module) => path.join(root, name, `module${module}`));
    directories.forEach((directory, module) => {
        mkdirSync(path.join(directory, "ScriptReference/docdata"), { recursive: true });
        mkdirSync(path.join(directory, "Manual/docdata"), { recursive: true });
        const write = (file, value) =>
            writeFileSync(path.join(directory, "Manual/docdata", file), JSON.stringify(value));
        write("index.json", makeIndex(module));
        write("toc.json", makeToc(module));
    });
    execFileSync(pagemeld, directories, { stdio: "ignore" });
    const set = path.join(directories[0], "Manual");
    cpSync(web, path.join(set, "docdata"), { recursive: true });
    other && cpSync(other, path.join(set, "other.js"));
    mkdirSync(path.join(set, "d1"));
    for (const [kind, tags] of Object.entries(scripts)) {
        const text = "<p>Some text of a page, as long as a line is.</p>\n".repeat(200);
        writeFileSync(path.join(set, `d1/${kind}.html`), `<!DOCTYPE html><meta charset="utf-8">${text}${tags}`);
    }
    return `${pathToFileURL(set)}/`;
}

const box = "document.querySelector('input[type=search]')";
const isShown = { bare: "document.body", page1: "document.querySelector('#pagemeld nav li')", other: box };
const loadTime = "performance.getEntriesByType('navigation')[0].loadEventEnd";
const elements = "document.querySelectorAll('*').length";
const median = (values, share = 0.5) => values.sort((a, b) => a - b)[Math.floor(values.length * share)];
const ms = (value) => (value === undefined ? "-" : `${value < 100 ? value.toFixed(1) : Math.round(value)} ms`);

// Runs code in the page and returns how long it takes until its effect is laid out.
const timed = (page, code) => page.evaluate(`(() => {
    const start = performance.now();
    ${code};
    document.body.getBoundingClientRect();
    return performance.now() - start;
})()`);

// When the page first shows its contents, in milliseconds since it was asked for.
const whenShown = (kind) => `new Promise((done) => {
    const check = () => ${isShown[kind]} && done(performance.now());
    new MutationObserver(check).observe(document, { childList: true, subtree: true });
    check();
})`;

// The bare page's times, and what each script adds to them. The page before is torn down beforehand.
async function measureLoading(page, base) {
    const times = Object.fromEntries(Object.keys(scripts).map((kind) => [kind, { load: [], shown: [] }]));
    for (let round = -1; round < rounds; round++) { // the first one warms up
        for (const [kind, { load, shown }] of Object.entries(times)) {
            await page.goto("about:blank");
            await chromium.send("HeapProfiler.collectGarbage");
            await page.goto(`${base}d1/${kind}.html`);
            round >= 0 && shown.push(await page.evaluate(whenShown(kind)));
            round >= 0 && load.push(await page.evaluate(loadTime));
        }
    }
    const bare = median(times.bare.load);
    return Object.fromEntries(Object.entries(times).map(([kind, { load, shown }]) =>
        [kind, { bare, load: median(load) - bare, shown: median(shown) - bare }]));
}

async function measureOpening(page, base) {
    const times = [];
    for (let round = 0; round < rounds; round++) {
        await page.goto(`${base}d1/page1.html`);
        await page.until(isShown.page1);
        times.push(await timed(page, "document.querySelector('#pagemeld li > button').click()"));
    }
    return median(times);
}

// From focus, with a word in the box already; and what the browser alone needs for the index script in a page.
async function measureFirstResults(page, base) {
    const [times, alone] = [[], []];
    for (let round = 0; round < rounds; round++) {
        await page.goto(`${base}d1/bare.html`);
        alone.push(await page.evaluate(`new Promise((done) => {
            const start = performance.now(), script = document.createElement("script");
            script.onload = () => done(performance.now() - start);
            script.src = "../docdata/global_index.js";
            document.head.append(script);
        })`));
        await page.goto(`${base}d1/page1.html`);
        await page.until(isShown.page1);
        times.push(await page.evaluate(`new Promise((done) => {
            const start = performance.now(), results = document.querySelector("#pagemeld ul");
            new MutationObserver(() => results.firstChild &&
                done(results.getBoundingClientRect() && performance.now() - start)).observe(results, { childList: true });
            ${box}.value = "${words[200]}";
            ${box}.focus();
        })`));
    }
    return { first: median(times), alone: median(alone) };
}

// Types 60 pairs of words, letter for letter.
async function measureKeystrokes(page) {
    const times = [];
    for (let i = 0; i < 60; i++) {
        const query = `${words[50 + i * i]} ${words[60 + i]}`;
        for (let length = 1; length <= query.length; length++) {
            const typed = query.slice(0, length);
            times.push(await timed(page, `${box}.value = "${typed}"; ${box}.dispatchEvent(new Event("input"))`));
        }
    }
    return `${ms(median(times))} / ${ms(median(times, 0.95))}`;
}

async function measure(page) {
    const empty = { pages: [], info: [], common: {}, searchIndex: {} };
    const contents = makeSite("contents", () => empty);
    const whole = makeSite("whole", makeIndex);
    const { page1, other: old } = await measureLoading(page, contents);
    const seen = {};
    for (const kind of Object.keys(scripts)) {
        await page.goto(`${contents}d1/${kind}.html`);
        await page.until(isShown[kind]);
        seen[kind] = await page.evaluate(elements);
    }
    const opening = await measureOpening(page, contents);
    const { first, alone } = await measureFirstResults(page, whole);
    const keystrokes = await measureKeystrokes(page);
    let oldFirst, oldKeystrokes = "-";
    if (old) {
        await page.goto(`${whole}d1/other.html`);
        oldFirst = await page.evaluate(loadTime);
        oldKeystrokes = await measureKeystrokes(page);
    }
    const size = ["pagemeld.js", "pagemeld.css"].reduce((sum, name) => sum + statSync(path.join(web, name)).size, 0);
    const script = statSync(fileURLToPath(`${whole}docdata/global_index.js`)).size;
    const model = /^model name\s*: (.*)/m.exec(readFileSync("/proc/cpuinfo", "utf8"))?.[1];
    console.log(`${model}; ${(await chromium.send("Browser.getVersion")).product}; medians of ${rounds} rounds; ` +
        `index script ${(script / 1e6).toFixed(1)} MB`);
    const rows = [
        [`page load over the bare page's ${ms(page1.bare)}`, "at most 50 ms", ms(page1.load), ms(old?.load)],
        ["contents shown, over the same", "-", ms(page1.shown), ms(old?.shown)],
        ["elements before the reader acts, 146 entries", "at most 644", seen.page1 - seen.bare,
            old ? seen.other - seen.bare : "-"],
        ["opening a level of 1,000 entries", "at most 100 ms", ms(opening), "-"],
        ["first results after focus", "at most 800 ms", ms(first), `with the page: ${ms(oldFirst)}`],
        ["of it, the index script alone", "-", ms(alone), "-"],
        ["a keystroke, median / 95th percentile", "at most 10 / 30 ms", keystrokes, oldKeystrokes],
        ["size of the files", "at most 20 KB", `${size} bytes`, other ? `${statSync(other).size} bytes` : "-"],
    ];
    rows.forEach((row) => console.log(`| ${row.join(" | ")} |`));
}

const page = await openPage("chromium");
const chromium = await page.tab.createCDPSession();
try {
    await page.resize(1280, 800);
    await measure(page);
} finally {
    await page.close();
    rmSync(root, { recursive: true });
}
