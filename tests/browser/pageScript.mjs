// Tests the page script in a real browser: node pageScript.mjs PAGEMELD
//
// On the combined example modules and one more, whose names and pages are as awkward as they come; opened as files
// and over HTTP. Ends with status 1 at the first fault.
import assert from "node:assert/strict";
import { execFileSync, spawn } from "node:child_process";
import { once } from "node:events";
import fs from "node:fs";
import { tmpdir } from "node:os";
import path from "node:path";
import { fileURLToPath, pathToFileURL } from "node:url";
import { Page, program } from "./chromium.mjs";

if (!program) {
    console.log("SKIPPED, NOTHING TESTED: there is no chromium; script/setup installs it");
    process.exit(0);
}
const root = fs.mkdtempSync(path.join(tmpdir(), "pagemeld-site-"));
const tree = fileURLToPath(new URL("../..", import.meta.url));
const sea = "Größe der See/Manual";
const tag = '<script src="../../docdata/pagemeld.js" defer="defer"></script>';
const image = "<img src=x onerror=alert(1)> \"pitch\"";
const waves = Array.from({ length: 40 }, (_, i) => `waves/${i + 1}.html`);
const node = (link, title, children = null) => ({ link, title, children });
const toc = node("index.html", "Brackwater Manual", [
    node("null", "Getting started", [node("far/off/latin.html#roll", "Roll"), node("far/off/latin.html", "Pitch")]),
    node("https://sea.invalid/?a#b", "Outside"), node("50% of? all.html#end", "Half"),
    node("far/off/hostile.html", image, waves.map((wave) => node(wave, "")))]);
const index = {
    pages: [["far/off/hostile.html", image], ["far/off/latin.html", "Rolling"], ["50% of? all.html", "Roll"],
        ...waves.map((wave, i) => [wave, `Wave ${i + 1}`])],
    info: [["A <b>pitch</b>.", 0], ["Pitch, then roll: constructor.", 0], ["Rolling, pitching.", 1], ["Thesis.", 1]],
    common: {}, searchIndex: { pitch: [0, 1], roll: [1], rolling: [2], pitching: [2], thesis: [3], constructor: [1] },
};
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
    "docdata/index.json": JSON.stringify(index), "docdata/toc.json": JSON.stringify(toc),
    "../ScriptReference/docdata/index.json": "", "../../favicon.ico": "",
    "50% of? all.html": "", "index.html": tag, ...Object.fromEntries(waves.map((wave) => [wave, ""])),
};

function makeSite() {
    fs.cpSync(path.join(tree, "examples"), root, { recursive: true });
    for (const [name, text] of Object.entries(pages)) {
        fs.mkdirSync(path.dirname(path.join(root, sea, name)), { recursive: true });
        fs.writeFileSync(path.join(root, sea, name), text);
    }
    for (const folder of [`${sea}/shared`, `${sea}/docdata`, "charts/Manual/docdata", "telemetry/Manual/docdata"]) {
        fs.cpSync(path.join(tree, "web"), path.join(root, folder), { recursive: true });
    }
    execFileSync(process.argv[2], ["-autopaths", root], { stdio: "ignore" });
    fs.writeFileSync(path.join(root, "telemetry/Manual/docdata/global_index.js"), "pages = [");
    fs.rmSync(path.join(root, "telemetry/Manual/docdata/global_toc.js"));
}

const $ = (selector) => `document.querySelector("#pagemeld ${selector}")`;
const status = `${$("[role=status]")}.textContent`;
const isReady = `${$("nav li")} && ${$("input")}.checkVisibility()`;
const found = "Array.from(document.querySelectorAll('#pagemeld li:has(p) > a'), (link) => link.text).slice(0, 4)";
const focused = "document.activeElement.text || document.activeElement.localName";
const expect = async (page, expression, value) => assert.deepEqual(await page.evaluate(expression), value);

async function search(page, query, module = "") {
    await page.evaluate(`${$("input")}.value = ""; ${$("input")}.focus()`);
    await page.until($("select"));
    await page.evaluate(`${$("select")}.value = "${module}"; ${$("select")}.dispatchEvent(new Event("change"))`);
    await page.ask("Input.insertText", { text: query });
}

