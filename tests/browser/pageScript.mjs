// Tests the page script in a browser, as files and over HTTP: node tests/browser/pageScript.mjs PAGEMELD BROWSER
// BROWSER is one of chromium, firefox-esr, WebKitWebDriver. The pages are those of site.mjs. Ends with status 1 at the first fault.
import assert from "node:assert/strict";
import { spawn } from "node:child_process";
import fs from "node:fs";
import { createRequire } from "node:module";
import path from "node:path";
import { setTimeout as delay } from "node:timers/promises";
import { openPage } from "./browsers.mjs";
import { hostileTitle, makeSite, sea, themes } from "./site.mjs";

const [pagemeld, browser] = process.argv.slice(2);
const axe = fs.readFileSync(createRequire(import.meta.url).resolve("axe-core/axe.min.js"), "utf8");
const root = makeSite(pagemeld);
const ownSite = path.resolve("build/site"); // of script/site
let page;
const plain = `${sea}/far/off/no theme.html`;
const seaModule = "Manual/Gr\u00f6\u00dfe  #1";
let base;

const $ = (selector) => `document.querySelector("#pagemeld ${selector}")`;
const all = (selector, what) => `Array.from(document.querySelectorAll("#pagemeld ${selector}"), (e) => e.${what})`;
const status = `${$("[role=status]")}.textContent`;
const found = `${all(".pagemeld-results > li > a:first-child", "text")}.slice(0, 4)`;
const dialog = "document.querySelector('dialog')";
const opener = "document.querySelector('.pagemeld-open')";
const focus = `(({ text, className, localName }) => text || className || localName)(document.activeElement)`;
const toUrl = (name) => encodeURI(name).replaceAll("#", "%23");
const expect = async (code, value) => assert.deepEqual(await page.evaluate(code), value, code);

async function goto(name) {
    await page.goto(base + toUrl(name));
    await page.until(`document.querySelector(".pagemeld-open, div#pagemeld nav")`);
}

// Types a query, as a reader does, and waits until its results are there.
async function search(query) {
    await page.evaluate(`${$("input")}.focus(), ${$("input")}.select()`);
    for (const key of query) {
        await page.press(key);
    }
    await page.until(`${status}.includes("found")`);
}

async function openDialog() {
    await page.evaluate(`${opener}.click()`);
    await page.until(`${$("nav li")}`);
}

// No rule is broken in the whole page, in wide and narrow windows.
async function checkAccess() {
    await page.evaluate(`(() => { ${axe} })()`);
    for (const width of [320, 768, 1280]) {
        await page.resize(width, 800);
        await expect(`axe.run(document, { preload: false, resultTypes: ["violations"] }).then(({ violations }) =>
            violations.flatMap(({ id, nodes }) => [id, ...nodes.map(({ target }) => String(target))]))`, []);
    }
}

