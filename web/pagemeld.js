// Search and contents of all modules, in a documentation page: in its own <div id="pagemeld">, or else in a dialog that
// a button in a corner opens. A page on disk can't fetch anything, so the outputs run as classic scripts, in hidden
// frames: a page's own "const p0" would make their globals a syntax error. They load when they are needed. Titles and
// texts enter the page as text only.

(function () {
    "use strict";

    const RESULTS_AT_ONCE = 10;
    const SLICE = 30; // ms of work without a pause
    const OTHER_SET = { Manual: "ScriptReference", ScriptReference: "Manual" };

    const tag = document.currentScript;
    const ownAddress = new URL(tag.getAttribute("src"), document.URL); // a <base> is to come after the tag
    const docdata = new URL(tag.dataset.docdata?.replace(/\/?$/, "/") ?? new URL(".", ownAddress), document.URL);

    const language = { lang: document.documentElement.lang }; // of what is not the view's own words
    const box = create("input", { type: "search", autocomplete: "off", spellcheck: "false" });
    const filter = create("select", language, create("option", { value: "", lang: "en" }, "All"));
    const form = create("form", { role: "search", "aria-label": "All modules" },
        create("label", {}, "Search all modules ", box), create("label", { hidden: "" }, "Search in ", filter));
    const status = create("p", { role: "status" });
    const results = create("ul", { class: "pagemeld-results", ...language });
    const more = create("button", { hidden: "" }, "More results");
    const contents = create("nav", { "aria-label": "All modules" });
    const tabs = ["Search", "Contents"].map((name) => create("button", { role: "tab" }, name));
    const view = create("div", { class: "pagemeld-view", lang: "en", role: "region", "aria-label": "All modules" },
        create("div", { role: "tablist", "aria-label": "Parts" }, ...tabs),
        create("div", { class: "pagemeld-finder" }, form, status, results, more), contents);
    const dialog = create("dialog", { id: "pagemeld", "aria-label": "All modules" });

    let kept = history.state?.pagemeld; // before the page's own scripts replace it, as Sphinx's do
    const needIndex = once(loadIndexes);
    const needContents = once(loadContents);
    const lookups = []; // of the sets that are loaded, the own one first
    let search; // the functions of the search file
    let found = { pages: [] };
    let isDialogKey = false;
    let placeOfPage; // below the dialog

    async function start() {
        const query = new URLSearchParams(location.search).get("pagemeld");
        const isSeenAtOnce = query || document.querySelector("div#pagemeld");
        if (document.readyState === "loading" || (!isSeenAtOnce && document.readyState !== "complete")) {
            await new Promise((done) => { addEventListener("load", done); }); // XHTML does not defer scripts
        }
        const place = document.querySelector("div#pagemeld");
        if (document.body?.localName !== "body") {
            return; // a frame set
        }
        await loaded(create("link", { rel: "stylesheet", href: new URL("pagemeld.css", ownAddress) }), document.head);
        listen();
        selectTab(tabs[0]);
        matchPage(place ? fillPlace(place) : fillCorner());
        if (query) {
            restoreQuery(query);
            openView();
        }
    }

    // In a place of the page, with a link that leads past it.
    function fillPlace(place) {
        const end = create("span", { tabindex: "-1" });
        const skip = create("a", { href: "#pagemeld", class: "pagemeld-skip" }, "Skip search and contents");
        skip.onclick = (event) => {
            event.preventDefault();
            end.focus();
        };
        view.prepend(skip);
        place.append(view, end);
        (window.requestIdleCallback ?? setTimeout)(needContents);
        return place;
    }

    // In a dialog, whose edge outside the view closes it.
    function fillCorner() {
        const opener = create("button",
            { class: "pagemeld-open", "aria-keyshortcuts": "/", "data-corner": tag.dataset.corner ?? "" },
            "Search all modules ", create("kbd", { "aria-hidden": "true" }, "/"));
        const close = create("button", { class: "pagemeld-close", "aria-label": "Close" }, "\u00d7");
        const corner = create("div", { id: "pagemeld-corner", role: "region", "aria-label": "Search", lang: "en" },
            opener, dialog);
        view.append(close);
        dialog.append(view);
        document.body.append(corner);
        opener.onclick = openView;
        dialog.onclose = () => { keepQuery(); };
        dialog.onmousedown = ({ target }) => { if (target === dialog) { dialog.close(); } };
        close.onclick = () => { dialog.close(); };
        addEventListener("scroll", () => { if (dialog.open) { scrollTo(placeOfPage); } }); // WebKit's keys scroll it
        return corner;
    }

    // Light text is on a dark page, whose theme an attribute of the root or the body may switch. What the system says
    // decides where the color is not given as red, green, and blue.
    function matchPage(home) {
        const systemIsDark = matchMedia("(prefers-color-scheme: dark)");
        const match = () => {
            const { color } = getComputedStyle(home.parentElement);
            const [red, green, blue] = /^rgb/.test(color) ? color.match(/[\d.]+/g) : [];
            const isDark = blue === undefined ? systemIsDark.matches : 0.21 * red + 0.72 * green + 0.07 * blue > 127;
            home.style.colorScheme = isDark ? "dark" : "light";
        };
        const observer = new MutationObserver(match);
        [document.documentElement, document.body].forEach((part) => observer.observe(part, { attributes: true }));
        systemIsDark.onchange = match;
        match();
    }

    function listen() {
        addEventListener("pageshow", focusChosen); // Back to a page that the browser kept may lose the focus
        addEventListener("keydown", onKey);
        ["keydown", "keypress", "keyup"].forEach((type) => addEventListener(type, onDialogKey, true));
        box.onfocus = needIndex;
        box.onblur = () => { keepQuery(); };
        box.oninput = filter.onchange = update;
        more.onclick = showMore;
        view.onclick = onClick;
        form.onsubmit = (event) => {
            event.preventDefault();
            results.querySelector(".pagemeld-best")?.click();
        };
        tabs.forEach((tab) => { tab.onclick = () => { selectTab(tab); }; });
    }

    function openView() {
        if (dialog.isConnected && !dialog.open) {
            placeOfPage = { left: scrollX, top: scrollY, behavior: "instant" };
            dialog.showModal();
            needContents();
        }
        box.focus();
        box.select();
    }

    // Tabs choose one of the parts where there is no room for both.
    function selectTab(chosen) {
        tabs.forEach((tab) => tab.setAttribute("aria-selected", tab === chosen));
        view.classList.toggle("pagemeld-at-contents", chosen === tabs[1]);
        showCurrent(contents);
    }

    // A link within this page does not leave it, but the dialog.
    function onClick({ target }) {
        const link = target.closest("a");
        if (link) {
            keepQuery(link.href);
        }
        if (link?.href.split("#")[0] === document.URL.split("#")[0]) {
            dialog.close();
        }
    }

    // The page does not see the keys that are pressed while the dialog is open, nor how the last one is let go.
    function onDialogKey(event) {
        isDialogKey = event.type === "keydown" ? dialog.open : isDialogKey;
        if (isDialogKey) {
            event.stopPropagation();
            onKey(event);
        }
    }

    function onKey(event) {
        const isTaken = event.ctrlKey || event.altKey || event.metaKey || event.isComposing || event.defaultPrevented;
        if (event.type === "keydown" && !isTaken && actOn(event.key, event.composedPath()[0])) {
            event.preventDefault();
        }
    }

    // Arrows lead through the results, "/" to the box, as Escape does in a place of the page. Returns whether it acted.
    function actOn(key, target) {
        const stops = [box, ...results.querySelectorAll("a"), more];
        const next = stops.includes(target) && stops[stops.indexOf(target) + { ArrowDown: 1, ArrowUp: -1 }[key]];
        const isTyped = target.isContentEditable || /^(input|textarea|select)$/.test(target.localName);
        if (next) {
            next.focus();
        } else if (key === "Escape" && dialog.open) {
            dialog.close();
        } else if (key === "Escape" ? view.contains(target) : key === "/" && !isTyped) {
            openView();
        } else {
            return false;
        }
        return true;
    }

    // The set being read, then the other one, unless the tag names the sets to search and leaves it out. The contents end
    // with the other set: its first page of this module.
    async function loadIndexes() {
        status.textContent = "Loading the search index";
        if (!await addIndex(docdata)) {
            status.textContent = "Search is not available: global_index.js did not run";
            return;
        }
        const set = OTHER_SET[lookups[0].set];
        const from = new URL(`../../${set}/docdata/`, docdata);
        if (set && (tag.dataset.sets ?? set).includes(set) && await addIndex(from)) {
            const first = lookups[1].pages[lookups[1].prefixes.indexOf("")];
            await needContents();
            contents.append(first ? createLink(first[0], set, [], from) : "");
        }
    }

    // Adds the search index in a docdata. The results that are shown stay where they are. Returns whether the index ran.
    async function addIndex(from) {
        const [source, all] = await run(`${from}global_index.js`, new URL("pagemeld-search.js", ownAddress));
        const hasRun = ["pages", "info", "common", "searchIndex", "prepareIndex"].every((name) => source[name]);
        if (hasRun) {
            const nameOfModule = (prefix) => [prefix, nameOf(createLink(prefix, "", [prefix], from), -3)];
            const modules = Object.fromEntries(["", ...all].map(nameOfModule));
            search = source;
            lookups.push({ ...await finish(source.prepareIndex(source, all)), from, set: nameOf(from, -3), modules });
            addToFilter(lookups.at(-1));
            findAll(found.pages.slice(0, results.childElementCount));
        }
        return hasRun;
    }

    function addToFilter({ set, modules }) {
        const values = new Set([set, ...Object.values(modules).map((name) => `${set}/${name}`).sort()]);
        filter.append(...Array.from(values, (value) => create("option", { value }, value)));
        filter.parentElement.hidden = filter.length < 4; // all, this set, and one module are the same
    }

    // Whether a page is in the set or module that is chosen.
    const accepts = ({ set, modules, prefixes }, page) =>
        ["", set, `${set}/${modules[prefixes[page]]}`].includes(filter.value);

    function update() {
        if (lookups.length > 0) {
            results.replaceChildren();
            findAll([]);
        }
    }

    function findAll(shown) {
        const isShown = ({ page, asked }) =>
            shown.some((one) => one.page === page && one.asked.lookup === asked.lookup);
        found = search.findPages(lookups, box.value, accepts);
        found.pages = shown.concat(found.pages.filter((page) => !isShown(page)));
        const { length } = found.pages;
        const whole = found.pages.filter(({ isWhole }) => isWhole).length;
        const count = ["Nothing", "1 page"][length] ?? `${length} pages`;
        const rest = whole === length ? "" : `, ${whole || "none"} with all words`;
        status.textContent = found.words.length > 0 ? `${count} found${rest}` : "";
        showResults(shown.length);
    }

    function showResults(count) {
        const next = found.pages.slice(results.childElementCount, Math.max(count, RESULTS_AT_ONCE));
        results.append(...next.map(createResult));
        more.hidden = results.childElementCount === found.pages.length;
    }

    function showMore() {
        const shown = results.childElementCount;
        showResults(shown + RESULTS_AT_ONCE);
        results.children[shown].querySelector("a").focus();
    }

    function createResult(page) {
        const { set, modules, from, prefixes } = page.asked.lookup;
        const prefix = prefixes[page.page];
        const shown = search.describePage(page);
        const linkTo = ({ link, title }) => createLink(link, title, [prefix], from);
        const result = create("li", {}, linkTo(shown), " ",
            create("span", {}, lookups.length > 1 ? `${modules[prefix]}, ${set}` : modules[prefix]),
            create("p", {}, ...shown.pieces.map((piece, i) => (i % 2 === 1 ? create("mark", {}, piece) : piece))),
            create("ul", {}, ...shown.places.map((place) => create("li", {}, linkTo(place)))));
        result.querySelector(shown.isPlaceMeant ? "ul a" : "a").classList.add("pagemeld-best");
        return result;
    }

    // Writes the query of an open view into the address, and what was chosen into the history, so that Back finds it.
    function keepQuery(chosen) {
        box.defaultValue = box.value; // to which WebKit resets the box after Back
        const query = dialog.isConnected && !dialog.open ? "" : box.value.trim();
        const address = new URL(document.URL);
        const others = address.search.replace(/[?&]pagemeld=[^&]*/, "");
        address.search = others + (query ? `${others && "&"}pagemeld=${encodeURIComponent(query)}` : "");
        kept = { module: filter.value, shown: results.childElementCount, chosen };
        history.replaceState({ ...history.state, pagemeld: kept }, "", address.href);
    }

    // Once the indexes are there: as it was when the reader left for a result, unless a query is typed meanwhile.
    async function restoreQuery(query) {
        const before = kept;
        box.value = query;
        await needIndex();
        if (before && box.value === query) {
            kept = before;
            filter.value = kept.module;
            update();
            showResults(kept.shown);
            focusChosen();
        }
    }

    function focusChosen() {
        [...results.querySelectorAll("a")].find(({ href }) => href === kept?.chosen)?.focus();
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
        showCurrent(contents);
    }

    // The nodes of the contents down to the first that leads to a page, or null.
    function findWay(nodes, page) {
        for (const node of nodes ?? []) {
            const below = node.link.split("#", 1)[0] === page ? [] : findWay(node.children, page);
            if (below) {
                return [node, ...below];
            }
        }
        return null;
    }

    // An entry of the contents. Those below it are made when it is opened, as it is on the way to this page.
    function createEntry(node, way, prefixes) {
        const { link, title, children } = node;
        const name = link === "null" ? "" : createLink(link, title, prefixes);
        if (node === way.at(-1)) {
            name.setAttribute("aria-current", "page");
        }
        if (!children?.length) {
            return create("li", {}, name || title);
        }
        const list = create("ul", {});
        const summary = name ? create("summary", { "aria-label": `Below ${title}` }) : create("summary", {}, title);
        const details = create("details", {}, summary, list);
        const fill = () => {
            list.append(...children.map((child) => createEntry(child, way, prefixes)));
            showCurrent(list);
        };
        details.addEventListener("toggle", fill, { once: true });
        details.open = way.slice(0, -1).includes(node);
        return create("li", {}, name, details);
    }

    function showCurrent(part) {
        if (dialog.open) {
            part.querySelector("[aria-current]")?.scrollIntoView({ block: "center" });
        }
    }

    // A link is a path on disk, in which only "#" has a meaning: "File:a.html" and "javascript:" are names of files.
    // The outputs put the prefix before whole addresses too.
    function createLink(link, title, prefixes, from = docdata) {
        const { length } = prefixes.find((prefix) => link.startsWith(prefix)) ?? "";
        const end = `${link}#`.indexOf("#", length);
        const path = link.slice(0, end).replace(/[\0- %?#\\]/g, encodeURIComponent) + link.slice(end);
        const isAddress = /^(https?|ftp|mailto):(?!:)/i.test(link.slice(length));
        const href = isAddress ? link.slice(length) : new URL("..", from).href + path;
        return create("a", { href, target: "_self" }, title.trim() || link);
    }

    // The names of a module and of its set are the last two of its directories.
    const nameOf = ({ pathname }, level) => decode(pathname.split("/").at(level) ?? "");
    const decode = (text) => { try { return decodeURIComponent(text); } catch { return text; } }; // not UTF-8

    // Runs scripts in a hidden frame that stays, so that its functions and values can be used. Returns its window, and
    // the values of p0, p1, ..., longest first. What a script assigned tells whether it ran.
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

    // Runs a generator, and makes way for the reader's events now and then. Returns its result.
    async function finish(steps) {
        let step = steps.next();
        for (let end = 0; !step.done; step = steps.next()) {
            if (performance.now() > end) {
                await new Promise((done) => { setTimeout(done); });
                end = performance.now() + SLICE;
            }
        }
        return step.value;
    }

    // Does something at the first call, and returns the same at each.
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

    start();
}());
