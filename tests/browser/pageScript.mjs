// Tests the page script in a real browser, as files and over HTTP: node tests/browser/pageScript.mjs PAGEMELD
// On the example modules and one more, whose names and pages are awkward. Ends with status 1 at the first fault.
import assert from "node:assert/strict";
import { execFileSync, spawn } from "node:child_process";
import fs from "node:fs";
import { tmpdir } from "node:os";
import path from "node:path";
import { Page } from "./chromium.mjs";

const root = fs.mkdtempSync(path.join(tmpdir(), "pagemeld-site-"));
const sea = "Größe #1/Manual";
const tag = '<script src="../../docdata/pagemeld.js" defer="defer"></script>';
const image = "<img src=x onerror=alert(1)> \"pitch\"";
const waves = Array.from({ length: 40 }, (_, i) => `waves/${i + 1}.html`);
const node = (link, title, children = null) => ({ link, title, children });
const toc = node("index.html", "Brackwater Manual", [
    node("null", "Getting started", [node("far/off/latin.html#roll", "Roll"), node("far/off/latin.html", "Größe")]),
    node("https://sea.invalid/?a#b", "Outside"), node("https://[/latin.html", "Broken"),
    node("50% of? all.html#end", "Half"), node("far/off/hostile.html", image, waves.map((wave) => node(wave, "")))]);
const index = {
    common: {}, searchIndex: { pitch: [0, 1], roll: [1], rolling: [2], pitching: [2], thesis: [3], constructor: [1] },
    info: [["A <b>pitch</b>.", 0], ["Pitch, then roll: constructor.", 0], ["Rolling, pitching.", 1], ["Thesis.", 1]],
    pages: [["far/off/hostile.html", image], ["far/off/latin.html", "Rolling"], ["50% of? all.html", "Roll"],
        ...waves.map((wave, i) => [wave, `Wave ${i + 1}`])],
};
const pages = {
    "far/off/hostile.html": `<!DOCTYPE html><html dir="rtl"><style>div, input { display: none }</style>
        <p id="toc">${tag}<textarea></textarea><script>const info = 1, p0 = 2, pages = 3, common = 4; class Set {}
        var URL, Map = "Map"; onkeydown = (event) => document.title !== "taken" || event.key !== "/";</script>`,
    "far/off/latin.html": Buffer.from(`<meta charset="iso-8859-1"><title>Gr\u00f6\u00dfe</title>${tag}`, "latin1"),
    "far/off/strict.xhtml": `<html xmlns="http://www.w3.org/1999/xhtml"><head>${tag}</head><body/></html>`,
    "far/off/based.html": `${tag}<base href="http://invalid.invalid/" target="_blank"><p>x`,
    "far/off/shared.html": '<script src="../../shared/pagemeld.js" defer data-docdata="../../docdata"></script><p>x',
    "far/off/policy.html": `<meta http-equiv="Content-Security-Policy" content="script-src 'self'">${tag}<p>x`,
    "far/off/frames.html": `${tag}<frameset><frame src="about:blank"></frameset>`,
    "docdata/index.json": JSON.stringify(index), "docdata/toc.json": JSON.stringify(toc), "../../favicon.ico": "",
    "../ScriptReference/docdata/index.json": "", "50% of? all.html": "", ...Object.fromEntries(waves.map((wave) => [wave, ""])),
};

fs.cpSync("examples", root, { recursive: true });
const modules = ["acquire", "charts", "logbook"].flatMap((name) => [`${name}/Manual`, `${name}/ScriptReference`]);
const producer = path.resolve("Tools/DocTools/PagemeldDocdata/pagemeld-docdata");
execFileSync(producer, ["--toc", "index.html", "--share", "Getting started", "--root-title", toc.title, ...modules],
    { cwd: root, stdio: "ignore" });