// Opens every level and shows every result: each link must then lead to a file, each control have a name, and
// nothing be left in the page or asked for outside the site.
async function checkWhole(page, base) {
    await page.until(`${$("[aria-expanded=false]")}?.click() ?? !${$("[aria-expanded=false]")}`);
    await search(page, "w");
    const links = await page.evaluate(`${$("ul + button")}.click();
        Array.from(document.querySelectorAll("#pagemeld a"), (link) => link.href)`);
    const fileOf = (link) => path.join(root, decodeURIComponent(link.replace(/#.*/, "").slice(base.length)));
    const dead = links.filter((link) => !link.startsWith(base) || !fs.existsSync(fileOf(link)));
    assert.deepEqual(dead, ["https://sea.invalid/?a#b"]);
    assert(links.length > 80 && links.includes(`${base}${encodeURI(sea)}/50%25%20of%3F%20all.html#end`));
    await page.ask("Accessibility.enable");
    const { nodes } = await page.ask("Accessibility.getFullAXTree");
    const isControl = ({ role }) => /^(button|link|searchbox|combobox|navigation)$/.test(role?.value);
    assert.deepEqual(nodes.filter((node) => isControl(node) && !node.name?.value), []);
    await expect(page, "length + typeof searchIndex + typeof p3", "0undefinedundefined");
    assert.deepEqual(page.requests.filter((url) => !url.startsWith(base)), []);
}

const queries = [ // what is searched for, what is said, the titles of the first results, the module chosen
    ["PITCH", "2 pages found", [image, "Rolling"]], // in the title, then elsewhere
    ["roll", "3 pages found", ["Roll", "Rolling", image]], // whole in the title, as a prefix there, elsewhere
    ["pitching thes", "1 page found", ["Rolling"]], // in two texts, the last a prefix
    ["pit roll", "Nothing found", []], // only the last is a prefix
    ["rolling the", "1 page found", ["Rolling"]], // a common word that may become "thesis"
    ["wave the", "40 pages found", ["Wave 1", "Wave 2", "Wave 3", "Wave 4"]], // and one that is left out
    ["the a ", "Only common words, which are not searched for", []],
    ["r", "3 pages found", ["The \"tide rose\"", "Charts", "Your first chart"], "charts"], // of one module
    ["__proto__ hasOwnProperty", "Nothing found", []],
    ["roll constructor", "1 page found", [image]],
];
const keys = [ // what is done first, the key and its modifiers, where the focus is then
    ["document.title = 'taken'", ["/"], "body"], ["document.title = ''", ["/", 2], "body"],
    ["document.querySelector('textarea').focus()", ["/"], "textarea"],
    ["document.activeElement.blur()", ["/", 8], "input"], ["document.execCommand('insertText', 0, 'wave')", ["ArrowDown"], "Wave 1"],
    ["", ["ArrowDown"], "Wave 2"], ["", ["ArrowUp"], "Wave 1"], ["", ["Tab"], "Wave 2"], ["", ["Escape"], "input"],
    [`if (${$("input")}.value !== "wave") throw 0`, ["Escape"], "input"],
];
const wholePages = ["hostile.html", "latin.html", "strict.xhtml", "based.html", "shared.html", "policy.html"];
const rows = { // by the page, and what else tells them apart
    ...Object.fromEntries(wholePages.map((name) => [`${sea}/far/off/${name}`, checkWhole])),
    "charts/Manual/index.html": checkWhole,
    "charts/Manual/index.html?queries": async (page) => {
        for (const [query, said, titles, module = ""] of queries) {
            await search(page, query, module);
            await expect(page, `["${query}", ${status}, ${found}]`, [query, said, titles]);
        }
        await expect(page, `${$("li:has(p)")}.innerText`, `${image} Größe der See\n\nPitch, then roll: constructor.`);
        await expect(page, "Array.from(document.querySelectorAll('mark'), (mark) => mark.textContent).join()", "roll,constructor");
        await page.ask("Emulation.setEmulatedMedia", { media: "print" });
        await expect(page, `${$("input")}.checkVisibility()`, false);
        await page.ask("Emulation.setEmulatedMedia", { media: "" });
    },
    "charts/Manual/index.html?x": async (page) => {
        await search(page, "pitching & thes");
        await page.press("Enter");
        await page.until("document.title === 'Größe'");
        await page.evaluate("history.back()");
        await page.until(`${found}[0] === "Rolling" && ${$("input")}.value === "pitching & thes"`);
        await expect(page, "location.search", "?x&pagemeld=pitching%20%26%20thes");
    },
    [`${sea}/far/off/hostile.html?keys`]: async (page) => {
        await search(page, "");
        await page.evaluate("document.activeElement.blur()");
        for (const [before, key, focus] of keys) {
            await page.evaluate(before);
            await page.press(...key);
            assert.equal(await page.evaluate(focused), focus, `${before} ${key}`);
        }
        await expect(page, `${$("input")}.value + document.querySelector("textarea").value + ${found}`, "/");
    },
    [`${sea}/far/off/latin.html?contents`]: async (page) => {
        const lines = `${$("nav")}.innerText.split(/\\s*\\n\\s*/).slice(0, 5)`;
        await expect(page, lines, ["Contents", "Brackwater Manual", "Getting started", "Roll", "Pitch"]);
        await expect(page, `${$("[aria-current=page]")}.text`, "Pitch");
        await expect(page, "document.querySelectorAll('#pagemeld nav li').length", 12);
        await page.evaluate(`${$("nav button")}.click()`);
        await expect(page, lines, ["Contents"]);
    },
    "telemetry/Manual/index.html": async (page) => {
        await page.evaluate(`${$("input")}.focus()`);
        await page.until(`${status} === "Search is not available: global_index.js did not run"`);
        await page.until("document.body.innerText.includes('Contents are not available: global_toc.js did not run')");
        page.errors = [];
    },
    [`${sea}/far/off/frames.html`]: (page) => expect(page, "document.querySelector('#pagemeld, iframe, link')", null),
};

makeSite();
const server = spawn("python3", ["-um", "http.server", "--bind", "127.0.0.1", "--directory", root, "0"]);
const page = await Page.open();
try {
    const [line] = await once(server.stdout, "data");
    for (const base of [`${pathToFileURL(root)}/`, /http:[^)]+/.exec(line)[0]]) {
        for (const [name, check] of Object.entries(rows)) {
            try {
                await page.goto(base + encodeURI(name));
                await page.until(name.includes("telemetry") ? $("input") : name.includes("frames") ? "true" : isReady);
                await check(page, base);
                assert.deepEqual(page.errors, []);
            } catch (fault) {
                throw new Error(`${base}${name}: ${page.errors}`, { cause: fault });
            }
        }
    }
    console.log(`${2 * Object.keys(rows).length} passed, 0 failed`);
} finally {
    await page.close();
    server.kill();
    fs.rmSync(root, { recursive: true });
}