// Opens every level and shows every result: all links lead to files, and nothing is left over in the page.
async function checkWhole() {
    await page.evaluate(`${opener}?.click()`);
    await page.until(`${$("nav li")}`);
    await page.until(`${$("details:not([open]) > summary")}?.click() ?? !${$("nav ul:empty")}`);
    await search("wave");
    await page.until(`${$(".pagemeld-results ~ button")}.hidden || ${$(".pagemeld-results ~ button")}.click()`);
    const links = await page.evaluate(all("a:not(.pagemeld-skip)", "href"));
    const fileOf = (link) => path.join(root, decodeURIComponent(link.replace(/#.*/, "").slice(base.length)));
    const dead = links.filter((link) => !link.startsWith(base) || !fs.existsSync(fileOf(link)));
    assert.deepEqual(dead, ["https://sea.invalid/?a#b", "https://[/latin.html"]);
    assert(links.length > 80 && links.includes(`${base}${toUrl(sea)}/50%25%20of%3F%20all.html#end`));
    await expect(`[typeof searchIndex, typeof p3, ${$("li a:not([target=_self])")}]`, ["undefined", "undefined", null]);
}

// The boxes of all of the page's own elements.
const boxes = `Array.from(document.body.querySelectorAll(":not(#pagemeld-corner, #pagemeld-corner *, script)"),
    (part) => Object.values(part.getBoundingClientRect().toJSON()).join())`;
const isOnTop = (part) => `(() => {
    const { left, right, top, bottom } = ${part}.getBoundingClientRect();
    return [[left + 22, top + 22], [right - 22, bottom - 22], [(left + right) / 2, (top + bottom) / 2]]
        .every(([x, y]) => ${part}.contains(document.elementFromPoint(x, y)));
})()`;
// What a page's rules would change first.
const look = `["input", "label", "nav li", ".pagemeld-results a", ".pagemeld-view"].flatMap((selector) => {
    const style = getComputedStyle(document.querySelector("#pagemeld " + selector));
    return [style.display, style.height, style.fontSize, style.position, style.textTransform, style.float,
        getComputedStyle(document.querySelector("#pagemeld " + selector), "::before").content];
})`;
const looks = [];

// The boxes once the page has settled: WebKitGTK adds its scroll bar some time after the page is loaded.
async function settledBoxes() {
    for (let last = ""; ;) {
        const now = (await page.evaluate(boxes)).join("\n");
        if (now === last) {
            return now;
        }
        last = now;
        await delay(150);
    }
}

// In a page with somebody's theme nothing moves, nothing covers the button or the dialog, and both look as elsewhere.
async function checkTheme(name, isDark) {
    await page.goto(`${base}${toUrl(sea)}/far/bare/${name}.html`);
    const bare = await settledBoxes();
    await goto(`${sea}/far/off/${name}.html`);
    assert.equal(await settledBoxes(), bare, name);
    await expect(`[${isOnTop(opener)}, ${opener}.offsetHeight >= 44, innerHeight - ${opener}.getBoundingClientRect().top < 80]`, [true, true, true]);
    await openDialog();
    await search("wave");
    assert.equal(await settledBoxes(), bare, name);
    await expect(`[${isOnTop($(".pagemeld-view"))}, getComputedStyle(${$(".pagemeld-view")}).colorScheme]`, [true, isDark ? "dark" : "light"]);
    looks.push(await page.evaluate(look));
    assert.deepEqual(looks.at(-1), looks[0], name);
    await page.press("ArrowRight");
    await page.press("Escape");
    await expect(`[document.title, ${dialog}.open]`, [name, false]);
}

const rows = { // what must hold, and how that is seen
    ...Object.fromEntries(["hostile.html", "latin.html", "strict.xhtml", "based.html", "shared.html", "policy.html"]
        .filter((name) => browser !== "WebKitWebDriver" || name !== "hostile.html") // whose driver needs the page's Map
        .map((name) => [`everything works in ${name}`, async () => {
            await goto(`${sea}/far/off/${name}`);
            await checkWhole();
        }])),
    ...Object.fromEntries(Object.entries(themes).map(([name, { isDark = false }]) =>
        [`at home in a page with ${name}`, () => checkTheme(name, isDark)])),
    "nothing is loaded before the dialog opens; its button is in the corner that the tag names": async () => {
        await goto(`${sea}/far/off/policy.html`);
        await expect(`[${opener}.offsetLeft, ${opener}.offsetTop, document.querySelectorAll("#pagemeld :is(iframe, li)").length,
            performance.getEntriesByType("resource").filter(({ name }) => /global_/.test(name)).length]`, [12, 12, 0, 0]);
    },
    "a link within the page closes the dialog and goes there, also again": async () => {
        await goto(plain);
        for (let times = 0; times < 2; times++) {
            await page.evaluate("scrollTo(0, 0)");
            await openDialog();
            await page.evaluate(`${$("a[href$='no%20theme.html#end']")}.click()`);
            await page.until(`!${dialog}.open && location.hash === "#end" && scrollY > 0`);
        }
    },
    "found, opened, gone back and closed by keyboard alone": async () => {
        await goto(plain + "?x=1");
        const stops = `Array.from(document.querySelectorAll("a[href], button, input")).filter((e) => e.checkVisibility()).length`;
        await expect(`${stops} - document.querySelectorAll("a[href]:not(#pagemeld-corner *)").length`, 1);
        await page.press("/");
        await expect(focus, "input");
        await page.until(`(${$("select")}.value = "${seaModule}", ${$("select")}.value)`); // once it can be chosen
        await search("pitching thes");
        await page.press("ArrowDown");
        await expect(focus, "Rolling");
        await page.press("Enter");
        await page.until("document.title === 'Gr\u00f6\u00dfe'");
        await page.evaluate("history.back()");
        await page.until(`${dialog}?.open && ${found}[0] === "Rolling" && ${focus} === "Rolling"`);
        await expect(`[${$("input")}.value, ${$("select")}.value, location.search]`,
            ["pitching thes", seaModule, "?x=1&pagemeld=pitching+thes"]);
        await page.press("Escape");
        await page.until(`!${dialog}.open && location.search === "?x=1"`);
        await expect(focus, "body");
    },
    "no rule of accessibility is broken": async () => {
        await goto(plain);
        await checkAccess();
        await openDialog();
        await search("wave");
        await checkAccess();
        await goto(`${sea}/far/off/own place.html`);
        await page.until($("nav li"));
        await search("wave");
        await checkAccess();
    },
    "the contents show the way to the page, and a link leads past them": async () => {
        await goto(`${sea}/far/off/own place.html`);
        await page.until(`${$("details[open] [aria-current]")}?.text === "Place"`);
        await page.evaluate(`${$(".pagemeld-skip")}.focus()`);
        await page.press("Enter");
        await page.press("Tab");
        await expect(focus, "End");
    },
    "in a narrow window tabs choose between search and contents": async () => {
        await page.resize(400, 700);
        await goto(plain);
        await openDialog();
        const seen = `["input", "nav li"].map((part) => document.querySelector("#pagemeld " + part).checkVisibility())`;
        await expect(seen, [true, false]);
        await page.evaluate(`${$("[role=tab]:last-child")}.click()`);
        await expect(seen, [false, true]);
        await page.resize(1280, 800);
    },
    "keys do not scroll the page below the dialog, and a click beside it closes it": async () => {
        await goto(`${plain}?pagemeld=wave`);
        await page.until(`${dialog}?.open && ${found}.length`);
        await page.press("PageDown");
        await delay(300);
        await expect("[scrollY, document.documentElement.scrollHeight > 2000]", [0, true]);
        await page.click(640, 3);
        await page.until(`!${dialog}.open && !location.search`);
    },
    "a broken output is named, and a frame set is left alone": async () => {
        await goto("telemetry/Manual/index.html");
        await page.until(`${$("input")}.focus() ?? ${status}.endsWith("run")`);
        await page.until(`${$("nav")}.innerText.includes("Contents are not available: global_toc.js did not run")`);
        await delay(500); // in which the other set's index, which is whole, would change the status
        await expect(status, "Search is not available: global_index.js did not run");
        await page.goto(`${base}${toUrl(sea)}/far/off/frames.html`);
        await expect("document.querySelector('#pagemeld, .pagemeld-open, iframe, link') === null", true);
        page.errors = [];
    },
    ...!fs.existsSync(ownSite) ? {} : { "our own documentation answers a question": async () => {
        await goto("own/pagemeld/Manual/index.html");
        await openDialog();
        await search("what does status 255 mean");
        await expect(`${found}[0]`, "Messages");
    } },
    ...browser !== "chromium" ? {} : { "marked words are seen in forced colors, and nothing of it is printed": async () => {
        await goto(`${plain}?pagemeld=pitch`);
        await page.until($("mark"));
        const session = await page.tab.createCDPSession();
        await session.send("Emulation.setEmulatedMedia", { features: [{ name: "forced-colors", value: "active" }] });
        await expect(`(({ color, backgroundColor }) => [color, backgroundColor])(getComputedStyle(${$("mark")}))`,
            ["rgb(0, 0, 0)", "rgb(255, 255, 0)"]);
        await session.send("Emulation.setEmulatedMedia", { media: "print" });
        await expect(`[${opener}, ${$(".pagemeld-view")}].some((part) => part.checkVisibility())`, false);
    } },
};

if (fs.existsSync(ownSite)) {
    fs.symlinkSync(ownSite, path.join(root, "own"));
} else {
    console.error("SKIPPED: our own documentation is not tested, because build/site is missing");
}
const server = spawn("python3", ["-um", "http.server", "--bind", "127.0.0.1", "--directory", root, "0"]);
try {
    const line = await new Promise((resolve) => server.stdout.once("data", resolve));
    for (base of [`file://${root}/`, /http:[^)]+/.exec(line)[0]]) {
        await page?.close();
        page = await openPage(browser);
        await page.resize(1280, 800);
        for (const [name, check] of Object.entries(rows)) {
            console.log(`${base.slice(0, 4)}: ${name}`);
            await check();
            assert.deepEqual(page.errors, []);
            await page.renew();
        }
    }
    console.log(`${2 * Object.keys(rows).length} passed, 0 failed`);
} finally {
    await page?.close();
    server.kill();
    fs.rmSync(root, { recursive: true });
}
