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
    const modules = ["acquire", "charts", "logbook"].flatMap((name) => [`${name}/Manual`, `${name}/ScriptReference`]);
    execFileSync(path.join(root, "make-docdata.py"), ["--toc", "index.html", "--root-title", toc.title, ...modules],
        { cwd: root, stdio: "ignore" });
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
const hostile = `${sea}/far/off/hostile.html`;
const status = "document.querySelector('#pagemeld [role=status]').textContent";
const box = "document.querySelector('#pagemeld input')";
const isReady = `document.querySelector("#pagemeld nav li") && ${box}.checkVisibility()`;
const closed = "#pagemeld [aria-expanded=false]";
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
    while (await page.evaluate(`[...document.querySelectorAll("${closed}")].map((b) => b.click()).length`));
    await search(page, "w");
    await page.evaluate("document.querySelector('#pagemeld ul + button').click()");
    const links = await page.evaluate("Array.from(document.querySelectorAll('#pagemeld a'), (link) => link.href)");
    const isFile = (link) => link.startsWith(base) && existsSync(path.join(root, decodeURIComponent(link.replace(/#.*/, "").slice(base.length))));
    assert.deepEqual(links.filter((link) => !isFile(link)), ["https://sea.invalid/?a#b"]);
    assert(links.length > 80 && links.includes(`${base}${encodeURI(sea)}/50%25%20of%3F%20all.html#end`), links.join());
    await page.ask("Accessibility.enable");
    const { nodes } = await page.ask("Accessibility.getFullAXTree");
    const isControl = ({ role }) => /^(button|link|searchbox|combobox|navigation)$/.test(role?.value);
    assert.deepEqual(nodes.filter((node) => isControl(node) && !node.name?.value), []);
    assert.equal(await page.evaluate("length + typeof searchIndex + typeof p3"), "0undefinedundefined");
    assert.deepEqual(page.requests.filter((url) => !url.startsWith(base)), []);
}

// Queries on the page of another module: what is said, and the titles of the first results.
const queries = [
    ["PITCH", "2 pages found", ['<img src=x onerror=alert(1)> "pitch"', "Rolling"]], // in the title, then whole
    ["roll", "3 pages found", ["Roll", "Rolling", '<img src=x onerror=alert(1)> "pitch"']], // whole in the title
    ["pitching thes", "1 page found", ["Rolling"]], // words in two texts, the last a prefix
    ["pit roll", "Nothing found", []], // only the last is a prefix
    ["the", "5 pages found", ["The \"tide rose\"", "Heights and their datum: Ærholm zero", "Rolling", "Units: °C, µS/cm and ‰"]], // may become "thesis"
    ["the roll", "3 pages found", ["Roll", "Rolling", '<img src=x onerror=alert(1)> "pitch"']],
    ["the a ", "Only common words, which are not searched for", []],
    ["__proto__ hasOwnProperty", "Nothing found", []], ["constructor", "1 page found", ['<img src=x onerror=alert(1)> "pitch"']],
    ["wave", "40 pages found", ["Wave 1", "Wave 2", "Wave 3", "Wave 4"]],
];

const rows = [
    ...["charts/Manual/index.html", hostile, ...["latin.html", "strict.xhtml", "based.html", "shared.html", "policy.html"]
        .map((name) => `${sea}/far/off/${name}`)].map((name) => [`all links of ${name}`, name, checkWhole]),
    ["queries", charts, async (page) => {
        for (const [query, said, pages] of queries) {
            await search(page, query);
            assert.deepEqual([query, await page.evaluate(status), await page.evaluate(found)], [query, said, pages]);
        }
    }],
    ["a result", charts, async (page) => {
        await search(page, "roll constr");
        assert.equal(await page.evaluate("document.querySelector('#pagemeld li:has(p)').innerHTML.replace(/<a .*?>/, '<a>')"),
            '<a>&lt;img src=x onerror=alert(1)&gt; "pitch"</a> <span>Größe der See</span>' +
            "<p>Pitch, then <mark>roll</mark>: <mark>constructor</mark>.</p>");
    }],
    ["filter", charts, async (page) => {
        await search(page, "r");
        await page.evaluate("const s = document.querySelector('#pagemeld select'); s.value = 'charts'; s.dispatchEvent(new Event('change'))");
        assert.deepEqual(await page.evaluate(found), ["The \"tide rose\"", "Charts", "Your first chart"]);
    }],
    ["address and Back", `${charts}?x`, async (page) => {
        await search(page, "pitching & thes");
        await page.press("Enter");
        await page.until("document.title === 'Größe'");
        await page.evaluate("history.back()");
        await page.until(`${found}[0] === "Rolling" && ${box}.value === "pitching & thes"`);
        assert.equal(await page.evaluate("location.search"), "?x&pagemeld=pitching%20%26%20thes");
    }],
    ["keys", hostile, async (page) => {
        const seen = [];
        const press = async (...keys) => {
            for (const key of keys) {
                await page.press(...[key].flat());
            }
            seen.push(await page.evaluate(focused));
        };
        await page.evaluate("document.title = 'taken'");
        await press("/");
        await page.evaluate("document.title = ''");
        await press(["/", 2]);
        await page.evaluate("document.querySelector('textarea').focus()");
        await press("/");
        await page.evaluate("document.activeElement.blur()");
        await press(["/", 8]);
        await search(page, "wave");
        await press("ArrowDown", "ArrowDown");
        await press("ArrowUp");
        await press("Tab");
        await press("Escape");
        await press("Escape");
        assert.deepEqual(seen, ["body", "body", "textarea", "input", "Wave 2", "Wave 1", "Wave 2", "input", "input"]);
        assert.equal(await page.evaluate(`${box}.value + document.querySelector('textarea').value + ${found}`), "/");
    }],
    ["contents", `${sea}/far/off/latin.html`, async (page) => {
        const shown = () => page.evaluate("document.querySelector('#pagemeld nav').innerText.split(/\\s*\\n\\s*/)");
        const top = ["Contents", "Brackwater Manual", "Getting started", "Roll", "Pitch", "Your first \"raw\" reading"];
        assert.deepEqual((await shown()).slice(0, 6), top);
        assert.equal(await page.evaluate("document.querySelector('#pagemeld [aria-current=page]').text"), "Pitch");
        assert.equal(await page.evaluate("document.querySelectorAll('#pagemeld nav li').length < 20"), true);
        await page.evaluate("document.querySelector('#pagemeld nav').firstChild.click()");
        assert.deepEqual(await shown(), ["Contents"]);
    }],
    ["broken and missing outputs", "telemetry/Manual/index.html", async (page) => {
        await page.evaluate(`${box}.focus()`);
        await page.until(`${status} === "Search is not available: global_index.js did not run"`);
        await page.until("document.body.innerText.includes('Contents are not available: global_toc.js did not run')");
        page.errors = [];
    }, box],
    ["frame set", `${sea}/far/off/frames.html`, (page) => page.evaluate("!document.querySelector('#pagemeld') || x"), "true"],
    ["print", charts, async (page) => {
        await page.ask("Emulation.setEmulatedMedia", { media: "print" });
        assert(!(await page.evaluate(`${box}.checkVisibility()`)));
        await page.ask("Emulation.setEmulatedMedia", { media: "" });
    }],
];

makeSite();
const server = spawn("python3", ["-um", "http.server", "--bind", "127.0.0.1", "--directory", root, "0"]);
const page = await Page.open();
try {
    const [line] = await once(server.stdout, "data");
    for (const base of [`${pathToFileURL(root)}/`, `${/http:[^)]+/.exec(line)}`]) {
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
