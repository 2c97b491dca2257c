// Tests the page script in a real browser: node pageScript.mjs PAGEMELD
//
// On the combined example modules and one more, whose names and pages are as awkward as they come; opened as files
// and over HTTP. Ends with status 1 at the first fault.
import assert from "node:assert/strict";
import { execFileSync, spawn } from "node:child_process";
import { once } from "node:events";
import { cpSync, existsSync, mkdirSync, mkdtempSync, rmSync, writeFileSync } from "node:fs";
import { tmpdir } from "node:os";
import path from "node:path";
import { fileURLToPath, pathToFileURL } from "node:url";
import { Page, program } from "./chromium.mjs";

if (!program) {
    console.log("SKIPPED, NOTHING TESTED: there is no chromium. Install it: script/setup");
    process.exit(0);
}
const root = mkdtempSync(path.join(tmpdir(), "pagemeld-site-"));
const tree = fileURLToPath(new URL("../..", import.meta.url));
const sea = "Größe der See/Manual";
const tag = '<script src="../../docdata/pagemeld.js" defer="defer"></script>';
const waves = Array.from({ length: 40 }, (_, i) => `waves/${i + 1}.html`);
const pages = {
    "far/off/hostile.html": `<!DOCTYPE html><p id="toc">${tag}<textarea></textarea><script>
        const info = 1, p0 = 2, pages = 3, common = 4; class Map {} class URL {}
        onkeydown = (event) => document.title !== "taken" || event.key !== "/";</script>`,
    "far/off/latin.html": Buffer.from(`<meta charset="iso-8859-1"><title>Gr\u00f6\u00dfe</title>${tag}`, "latin1"),
    "far/off/strict.xhtml": `<html xmlns="http://www.w3.org/1999/xhtml"><head>${tag}</head><body/></html>`,
    "far/off/based.html": `${tag}<base href="http://invalid.invalid/" target="_blank"><p>x`,
    "far/off/shared.html": '<script src="../../shared/pagemeld.js" defer data-docdata="../../docdata"></script><p>x',
    "far/off/policy.html": `<meta http-equiv="Content-Security-Policy" content="script-src 'self'">${tag}<p>x`,
    "far/off/frames.html": `${tag}<frameset><frame src="about:blank"></frameset>`,
    "../../favicon.ico": "", "50% of? all.html": "", "index.html": tag, ...Object.fromEntries(waves.map((name) => [name, ""])),
};
const leaf = (link, title, children = null) => ({ link, title, children });
const toc = leaf("index.html", "Brackwater Manual", [
    leaf("null", "Getting started", [leaf("far/off/latin.html#roll", "Roll"), leaf("far/off/latin.html", "Pitch")]),
    leaf("https://sea.invalid/?a#b", "Outside"), leaf("50% of? all.html#end", "Half"),
    leaf("far/off/hostile.html", "<img src=x onerror=alert(1)>", waves.map((name) => leaf(name, "")))]);
const index = {
    pages: [["far/off/hostile.html", "<img src=x onerror=alert(1)> \"pitch\""], ["far/off/latin.html", "Rolling"],
        ["50% of? all.html", "Roll"], ...waves.map((name) => [name, `Wave ${parseInt(name.slice(6))}`])],
    info: [["A <b>pitch</b>.", 0], ["Pitch, then roll: constructor.", 0], ["Rolling, pitching.", 1], ["Thesis.", 1]],
    common: {}, searchIndex: { pitch: [0, 1], roll: [1], rolling: [2], pitching: [2], thesis: [3], constructor: [1] },
};

function makeSite() {
    cpSync(path.join(tree, "examples"), root, { recursive: true });
    for (const [name, text] of Object.entries(pages)) {
        mkdirSync(path.dirname(path.join(root, sea, name)), { recursive: true });
        writeFileSync(path.join(root, sea, name), text);
    }
    const empty = { pages: [], info: [], common: {}, searchIndex: {} };
    for (const [set, json] of [["Manual", { index, toc }], ["ScriptReference", { index: empty, toc }]]) {
        const docdata = path.join(root, path.dirname(sea), set, "docdata");
        mkdirSync(docdata, { recursive: true });
        Object.keys(json).forEach((name) => writeFileSync(`${docdata}/${name}.json`, JSON.stringify(json[name])));
    }
    for (const folder of [`${sea}/shared`, `${sea}/docdata`, "charts/Manual/docdata", "telemetry/Manual/docdata"]) {
        cpSync(path.join(tree, "web"), path.join(root, folder), { recursive: true });
    }
    execFileSync(process.argv[2], ["-autopaths", root], { stdio: "ignore" });
    ["telemetry/Manual/docdata/global_index.js", "telemetry/Manual/docdata/global_toc.js"].forEach((name, i) =>
        i === 0 ? writeFileSync(path.join(root, name), "pages = [") : rmSync(path.join(root, name)));
}

