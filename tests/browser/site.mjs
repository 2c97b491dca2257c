// Makes the site on which the page script is tested: the example modules and one more, whose names and pages are awkward.
import { execFileSync } from "node:child_process";
import fs from "node:fs";
import { tmpdir } from "node:os";
import path from "node:path";

export const sea = "Gr\u00f6\u00dfe  #1/Manual";
export const hostileTitle = "<img src=x onerror=alert(1)> \"pitch\"";
const tag = '<script src="../../docdata/pagemeld.js" defer="defer"></script>';
const place = '<div id="pagemeld"></div>';
const waves = Array.from({ length: 40 }, (_, i) => `waves/${i + 1}.html`);
const node = (link, title, children = null) => ({ link, title, children });
const toc = node("index.html", "Brackwater Manual", [
    node("null", "Getting started", [node("far/off/own place.html", "Place"), node("far/off/latin.html#roll", "Roll"), node("far/off/latin.html", "Gr\u00f6\u00dfe")]),
    node("https://sea.invalid/?a#b", "Outside"), node("https://[/latin.html", "Broken"),
    node("50% of? all.html#end", "Half"), node("far/off/no theme.html#end", "End"), node("File:x.html", "No scheme"),
    node("far/off/hostile.html", hostileTitle, waves.map((wave) => node(wave, "")))]);
const index = {
    common: {}, searchIndex: { pitch: [0, 1], roll: [1], rolling: [2], pitching: [2], thesis: [3], constructor: [1] },
    info: [["A <b>pitch</b>.", 0], ["Pitch, then roll: constructor.", 0], ["Rolling, pitching.", 1], ["Thesis.", 1]],
    pages: [["far/off/hostile.html", hostileTitle], ["far/off/latin.html", "Rolling"], ["50% of? all.html", "Roll"],
        ...waves.map((wave, i) => [wave, `Wave ${i + 1}`])],
};

// What hurts in other people's themes: their rules, and parts of the body that go with them.
export const themes = {
    "no theme": { css: "", script: `addEventListener("DOMContentLoaded", () => { history.replaceState({}, ""); });` },
    "a fixed sidebar": { css: "aside { position: fixed; z-index: 9999; inset: 0 auto 0 0; width: 300px; } main { margin-left: 300px; }" },
    "a fixed header": { css: "header { position: fixed; z-index: 99999; inset: 0 0 auto; height: 60px; } main { padding-top: 60px; }" },
    "a flex body": { css: "body { display: flex; gap: 30px; } body > * { flex: 1; min-width: 200px; }" },
    "a frame that fills the window": { css: "main { position: fixed; inset: 0; overflow: auto; } html, body { height: 100%; overflow: hidden; }" },
    "a tree view": { css: "body { overflow: auto; height: 100%; margin: 0; } html { height: 100%; } ul { float: left; } li::before { content: '+'; }" },
    "a dark theme": { css: "body { color: #ddd; background: #111; } a { color: #9cf; }", isDark: true },
    "key handlers": { css: "", script: `addEventListener("keydown", ({ key }) => { document.title += key; });
        document.addEventListener("keyup", ({ key }) => { document.title += key; }, true);` },
    "resets": { css: `* { all: unset; } * { box-sizing: content-box; text-transform: uppercase; } button, dialog { display: block; }
        a::before, :is(p, li)::after { content: "leak"; } ::first-letter { font-size: 300%; } label, input { float: right; }` },
};
const themePage = (name, { css, script = "" }, tag) => `<!DOCTYPE html><html lang="en"><head><meta charset="utf-8">
    <title>${name}</title><style>${css}</style>${tag}<script>${script}</script></head><body>
    <header><a href="#end">Start</a></header><aside aria-label="Pages"><ul><li><a href="../../waves/1.html">Wave</a></li></ul></aside>
    <main><h1>${name}</h1>${"<p>Text of the page.</p>".repeat(60)}<p id="end"><a href="#end">End</a></p></main></body></html>`;

const pages = {
    "far/off/hostile.html": `<!DOCTYPE html><html dir="rtl"><style>div, input { display: none }</style>
        <p id="toc">${tag}<textarea></textarea><script>const info = 1, p0 = 2, pages = 3, common = 4; class Set {}
        var URL, Map = "Map"; onkeydown = (event) => document.title !== "taken" || event.key !== "/";</script>`,
    "far/off/latin.html": Buffer.from(`<meta charset="iso-8859-1"><title>Gr\u00f6\u00dfe</title>${place}${tag}`, "latin1"),
    "far/off/strict.xhtml": `<html xmlns="http://www.w3.org/1999/xhtml"><head>${tag}</head><body>${place}</body></html>`,
    "far/off/based.html": `${tag}<base href="http://invalid.invalid/" target="_blank"><p>x</p>${place}`,
    "far/off/shared.html": `<script src="../../shared/pagemeld.js" defer data-docdata="../../docdata"></script><p>x</p>${place}`,
    "far/off/policy.html": `<meta http-equiv="Content-Security-Policy" content="script-src 'self'">
        ${tag.replace("defer", "data-corner='top left' defer")}<p>x</p>`,
    "far/off/own place.html": themePage("own place", { css: "" }, tag).replace("<main>", `${place}<main>`),
    "far/off/frames.html": `${tag}<frameset><frame src="about:blank"></frameset>`,
    "docdata/index.json": JSON.stringify(index), "docdata/toc.json": JSON.stringify(toc), "../../favicon.ico": "",
    "../ScriptReference/docdata/index.json": "", "50% of? all.html": "", "File:x.html": "",
    ...Object.fromEntries(waves.map((wave) => [wave, ""])),
    ...Object.fromEntries(Object.entries(themes).flatMap(([name, theme]) => [
        [`far/off/${name}.html`, themePage(name, theme, tag)], [`far/bare/${name}.html`, themePage(name, theme, "")]])),
};

// Returns the site's directory, below which all modules are combined and have the script.
export function makeSite(pagemeld) {
    const root = fs.mkdtempSync(path.join(tmpdir(), "pagemeld-site-"));
    const docdata = path.resolve("Tools/DocTools/PagemeldDocdata/pagemeld-docdata");
    fs.cpSync("examples", root, { recursive: true });
    const modules = ["acquire", "charts", "logbook"].flatMap((name) => [`${name}/Manual`, `${name}/ScriptReference`]);
    execFileSync(docdata, ["--toc", "index.html", "--share", "Getting started", "--root-title", toc.title, ...modules],
        { cwd: root, stdio: "ignore" });
    for (const [name, text] of Object.entries(pages)) {
        fs.mkdirSync(path.dirname(path.join(root, sea, name)), { recursive: true });
        fs.writeFileSync(path.join(root, sea, name), text);
    }
    [`${sea}/shared`, `${sea}/docdata`, "charts/Manual/docdata", "telemetry/Manual/docdata"].forEach((directory) =>
        fs.cpSync("web", path.join(root, directory), { recursive: true }));
    execFileSync(path.resolve(pagemeld), ["-autopaths", root], { stdio: "ignore" });
    fs.writeFileSync(path.join(root, "telemetry/Manual/docdata/global_index.js"), "pages = [");
    fs.rmSync(path.join(root, "telemetry/Manual/docdata/global_toc.js"));
    return root;
}