for (const [name, text] of Object.entries(pages)) {
    fs.mkdirSync(path.dirname(path.join(root, sea, name)), { recursive: true });
    fs.writeFileSync(path.join(root, sea, name), text);
}
[`${sea}/shared`, `${sea}/docdata`, "charts/Manual/docdata", "telemetry/Manual/docdata"].forEach((directory) =>
    fs.cpSync("web", path.join(root, directory), { recursive: true }));
execFileSync(process.argv[2], ["-autopaths", root], { stdio: "ignore" });
fs.writeFileSync(path.join(root, "telemetry/Manual/docdata/global_index.js"), "pages = [");
fs.rmSync(path.join(root, "telemetry/Manual/docdata/global_toc.js"));
const page = await Page.open();
const $ = (selector) => `document.querySelector("#pagemeld ${selector}")`;
const all = (selector, what) => `Array.from(document.querySelectorAll("#pagemeld ${selector}"), (e) => e.${what})`;
const status = `${$("[role=status]")}.textContent`;
const found = `${all("li:has(p) > a", "text")}.slice(0, 4)`;
const toUrl = (name) => encodeURI(name).replace("#", "%23");
const expect = async (code, value) => assert.deepEqual(await page.evaluate(code), value);

async function search(query, module = "") {
    await page.until(`${$("input")}.focus() ?? ${$("select")}`);
    await page.evaluate(`${$("input")}.value = ""; ${$("select")}.value = "${module}"`);
    await page.ask("Input.insertText", { text: query });
}

