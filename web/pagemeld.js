// Shows search and contents of all modules in the page's <div id="pagemeld">, or else in a dialog that a button opens.
// Pages on disk can't fetch, so the outputs run as scripts: in frames, since a page may have a "const p0" of its own.

(function main(tag, before) {
"use strict";

const place = document.querySelector("div#pagemeld");
const query = new URLSearchParams(location.search).get("pagemeld");
const isReady = place || query ? document.readyState !== "loading" : document.readyState === "complete";
if (!isReady) { // the button can wait
    addEventListener("load", () => { setTimeout(main, 0, tag, before); });
    return;
}

const RESULTS_AT_ONCE = 10;

const ownAddress = new URL(tag.getAttribute("src"), document.URL); // a later <base> does not count
const docdata = new URL(tag.dataset.docdata?.replace(/\/?$/, "/") ?? new URL(".", ownAddress), document.URL);

const language = { lang: document.documentElement.lang }; // of what is not the view's own words
const box = create("input", { type: "search", spellcheck: "false" });
const filter = create("select", language, create("option", { value: "", lang: "en" }, "All"));
const fields = create("div", {},
    create("label", {}, "Search all modules ", box), create("label", {}, "Search in ", filter));
const status = create("p", { role: "status" });
const results = create("ul", { class: "pagemeld-results", ...language });
const more = create("button", { hidden: "" }, "More results");
const contents = create("nav", { "aria-label": "All modules" });
const tabs = ["Search", "Contents"].map((name) => create("button", { role: "tab" }, name));
const view = create("div", { class: "pagemeld-view", lang: "en", role: "search", "aria-label": "All modules" },
    create("div", { role: "tablist" }, ...tabs),
    create("div", { class: "pagemeld-finder" }, fields, status, results, more), contents);
const dialog = create("dialog", { id: "pagemeld", "aria-label": "All modules" });

const needIndex = once(loadIndexes);
const needContents = once(loadContents);
const lookups = []; // of the sets that are loaded, the own one first
let search; // the functions of the search file
let pages = []; // found
let chosen; // the link by which the reader left
let isDialogKey = false;
let pageScroll;

function start() {
    listen();
    selectTab(tabs[0]);
    matchPage(place ? fillPlace() : fillCorner());
    if (query) {
        restoreQuery();
        openView();
    }
}

function fillPlace() {
    const end = create("span", { tabindex: "-1" });
    const skip = create("a", { href: "#pagemeld", class: "pagemeld-skip" }, "Skip search and contents");
    skip.onclick = (event) => {
        event.preventDefault();
        end.focus();
    };
    view.prepend(skip);
    place.append(view, end);
    setTimeout(needContents);
    return place;
}

function fillCorner() {
    const opener = create("button", { class: "pagemeld-open", "data-corner": tag.dataset.corner ?? "" },
        "Search all modules ", create("kbd", {}, "/"));
    const close = create("button", { class: "pagemeld-close", "aria-label": "Close" }, "\u00d7");
    const corner = create("section", { id: "pagemeld-corner", "aria-label": "Search", lang: "en" }, opener, dialog);
    view.append(close);
    dialog.append(view);
    document.body.append(corner);
    opener.onclick = openView;
    close.onclick = () => { dialog.close(); };
    dialog.onclose = keepQuery;
    dialog.onmousedown = ({ target }) => { if (target === dialog) { dialog.close(); } };
    addEventListener("scroll", () => { if (dialog.open) { scrollTo(pageScroll); } }); // WebKit's keys scroll it
    return corner;
}

// Dark where the page's text is light, which an attribute may switch.
function matchPage(home) {
    const systemIsDark = matchMedia("(prefers-color-scheme: dark)");
    const match = () => {
        const { color } = getComputedStyle(home.parentElement);
        const [, red, green, blue] = color.split(/[(,)]/);
        const isLight = 0.21 * red + 0.72 * green + 0.07 * blue > 127;
        home.style.colorScheme = (color.startsWith("rgb") ? isLight : systemIsDark.matches) ? "dark" : "light";
    };
    const observer = new MutationObserver(match);
    [document.documentElement, document.body].forEach((part) => observer.observe(part, { attributes: true }));
    systemIsDark.onchange = match;
    match();
}

function listen() {
    addEventListener("pageshow", () => { chosen?.focus({ preventScroll: true }); }); // lost by a page kept for Back
    addEventListener("keydown", onKey);
    ["keydown", "keypress", "keyup"].forEach((type) => addEventListener(type, onDialogKey, true));
    box.onfocus = needIndex;
    box.oninput = filter.onchange = update;
    box.onblur = view.onclick = keepQuery;
    more.onclick = showMore;
    tabs.forEach((tab) => { tab.onclick = () => { selectTab(tab); }; });
}

function openView() {
    if (!place && !dialog.open) {
        pageScroll = { left: scrollX, top: scrollY, behavior: "instant" };
        dialog.showModal();
        needContents();
    }
    box.focus();
    box.select();
}

function selectTab(chosenTab) {
    tabs.forEach((tab) => tab.setAttribute("aria-selected", tab === chosenTab));
    showCurrent();
}

// The page sees no key pressed in the dialog, nor the release of the one that closes it.
function onDialogKey(event) {
    isDialogKey = event.type === "keydown" ? dialog.open : isDialogKey;
    if (isDialogKey) {
        event.stopPropagation();
        onKey(event);
    }
}

function onKey(event) {
    const isComposing = event.isComposing || event.keyCode === 229; // the last key, in Safari
    const isTaken = event.ctrlKey || event.altKey || event.metaKey || isComposing || event.defaultPrevented;
    if (event.type === "keydown" && !isTaken && actOn(event.key, event.composedPath()[0])) {
        event.preventDefault();
    }
}

// Returns whether it acted.
function actOn(key, target) {
    const stops = [box, ...results.querySelectorAll("a"), more];
    const next = stops.includes(target) && stops[stops.indexOf(target) + { ArrowDown: 1, ArrowUp: -1 }[key]];
    const isTyped = target.isContentEditable || /^(input|textarea|select)$/.test(target.localName);
    if (next) {
        next.focus();
    } else if (key === "Escape" && dialog.open) {
        dialog.close();
    } else if (key === "Enter" && target === box) {
        results.querySelector(".pagemeld-best")?.click();
    } else if (key === "/" && !isTyped) {
        openView();
    } else {
        return false;
    }
    return true;
}

// The other set's index comes second, and the contents end with that set's first page of this module.
async function loadIndexes() {
    status.textContent = "Loading the search index";
    if (!await addIndex(docdata)) {
        status.textContent = "Search is not available: global_index.js did not run";
        return;
    }
    const set = { Manual: "ScriptReference", ScriptReference: "Manual" }[nameOf(docdata)];
    const from = new URL(`../../${set}/docdata/`, docdata);
    if ((tag.dataset.sets ?? set)?.includes(set) && await addIndex(from)) {
        const first = lookups[1].pages[lookups[1].prefixes.indexOf("")];
        await needContents();
        contents.append(first ? createLink(first[0], set, [], from) : "");
    }
}

// Leaves the results that are shown where they are. Returns whether the index ran.
async function addIndex(from) {
    const [source, all] = await run(`${from}global_index.js`, new URL("pagemeld-search.js", ownAddress));
    if (!source.searchIndex || !source.prepareIndex) {
        return false;
    }
    const set = nameOf(from);
    const label = (prefix) => [prefix, `${set}/${nameOf(createLink(prefix, "", [prefix], from))}`];
    const labels = Object.fromEntries(["", ...all].map(label));
    const values = new Set([set, ...Object.values(labels).sort()]);
    filter.append(...Array.from(values, (value) => create("option", { value }, value)));
    search = source;
    lookups.push({ ...await finish(source.prepareIndex(source, all)), from, set, labels });
    findAll();
    return true;
}

function update() {
    if (lookups.length > 0) {
        results.replaceChildren();
        findAll();
    }
}

function findAll() {
    const shown = pages.slice(0, results.childElementCount);
    const isSame = (a, b) => a.page === b.page && a.asked.lookup === b.asked.lookup;
    const { value } = filter;
    const accepts = ({ set, labels, prefixes }, page) => ["", set, labels[prefixes[page]]].includes(value);
    const found = search.findPages(lookups, box.value, accepts);
    pages = shown.concat(found.pages.filter((page) => !shown.some((one) => isSame(one, page))));
    const whole = pages.filter(({ isWhole }) => isWhole).length;
    const count = pages.length === 1 ? "1 page" : `${pages.length || "No"} pages`;
    const rest = whole === pages.length ? "" : `, ${whole} with all words`;
    status.textContent = found.words.length > 0 ? `${count} found${rest}` : "";
    showResults(RESULTS_AT_ONCE);
}

function showResults(count) {
    results.append(...pages.slice(results.childElementCount, count).map(createResult));
    more.hidden = results.childElementCount === pages.length;
}

function showMore() {
    const shown = results.childElementCount;
    showResults(shown + RESULTS_AT_ONCE);
    results.children[shown].querySelector("a").focus();
}

function createResult(page) {
    const { set, labels, from, prefixes } = page.asked.lookup;
    const prefix = prefixes[page.page];
    const shown = search.describePage(page);
    const linkTo = ({ link, title }) => createLink(link, title, [prefix], from);
    const result = create("li", {}, linkTo(shown), " ",
        create("span", {}, labels[prefix].slice(lookups.length > 1 ? 0 : set.length + 1)),
        create("p", {}, ...shown.pieces.map((piece, i) => (i % 2 === 1 ? create("mark", {}, piece) : piece))),
        create("ul", {}, ...shown.places.map((place) => create("li", {}, linkTo(place)))));
    result.querySelector(shown.isPlaceMeant ? "ul a" : "a").classList.add("pagemeld-best");
    return result;
}

// For Back, and for readers who copy the address. A link within the page closes the dialog.
function keepQuery({ target }) {
    const address = new URL(document.URL);
    address.searchParams.delete("pagemeld");
    if (box.value && (place || dialog.open)) {
        address.searchParams.set("pagemeld", box.value);
    }
    chosen = target.closest("a");
    const state = { module: filter.value, shown: results.childElementCount, chosen: chosen?.href };
    history.replaceState({ ...history.state, pagemeld: state }, "", address);
    if (chosen?.href.split("#")[0] === document.URL.split("#")[0]) {
        dialog.close();
    }
}

// As it was when the reader left, unless something else is typed meanwhile.
async function restoreQuery() {
    box.value = query;
    await needIndex();
    if (before && box.value === query) {
        filter.value = before.module;
        update();
        showResults(before.shown);
        [...results.querySelectorAll("a")].find(({ href }) => href === before.chosen)?.focus();
    }
}

async function loadContents() {
    const [{ toc }, prefixes] = await run(`${docdata}global_toc.js`);
    if (!toc) {
        contents.textContent = "Contents are not available: global_toc.js did not run";
        return;
    }
    const root = decode(new URL("..", docdata).pathname);
    const page = decode(location.pathname.replace(/\/$/, "/index.html")).slice(root.length);
    const way = findWay(toc.children, page) ?? [];
    const list = create("ul", language, ...toc.children.map((node) => createEntry(node, way, prefixes)));
    contents.append(create("p", language, toc.title), list);
}

// Returns the nodes down to the first that leads to a page, or null.
function findWay(nodes, page) {
    for (const node of nodes ?? []) {
        const below = node.link.split("#", 1)[0] === page ? [] : findWay(node.children, page);
        if (below) {
            return [node, ...below];
        }
    }
    return null;
}

// Makes the entries below when it is opened, as it is on the way to this page.
function createEntry(node, way, prefixes) {
    const { link, title, children } = node;
    const name = link === "null" ? "" : createLink(link, title, prefixes);
    if (node === way.at(-1)) {
        name.setAttribute("aria-current", "page");
        setTimeout(showCurrent);
    }
    if (!children?.length) {
        return create("li", {}, name || title);
    }
    const list = create("ul", {});
    const summary = name ? create("summary", { "aria-label": `Below ${title}` }) : create("summary", {}, title);
    const details = create("details", {}, summary, list);
    const fill = () => { list.append(...children.map((child) => createEntry(child, way, prefixes))); };
    details.addEventListener("toggle", fill, { once: true });
    details.open = way.includes(node);
    return create("li", {}, name, details);
}

function showCurrent() {
    if (dialog.open) {
        contents.querySelector("[aria-current]")?.scrollIntoView({ block: "center" });
    }
}

// A link is a path on disk, even "javascript:"; only "#" has a meaning. A prefix may precede a whole address.
function createLink(link, title, prefixes, from = docdata) {
    const { length } = prefixes.find((prefix) => link.startsWith(prefix)) ?? "";
    const end = `${link}#`.indexOf("#", length);
    const path = link.slice(0, end).replace(/[\0- %?#\\]/g, encodeURIComponent) + link.slice(end);
    const isAddress = /^(https?|ftp|mailto):(?!:)/i.test(link.slice(length));
    const href = isAddress ? link.slice(length) : new URL("..", from).href + path;
    return create("a", { href, target: "_self" }, title.trim() || link);
}

const nameOf = ({ pathname }) => decode(pathname.split("/").at(-3) ?? ""); // of a module, or of a docdata's set
const decode = (text) => { try { return decodeURIComponent(text); } catch { return text; } }; // not UTF-8

// Runs scripts in a frame that stays. Returns its window, and the values of p0, p1, ..., longest first.
async function run(...addresses) {
    const frame = create("iframe", { hidden: "" });
    await loaded(frame, view);
    for (const src of addresses) {
        await loaded(create("script", { src }), frame.contentDocument.head);
    }
    const source = frame.contentWindow;
    const prefixes = Object.keys(source).filter((key) => /^p\d+$/.test(key)).map((key) => source[key]);
    return [source, prefixes.sort((a, b) => b.length - a.length)];
}

// Runs a generator, and lets the reader's events pass.
async function finish(steps) {
    let step = steps.next();
    for (let end = 0; !step.done; step = steps.next()) {
        if (performance.now() > end) {
            await new Promise((done) => { setTimeout(done); });
            end = performance.now() + 30; // ms
        }
    }
    return step.value;
}

function once(act) {
    let result;
    return () => (result ??= act());
}

const loaded = (element, parent) =>
    new Promise((done) => { element.onload = element.onerror = done; parent.append(element); });

function create(name, attributes, ...children) {
    const element = document.createElementNS("http://www.w3.org/1999/xhtml", name);
    Object.entries(attributes).forEach(([key, value]) => element.setAttribute(key, value));
    element.append(...children);
    return element;
}

const style = create("link", { rel: "stylesheet", href: new URL("pagemeld.css", ownAddress) });
if (document.body.localName === "body") { // not a frame set
    loaded(style, document.head).then(start);
}
}(document.currentScript, history.state?.pagemeld)); // read before Sphinx's scripts replace it