const charts = "charts/Manual/index.html";
const far = `${sea}/far/off/`;
const image = '<img src=x onerror=alert(1)> "pitch"';
const status = "document.querySelector('#pagemeld [role=status]').textContent";
const box = "document.querySelector('#pagemeld input')";
const isReady = `document.querySelector("#pagemeld nav li") && ${box}.checkVisibility()`;
const focused = "document.activeElement.text || document.activeElement.localName";
const found = "Array.from(document.querySelectorAll('#pagemeld li:has(p) > a'), (link) => link.text).slice(0, 4)";

async function search(page, query) {
    await page.evaluate(`${box}.value = ""; ${box}.focus()`);
    await page.until(`${status} === "" || ${box}.form.length > 1`);
    await page.ask("Input.insertText", { text: query });
}

// Opens every level and shows every result: each link must then lead to a file, each control have a name, and
// nothing be left in the page or asked for outside the site.
async function checkWhole(page, base) {
    const openNext = "document.querySelector('#pagemeld [aria-expanded=false]')?.click() === undefined";
    await page.until(`${openNext} && !document.querySelector('#pagemeld [aria-expanded=false]')`);
    await search(page, "w");
    await page.evaluate("document.querySelector('#pagemeld ul + button').click()");
    const links = await page.evaluate("Array.from(document.querySelectorAll('#pagemeld a'), (link) => link.href)");
    const fileOf = (link) => path.join(root, decodeURIComponent(link.replace(/#.*/, "").slice(base.length)));
    const dead = links.filter((link) => !link.startsWith(base) || !existsSync(fileOf(link)));
    assert.deepEqual(dead, ["https://sea.invalid/?a#b"]);
    assert(links.length > 80 && links.includes(`${base}${encodeURI(sea)}/50%25%20of%3F%20all.html#end`));
    await page.ask("Accessibility.enable");
    const { nodes } = await page.ask("Accessibility.getFullAXTree");
    const isControl = ({ role }) => /^(button|link|searchbox|combobox|navigation)$/.test(role?.value);
    assert.deepEqual(nodes.filter((node) => isControl(node) && !node.name?.value), []);
    assert.equal(await page.evaluate("length + typeof searchIndex + typeof p3"), "0undefinedundefined");
    assert.deepEqual(page.requests.filter((url) => !url.startsWith(base)), []);
}

// Queries, what is said, and the titles of the first results.
const queries = [
    ["PITCH", "2 pages found", [image, "Rolling"]], // in the title, then elsewhere
    ["roll", "3 pages found", ["Roll", "Rolling", image]], // in the title whole, then its beginning
    ["pitching thes", "1 page found", ["Rolling"]], // in two texts, the last a prefix
    ["pit roll", "Nothing found", []], // only the last is a prefix
    ["the", "5 pages found", ['The "tide rose"', "Heights and their datum: Ærholm zero", "Rolling", "Units: °C, µS/cm and ‰"]],
    ["the roll", "3 pages found", ["Roll", "Rolling", image]], // common words are left out
    ["the a ", "Only common words, which are not searched for", []],
    ["wave", "40 pages found", ["Wave 1", "Wave 2", "Wave 3", "Wave 4"]],
    ["__proto__ hasOwnProperty", "Nothing found", []],
    ["roll constructor", "1 page found", [image]],
];

const rows = [
    ...[charts, ...["hostile.html", "latin.html", "strict.xhtml", "based.html", "shared.html", "policy.html"]
        .map((name) => far + name)].map((name) => [`all of ${name}`, name, checkWhole]),
    ["queries", charts, async (page) => {
        for (const [query, said, titles] of queries) {
            await search(page, query);
            assert.deepEqual([query, await page.evaluate(status), await page.evaluate(found)], [query, said, titles]);
        }
        assert.equal(await page.evaluate("document.querySelector('#pagemeld li:has(p)').innerText"),
            `${image} Größe der See\n\nPitch, then roll: constructor.`);
        assert.equal(await page.evaluate("Array.from(document.querySelectorAll('mark'), (m) => m.textContent).join()"),
            "roll,constructor");
    }],
    ["filter", charts, async (page) => {
        await search(page, "r");
        await page.evaluate(`const filter = ${box}.form[1]; filter.value = "charts";
            filter.dispatchEvent(new Event("change"))`);
        assert.deepEqual(await page.evaluate(found), ['The "tide rose"', "Charts", "Your first chart"]);
    }],
    ["address and Back", `${charts}?x`, async (page) => {
        await search(page, "pitching & thes");
        await page.press("Enter");
        await page.until("document.title === 'Größe'");
        await page.evaluate("history.back()");
        await page.until(`${found}[0] === "Rolling" && ${box}.value === "pitching & thes"`);
        assert.equal(await page.evaluate("location.search"), "?x&pagemeld=pitching%20%26%20thes");
    }],
    ["keys", `${far}hostile.html`, async (page) => {
        const [control, shift] = [2, 8];
        const steps = [ // what is done first, the key, where the focus is then
            ["document.title = 'taken'", ["/"], "body"], ["document.title = ''", ["/", control], "body"],
            ["document.querySelector('textarea').focus()", ["/"], "textarea"],
            ["document.activeElement.blur()", ["/", shift], "input"],
            [`${box}.value = "wav"; document.execCommand("insertText", false, "e")`, ["ArrowDown"], "Wave 1"],
            ["", ["ArrowDown"], "Wave 2"], ["", ["ArrowUp"], "Wave 1"], ["", ["Tab"], "Wave 2"], ["", ["Escape"], "input"],
        ];
        await page.evaluate(`${box}.focus()`);
        await page.until(`${box}.form.length > 1`);
        await page.evaluate(`${box}.blur()`);
        for (const [before, key, focus] of steps) {
            await page.evaluate(before);
            await page.press(...key);
            assert.equal(await page.evaluate(focused), focus, `${before} ${key}`);
        }
        await page.press("Escape");
        assert.equal(await page.evaluate(`${box}.value + document.querySelector("textarea").value + ${found}`), "/");
    }],
    ["contents", `${far}latin.html`, async (page) => {
        const shown = "document.querySelector('#pagemeld nav').innerText.split(/\\s*\\n\\s*/)";
        assert.deepEqual((await page.evaluate(shown)).slice(0, 5),
            ["Contents", "Brackwater Manual", "Getting started", "Roll", "Pitch"]);
        assert.equal(await page.evaluate("document.querySelector('#pagemeld [aria-current=page]').text"), "Pitch");
        assert(await page.evaluate("document.querySelectorAll('#pagemeld nav li').length < 20"), "closed levels");
        await page.evaluate("document.querySelector('#pagemeld nav button').click()");
        assert.deepEqual(await page.evaluate(shown), ["Contents"]);
    }],
    ["broken and missing outputs", "telemetry/Manual/index.html", async (page) => {
        await page.evaluate(`${box}.focus()`);
        await page.until(`${status} === "Search is not available: global_index.js did not run"`);
        await page.until("document.body.innerText.includes('Contents are not available: global_toc.js did not run')");
        page.errors = [];
    }, box],
    ["frame set", `${far}frames.html`, async (page) => {
        assert.equal(await page.evaluate("document.querySelector('#pagemeld, iframe, link')"), null);
    }, "document.readyState === 'complete'"],
    ["print", charts, async (page) => {
        await page.ask("Emulation.setEmulatedMedia", { media: "print" });
        assert.equal(await page.evaluate(`${box}.checkVisibility()`), false);
        await page.ask("Emulation.setEmulatedMedia", { media: "" });
    }],
];

makeSite();
const server = spawn("python3", ["-um", "http.server", "--bind", "127.0.0.1", "--directory", root, "0"]);
const page = await Page.open();
try {
    const [line] = await once(server.stdout, "data");
    for (const base of [`${pathToFileURL(root)}/`, /http:[^)]+/.exec(line)[0]]) {
        for (const [row, name, check, isShown = isReady] of rows) {
            try {
                await page.goto(base + encodeURI(name));
                await page.until(isShown);
                await check(page, base);
                assert.deepEqual(page.errors, []);
            } catch (fault) {
                throw new Error(`${row}, ${base}: ${page.errors}`, { cause: fault });
            }
        }
    }
    console.log(`${2 * rows.length} passed, 0 failed`);
} finally {
    await page.close();
    server.kill();
    rmSync(root, { recursive: true });
}