// Opens every level and shows every result: all links lead to files, all controls have names, nothing is left over.
async function checkWhole(base) {
    await page.until(`${$("[aria-expanded=false]")}?.click() ?? !${$("[aria-expanded=false]")}`);
    await search("w");
    const links = await page.evaluate(`${$("ul + button")}.click(); ${all("a", "href")}`);
    const fileOf = (link) => path.join(root, decodeURIComponent(link.replace(/#.*/, "").slice(base.length)));
    const dead = links.filter((link) => !link.startsWith(base) || !fs.existsSync(fileOf(link)));
    assert.deepEqual(dead, ["https://sea.invalid/?a#b", "https://[/latin.html"]);
    assert(links.length > 80 && links.includes(`${base}${toUrl(sea)}/50%25%20of%3F%20all.html#end`));
    const { nodes } = await page.ask("Accessibility.getFullAXTree");
    const controls = nodes.filter(({ role }) => /^(button|link|searchbox|combobox|navigation)$/.test(role?.value));
    assert(controls.length > 80 && controls.every(({ name }) => name.value));
    await expect(`length + typeof searchIndex + typeof p3 + ${$("a:not([target=_self])")}`, "0undefinedundefinednull");
    assert.deepEqual(page.requests.filter((url) => !url.startsWith(base)), []);
}

const queries = [ // what is searched for, what is said, the titles of the first results, the module chosen
    ["PITCH", "2 pages found", [image, "Rolling"]], // in the title, then elsewhere
    ["roll", "3 pages found", ["Roll", "Rolling", image]], // whole in the title, as a prefix there, elsewhere
    ["pitching thes", "1 page found", ["Rolling"]], // in two texts, the last a prefix
    ["__proto__ hasOwnProperty", "Nothing found", []], ["pit roll", "Nothing found", []], // only the last is a prefix
    ["the", "1 page found", ["Rolling"], "Größe #1"], // a common word that may become "thesis"; of one module
    ["wave the", "40 pages found", ["Wave 1", "Wave 2", "Wave 3", "Wave 4"]], // and one that is left out
    ["r", "3 pages found", ["The \"tide rose\"", "Charts", "Your first chart"], "charts"],
    ["the a ", "Only common words, which are not searched for", []], ["roll constructor", "1 page found", [image]],
];
const keys = [ // what is done first, the key and its modifiers, where the focus is then
    ["document.activeElement.blur(); document.title = 'taken'", ["/"], "body"], ["document.title = ''", ["/", 2], "body"],
    ["document.querySelector('textarea').focus()", ["/"], "textarea"],
    ["document.activeElement.blur()", ["/", 8], "input"],
    ["document.execCommand('insertText', 0, 'wave')", ["ArrowDown"], "Wave 1"], ["", ["ArrowDown"], "Wave 2"],
    ["", ["ArrowUp"], "Wave 1"], ["", ["Tab"], "Wave 2"], ["", ["Escape"], "input"], ["", ["Escape"], "input"],
];
const rows = { // by the page, and what else tells them apart
    ...Object.fromEntries(["hostile.html", "latin.html", "strict.xhtml", "based.html", "shared.html", "policy.html"]
        .map((name) => [`${sea}/far/off/${name}`, checkWhole])), "charts/Manual/index.html": checkWhole,
    "charts/Manual/index.html?queries": async () => {
        for (const [query, said, titles, module] of queries) {
            await search(query, module);
            await expect(`["${query}", ${status}, ${found}]`, [query, said, titles]);
        }
        await expect(`${$("li:has(p)")}.innerText`, `${image} Größe #1\n\nPitch, then roll: constructor.`);
        await expect(all("mark", "textContent"), ["roll", "constructor"]);
        await page.ask("Emulation.setEmulatedMedia", { media: "print" });
        await expect(`${$("input")}.checkVisibility()`, false);
        await page.ask("Emulation.setEmulatedMedia", { media: "" });
    },
    "charts/Manual/index.html?x": async () => {
        await search("pitching & thes");
        await page.press("Enter");
        await page.until("document.title === 'Größe'");
        await page.evaluate("history.back()");
        await page.until(`${found}[0] === "Rolling" && ${$("input")}.value === "pitching & thes"`);
        await expect("location.search", "?x&pagemeld=pitching%20%26%20thes");
    },
    [`${sea}/far/off/hostile.html?keys`]: async () => {
        await search("");
        for (const [before, key, focus] of keys) {
            await page.evaluate(before);
            await page.press(...key);
            await expect(`["${before}", document.activeElement.text || document.activeElement.localName]`, [before, focus]);
        }
        await expect(`${$("input")}.value + document.querySelector("textarea").value + ${found}`, "/");
    },
    [`${sea}/far/off/latin.html?contents`]: async () => {
        const lines = `${$("nav")}.innerText.split(/\\s*\\n\\s*/).slice(0, 5)`;
        await expect(lines, ["Contents", "Brackwater Manual", "Getting started", "Roll", "Größe"]);
        const seen = `[${$("[aria-current=page]")}.text, ${all("nav li", "text")}.length]`;
        await expect(`${$("li button")}.click() ?? ${$("li button")}.click() ?? ${seen}`, ["Größe", 13]);
        await expect(`${$("nav button")}.click() ?? ${lines}`, ["Contents"]);
    },
    "telemetry/Manual/index.html": async () => {
        await page.until(`${$("input")}.focus() ?? ${status} === "Search is not available: global_index.js did not run"`);
        await page.until(`${$("nav")}.innerText.includes("Contents are not available: global_toc.js did not run")`);
        page.errors = [];
    },
    [`${sea}/far/off/frames.html`]: () => expect("document.querySelector('#pagemeld, iframe, link')", null),
};

const server = spawn("python3", ["-um", "http.server", "--bind", "127.0.0.1", "--directory", root, "0"]);
try {
    const line = await new Promise((resolve) => server.stdout.once("data", resolve));
    for (const base of [`file://${root}/`, /http:[^)]+/.exec(line)[0]]) {
        for (const [name, check] of Object.entries(rows)) {
            console.log(base + name);
            await page.goto(base + toUrl(name));
            await page.until(/telemetry|frames/.test(name) ? "true" : `${$("nav li")} && ${$("input")}.checkVisibility()`);
            await check(base);
            assert.deepEqual(page.errors, []);
        }
    }
    console.log(`${2 * Object.keys(rows).length} passed, 0 failed`);
} finally {
    await page.close();
    server.kill();
    fs.rmSync(root, { recursive: true });
}
