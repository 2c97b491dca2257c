// Measures the page script in Chromium: node benchmarks/reader.mjs PAGEMELD
//
// PAGEMELD is the built program. Prints the table of docs/PERFORMANCE.md. Needs "npm ci --prefix tests/browser".
import { execFileSync } from "node:child_process";
import { cpSync, mkdirSync, mkdtempSync, readFileSync, readdirSync, rmSync, statSync, writeFileSync } from "node:fs";
import { tmpdir } from "node:os";
import path from "node:path";
import { fileURLToPath, pathToFileURL } from "node:url";
import { gzipSync } from "node:zlib";
import { openPage } from "../tests/browser/browsers.mjs";

const [pagemeld] = process.argv.slice(2);
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

// Combines modules and lays into the first a page without the script, one with an empty script of its size, one with it,
// and one with a place for it.
function makeSite() {
    const directories = count(moduleCount, (module) => path.join(root, `module${module}`));
    directories.forEach((directory, module) => {
        const docdata = path.join(directory, "Manual/docdata");
        mkdirSync(docdata, { recursive: true });
        writeFileSync(path.join(docdata, "index.json"), JSON.stringify(makeIndex(module)));
        const toc = { link: "index.html", title: "Everything", children: [] };
        writeFileSync(path.join(docdata, "toc.json"), JSON.stringify(toc));
    });
    execFileSync(pagemeld, directories, { stdio: "ignore" });
    const set = path.join(directories[0], "Manual");
    cpSync(web, path.join(set, "docdata"), { recursive: true });
    writeFileSync(path.join(set, "empty.js"), " ".repeat(statSync(path.join(web, "pagemeld.js")).size));
    const tag = '<script src="docdata/pagemeld.js" data-sets="Manual" defer></script>';
    const text = "<p>Some text of a page, as long as a line is.</p>\n".repeat(200);
    const empty = '<script src="empty.js" defer></script>';
    const place = `${tag}<div id="pagemeld"></div>`;
    for (const [name, head] of Object.entries({ bare: "", empty, button: tag, place })) {
        writeFileSync(path.join(set, `${name}.html`), `<!DOCTYPE html><meta charset="utf-8">${head}${text}`);
    }
    return `${pathToFileURL(set)}/`;
}

const box = 'document.querySelector("#pagemeld input[type=search]")';
const median = (values, share = 0.5) => values.toSorted((a, b) => a - b)[Math.floor(values.length * share)];
const ms = (value) => `${value < 100 ? value.toFixed(1) : Math.round(value)} ms`;

// What a script that does nothing adds to the time until a page is loaded, and what this one adds: medians of pairs.
async function measureLoading(page, base) {
    const times = { bare: [], empty: [], button: [] };
    for (let round = -1; round < 5 * rounds; round++) { // the first one warms up
        for (const [kind, list] of Object.entries(times)) {
            await page.goto(`${base}${kind}.html`);
            const time = await page.evaluate("performance.getEntriesByType('navigation')[0].loadEventEnd");
            if (round >= 0) {
                list.push(time);
            }
        }
    }
    const over = (list) => median(list.map((time, i) => time - times.bare[i]));
    return [over(times.empty), over(times.button)];
}

// From focus, with a word in the box already; the index script alone, in a bare page; and the longest other task.
async function measureFirstResults(page, base) {
    const [times, alone, tasks] = [[], [], []];
    for (let round = 0; round < rounds; round++) {
        await page.goto(`${base}bare.html`);
        alone.push(await page.evaluate(`new Promise((done) => {
            const start = performance.now(), script = document.createElement("script");
            script.onload = () => done(performance.now() - start);
            script.src = "docdata/global_index.js";
            document.head.append(script);
        })`));
        await page.goto(`${base}place.html`);
        await page.until(box);
        const [time, others] = await page.evaluate(`new Promise((done) => {
            const start = performance.now(), results = document.querySelector(".pagemeld-results"), long = [];
            new PerformanceObserver((list) => long.push(...list.getEntries().map(({ duration }) => duration)))
                .observe({ entryTypes: ["longtask"] });
            new MutationObserver(() => {
                const time = results.getBoundingClientRect() && performance.now() - start;
                setTimeout(() => done([time, long.sort((a, b) => b - a).slice(1)]), 500);
            }).observe(results, { childList: true });
            ${box}.value = "${words[200]}";
            ${box}.focus();
        })`);
        times.push(time);
        tasks.push(Math.max(0, ...others));
    }
    return { first: median(times), alone: median(alone), task: median(tasks) };
}

// Types 60 pairs of words letter by letter, one of the words of every second pair mistyped. A keystroke lasts until the
// results are laid out.
async function measureKeystrokes(page) {
    const times = [];
    for (let i = 0; i < 60; i++) {
        const first = words[50 + i * i];
        const mistyped = i % 2 === 0 ? first : first[0] + first[2] + first[1] + first.slice(3);
        const query = `${mistyped} ${words[60 + i]}`;
        for (let length = 1; length <= query.length; length++) {
            times.push(await page.evaluate(`(() => {
                const start = performance.now();
                ${box}.value = "${query.slice(0, length)}";
                ${box}.dispatchEvent(new Event("input"));
                document.body.getBoundingClientRect();
                return performance.now() - start;
            })()`));
        }
    }
    return `${ms(median(times))} / ${ms(median(times, 0.95))}`;
}

function measureSizes() {
    const files = readdirSync(web).map((name) => readFileSync(path.join(web, name)));
    const size = files.reduce((sum, { length }) => sum + length, 0);
    return `${size} / ${files.reduce((sum, file) => sum + gzipSync(file).length, 0)} bytes`;
}

async function measure(page) {
    const base = makeSite();
    await page.resize(1280, 800);
    const [empty, load] = await measureLoading(page, base);
    const { first, alone, task } = await measureFirstResults(page, base);
    const rows = [
        ["page load over the bare page's", "at most 10 ms", ms(load)],
        ["the same with an empty script of that size", "-", ms(empty)],
        ["first results after focus", "at most 800 ms", ms(first)],
        ["of it, the index script alone", "-", ms(alone)],
        ["the longest other task", "at most 100 ms", ms(task)],
        ["a keystroke, median / 95th percentile", "at most 8 / 25 ms", await measureKeystrokes(page)],
        ["size of the files / with gzip", "at most 34 / 11 KiB", measureSizes()],
    ];
    const script = statSync(fileURLToPath(`${base}docdata/global_index.js`)).size;
    const model = /^model name\s*: (.*)/m.exec(readFileSync("/proc/cpuinfo", "utf8"))?.[1];
    const browser = await page.evaluate("navigator.userAgent.match(/Chrom\\S+/)[0]");
    console.log(`${model}; ${browser}; medians of ${rounds} rounds; index script ${(script / 1e6).toFixed(1)} MB`);
    rows.forEach((row) => console.log(`| ${row.join(" | ")} |`));
}

const page = await openPage("chromium");
try {
    await measure(page);
} finally {
    await page.close();
    rmSync(root, { recursive: true });
}
