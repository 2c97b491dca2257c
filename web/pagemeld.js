// Search and contents of all modules, in a documentation page.
//
// The view is in the page's own <div id="pagemeld">, or else in a dialog that a button in a corner opens. A page on disk
// can't fetch anything, so the outputs run as classic scripts, in hidden frames: a page's own "const p0" would make
// their globals a syntax error. The contents load when they are seen, the search index when the reader turns to the box.
// Titles and texts enter the page as text only.

(function () {
    "use strict";

    const RESULTS_AT_ONCE = 10;
    const SLICE = 30; // ms of work without a pause
    const SETS = ["Manual", "ScriptReference"];

    const tag = document.currentScript; // a later <base> did not change where it led
    const isBeforeBase = document.querySelector("base[href]")?.compareDocumentPosition(tag) & 2;
    const ownAddress = new URL(tag.getAttribute("src"), isBeforeBase ? document.URL : document.baseURI).href;
    const shared = tag.dataset.docdata?.replace(/\/?$/, "/");
    const docdata = shared ? new URL(shared, document.URL).href : new URL(".", ownAddress).href;
    const ownSet = nameOf(docdata, -3);
    const otherSet = SETS[1 - SETS.indexOf(ownSet)]; // none of a directory with another name

    const language = { lang: document.documentElement.lang }; // of what is not the view's own words
    const box = create("input", { type: "search", autocomplete: "off", spellcheck: "false" });
    const filter = create("select", language, create("option", { value: "", lang: "en" }, "All"));
    const filterLabel = create("label", {}, "Search in ", filter);
    const form = create("form", { role: "search", "aria-label": "All modules" },
        create("label", {}, "Search all modules ", box));
    const status = create("p", { role: "status" });
    const results = create("ul", { class: "pagemeld-results", ...language });
    const more = create("button", { type: "button", hidden: "" }, "More results");
    const finder = create("div", { class: "pagemeld-finder" }, form, status, results, more);
    const contents = create("div", { class: "pagemeld-contents", ...language });
    const nav = create("nav", { "aria-label": "All modules" }, contents);
    const tabs = ["Search", "Contents"].map((name) => create("button", { type: "button", role: "tab" }, name));
    const tabList = create("div", { role: "tablist", class: "pagemeld-tabs", "aria-label": "Parts" }, ...tabs);
    const view = create("div", { class: "pagemeld-view", lang: "en", role: "region", "aria-label": "All modules" },
        tabList, finder, nav);
    const opener = create("button", { type: "button", class: "pagemeld-open", "aria-keyshortcuts": "/" },
        "Search all modules ", create("kbd", { "aria-hidden": "true" }, "/"));
    const dialog = create("dialog", { "aria-label": "All modules" });
    const corner = create("div", { id: "pagemeld-corner", role: "region", "aria-label": "Search", lang: "en" },
        opener, dialog);

    const systemIsDark = matchMedia("(prefers-color-scheme: dark)");
    const needIndex = once(loadLookups);
    const needContents = once(loadContents);
    const lookups = []; // of the sets that are loaded, the own one first
    let search; // the functions of the search file
    let found = { pages: [] };
    let isDialogKey = false;
    let home = corner; // where the view is

    function create(name, attributes, ...children) {
        const element = document.createElementNS("http://www.w3.org/1999/xhtml", name);
        Object.entries(attributes).forEach(([key, value]) => element.setAttribute(key, value));
        element.append(...children);
        return element;
    }

    // Does something at the first call, and returns the same at each.
    function once(act) {
        let result;
        return () => (result ??= act());
    }

    const happened = (target, type) => new Promise((done) => { target.addEventListener(type, done, { once: true }); });

    const loaded = (element, parent) =>
        new Promise((done) => { element.onload = element.onerror = done; parent.append(element); });

    // Runs scripts in a hidden frame that stays, so that their functions and values can be used. Returns its window. A
    // script that fails is loaded too: what it assigned tells whether it ran.
    async function runScripts(...addresses) {
        const frame = create("iframe", { hidden: "" });
        await loaded(frame, view);
        for (const address of addresses) {
            await loaded(create("script", { src: address }), frame.contentDocument.head);
        }
        return frame.contentWindow;
    }

    // The values of p0, p1, ... that an output assigned, longest first.
    function prefixesOf(source) {
        const names = Object.keys(source).filter((key) => /^p\d+$/.test(key));
        return names.map((name) => source[name]).sort((a, b) => b.length - a.length);
    }

    function decode(text) {
        try {
            return decodeURIComponent(text);
        } catch {
            return text; // not UTF-8
        }
    }

    // A directory in an address: the module, "charts", is the fourth from the end of ".../charts/Manual/docdata/".
    function nameOf(address, level) {
        return decode(new URL(address).pathname.split("/").at(level) ?? "");
    }

    // A link is a path on disk, in which only "#" has a meaning: "File:a.html" and "javascript:" are names of files.
    // The outputs put the prefix before whole addresses too.
    function addressOf(link, prefix, from = docdata) {
        const rest = link.slice(prefix.length);
        if (/^(https?|ftp|mailto):(?!:)/i.test(rest)) {
            return rest;
        }
        const end = `${link}#`.indexOf("#", prefix.length);
        return new URL("..", from).href + link.slice(0, end).replace(/[\0- %?#\\]/g, encodeURIComponent) + link.slice(end);
    }

    const createLink = (link, title, prefix, from) =>
        create("a", { href: addressOf(link, prefix, from), target: "_self" }, title.trim() || link);

    // Runs a generator, and makes way for the reader's events now and then. Returns its result.
    async function finish(steps) {
        for (let end = 0, step = {}; ; step = steps.next()) {
            if (step.done) {
                return step.value;
            }
            if (performance.now() > end) {
                await new Promise((done) => { setTimeout(done); });
                end = performance.now() + SLICE;
            }
        }
    }

    // Loads the search index of a set from its docdata. Returns null if it did not run.
    async function loadLookup(set, from) {
        const source = await runScripts(`${from}global_index.js`, new URL("pagemeld-search.js", ownAddress).href);
        if (!["pages", "info", "common", "searchIndex", "prepareIndex"].every((name) => source[name])) {
            return null;
        }
        search = source;
        const prefixes = prefixesOf(source);
        const moduleOf = (prefix) => nameOf(addressOf(`${prefix}docdata/`, prefix, from), -4);
        const modules = Object.fromEntries(["", ...prefixes].map((prefix) => [prefix, moduleOf(prefix)]));
        return { ...await finish(source.prepareIndex(source, prefixes)), set, from, modules };
    }

    // Loads the set being read, then the other one, unless the tag names the sets to search and leaves it out.
    async function loadLookups() {
        status.textContent = "Loading the search index";
        const own = await loadLookup(ownSet, docdata);
        if (!own) {
            status.textContent = "Search is not available: global_index.js did not run";
            return;
        }
        join(own);
        if (otherSet && (tag.dataset.sets ?? otherSet).includes(otherSet)) {
            const other = await loadLookup(otherSet, new URL(`../../${otherSet}/docdata/`, docdata).href);
            if (other) {
                join(other);
                offerSet(other);
            }
        }
    }

    // The results that are shown stay where they are; those of the other set come after them.
    function join(lookup) {
        lookups.push(lookup);
        addToFilter(lookup);
        const shown = found.pages.slice(0, results.childElementCount);
        const isSame = (a, b) => a.page === b.page && a.weighed.lookup === b.weighed.lookup;
        findAll();
        found.pages = [...shown, ...found.pages.filter((page) => !shown.some((other) => isSame(page, other)))];
        showResults(Math.max(shown.length, RESULTS_AT_ONCE));
    }

    function addToFilter({ set, modules }) {
        const names = Object.values(modules).sort().filter((name, i, all) => name !== all[i - 1]);
        const options = names.map((name) => create("option", { value: `${set}/${name}` }, name));
        filter.append(create("optgroup", { label: set }, create("option", { value: set }, `All of ${set}`), ...options));
        if (lookups.length > 1 || names.length > 1) {
            form.append(filterLabel);
        }
    }

    // The last entry of the contents leads to the other set: to its first page of the own module, or else of all.
    function offerSet({ set, from, pages, prefixes }) {
        const first = Math.max(0, prefixes.indexOf(""));
        if (first < pages.length) {
            nav.append(createLink(pages[first][0], set, prefixes[first], from));
        }
    }

    // Whether a page is in the set or module that is chosen.
    const accepts = ({ set, modules, prefixes }, page) =>
        ["", set, `${set}/${modules[prefixes[page]]}`].includes(filter.value);

    function findAll() {
        found = search.findPages(lookups, box.value, accepts);
        const { query, pages } = found;
        const whole = pages.filter(({ isWhole }) => isWhole).length;
        const count = pages.length === 1 ? "1 page" : `${pages.length || "No"} pages`;
        const rest = whole === pages.length ? "" : `, ${whole || "none"} with all words`;
        status.textContent = query.keys.length > 0 ? `${count} found${rest}` : "";
    }

    function update() {
        if (lookups.length > 0) {
            findAll();
            results.replaceChildren();
            showResults(RESULTS_AT_ONCE);
        }
    }

    function showResults(count) {
        results.append(...found.pages.slice(results.childElementCount, count).map(createResult));
        more.hidden = results.childElementCount === found.pages.length;
    }

    function showMore() {
        const shown = results.childElementCount;
        showResults(shown + RESULTS_AT_ONCE);
        results.children[shown].querySelector("a").focus();
    }

    function createResult(page) {
        const { set, modules, from, prefixes } = page.weighed.lookup;
        const prefix = prefixes[page.page];
        const shown = search.describePage(page, found.query);
        const linkTo = ({ link, title }) => createLink(link, title, prefix, from);
        const result = create("li", {}, linkTo(shown), " ",
            create("span", {}, lookups.length > 1 ? `${modules[prefix]}, ${set}` : modules[prefix]),
            create("p", {}, ...shown.pieces.map((piece, i) => (i % 2 === 1 ? create("mark", {}, piece) : piece))),
            create("ul", {}, ...shown.places.map((place) => create("li", {}, linkTo(place)))));
        result.querySelector(shown.isPlaceMeant ? "ul a" : "a").classList.add("pagemeld-best");
        return result;
    }

    const linksFound = () => [...results.querySelectorAll("a")];

    // Writes the query of an open view into the address, and which module and link were chosen into the entry of the
    // history, so that Back finds them. The rest of both is the page's.
    function keepQuery(chosen) {
        box.defaultValue = box.value; // to which WebKit resets the box after Back
        const query = dialog.isConnected && !dialog.open ? "" : box.value.trim();
        const address = new URL(document.URL);
        const others = address.search.slice(1).split("&").filter((part) => part && !part.startsWith("pagemeld="));
        address.search = others.concat(query ? `pagemeld=${encodeURIComponent(query)}` : []).join("&");
        const kept = { module: filter.value, shown: results.childElementCount, chosen };
        history.replaceState({ ...history.state, pagemeld: kept }, "", address.href);
    }

    // Once the indexes are there: as it was when the reader left for a result.
    async function restoreQuery(query) {
        box.value = query;
        await needIndex();
        const { module = "", shown = 0, chosen } = history.state?.pagemeld ?? {};
        if (box.value === query) {
            filter.value = module;
            update();
            showResults(Math.max(shown, RESULTS_AT_ONCE));
            linksFound().find(({ href }) => href === chosen)?.focus();
        }
    }

    // Whether a link of the contents leads to this page. Takes few links apart.
    function isThisPage(link, prefix) {
        const pathOf = ({ pathname }) => decode(pathname.replace(/\/$/, "/index.html"));
        const path = pathOf(location);
        return link.includes(path.split("/").at(-1)) && pathOf(create("a", { href: addressOf(link, prefix) })) === path;
    }

    // The nodes down to the first whose link passes the test, or null.
    function findWay(nodes, test) {
        for (const node of nodes ?? []) {
            const below = test(node.link) ? [] : findWay(node.children, test);
            if (below) {
                return [node, ...below];
            }
        }
        return null;
    }

    // An entry of the contents. Those below it are made when it is opened, or at once on the way to this page.
    function createEntry(node, way, prefixOf) {
        const { link, title, children } = node;
        const name = link === "null" ? "" : createLink(link, title, prefixOf(link));
        if (node === way.at(-1)) {
            name.setAttribute("aria-current", "page");
        }
        if (!children?.length) {
            return create("li", {}, name || title);
        }
        const list = create("ul", {});
        const summary = name ? create("summary", { "aria-label": `Below ${name.text}` }) : create("summary", {}, title);
        const details = create("details", {}, summary, list);
        const fill = () => list.append(...children.map((child) => createEntry(child, way, prefixOf)));
        if (way.slice(0, -1).includes(node)) {
            fill();
            details.open = true;
        } else {
            details.addEventListener("toggle", fill, { once: true });
        }
        return create("li", {}, name, details);
    }

    async function loadContents() {
        const source = await runScripts(`${docdata}global_toc.js`);
        if (!source.toc) {
            contents.textContent = "Contents are not available: global_toc.js did not run";
            return;
        }
        const { title, children } = source.toc;
        const prefixes = prefixesOf(source);
        const prefixOf = (link) => prefixes.find((prefix) => link.startsWith(prefix)) ?? "";
        const way = findWay(children, (link) => isThisPage(link, prefixOf(link))) ?? [];
        const entries = children.map((node) => createEntry(node, way, prefixOf));
        contents.append(create("p", {}, title), create("ul", {}, ...entries));
        showCurrent();
    }

    function showCurrent() {
        const current = contents.querySelector("[aria-current]") ?? contents;
        const above = current.getBoundingClientRect().top - contents.getBoundingClientRect().top;
        contents.scrollTop += above - contents.clientHeight / 2;
    }

    // Tabs choose one of the parts where there is no room for both.
    function selectTab(chosen) {
        tabs.forEach((tab) => tab.setAttribute("aria-selected", tab === chosen));
        view.classList.toggle("pagemeld-at-contents", chosen === tabs[1]);
        showCurrent();
    }

    const isTyped = (target) => target.isContentEditable || /^(input|textarea|select)$/.test(target.localName);

    // What a key does where it is pressed: "/" leads to the box, the arrows through the box and the results.
    function actOf({ key, shiftKey }, target) {
        const stops = [box, ...linksFound(), ...(more.hidden ? [] : [more])];
        const step = { ArrowDown: 1, ArrowUp: -1 }[key];
        const next = stops.includes(target) && !shiftKey ? stops[stops.indexOf(target) + step] : null;
        if (next) {
            return () => next.focus();
        }
        if (key === "/" && !isTyped(target)) {
            return openView;
        }
        if (key === "Escape" && dialog.open) {
            return () => dialog.close();
        }
        return key === "Escape" && view.contains(target) ? clear : null;
    }

    function onKey(event) {
        const isTaken = event.ctrlKey || event.altKey || event.metaKey || event.isComposing || event.defaultPrevented;
        const act = event.type === "keydown" && !isTaken ? actOf(event, event.composedPath()[0]) : null;
        if (act) {
            event.preventDefault();
            act();
        }
    }

    // The page does not see the keys that are pressed while the dialog is open, nor how the last one is let go.
    function onDialogKey(event) {
        if (event.type === "keydown") {
            isDialogKey = dialog.open;
        }
        if (isDialogKey) {
            event.stopPropagation();
            onKey(event);
        }
    }

    function clear() {
        box.value = "";
        update();
        box.focus();
    }

    function openView() {
        if (dialog.isConnected && !dialog.open) {
            holdPage();
            dialog.showModal();
            needContents();
        }
        box.focus();
        box.select();
    }

    // The page can't be scrolled while the dialog is open, unless that would move it: where a browser does not keep the
    // room of the scroll bar, and where the window's overflow is that of the body.
    function holdPage() {
        const { documentElement: root, body } = document;
        const width = root.offsetWidth;
        const isOfBody = getComputedStyle(body).overflowY !== "visible";
        root.classList.toggle("pagemeld-held", !isOfBody);
        root.classList.toggle("pagemeld-held", !isOfBody && root.offsetWidth === width);
    }

    // Light text is on a dark page. What the system says decides where the color is not given as red, green, and blue.
    function matchPage() {
        const { color } = getComputedStyle(home.parentElement);
        const [red, green, blue] = /^rgb/.test(color) ? color.match(/[\d.]+/g) : [];
        const isDark = blue === undefined ? systemIsDark.matches : 0.21 * red + 0.72 * green + 0.07 * blue > 127;
        home.classList.toggle("pagemeld-dark", isDark);
    }

    // Themes are switched by an attribute of the root or the body.
    function watchPage() {
        const observer = new MutationObserver(matchPage);
        [document.documentElement, document.body].forEach((part) => observer.observe(part, { attributes: true }));
        systemIsDark.onchange = matchPage;
        matchPage();
    }

    // In a place of the page, with a link that leads past it.
    function fillPlace(place) {
        const end = create("span", { tabindex: "-1" });
        const skip = create("a", { href: "#pagemeld", class: "pagemeld-skip" }, "Skip search and contents");
        skip.onclick = (event) => {
            event.preventDefault();
            end.focus();
        };
        home = place;
        view.prepend(skip);
        home.append(view, end);
        (window.requestIdleCallback ?? setTimeout)(needContents);
    }

    // The edge of the dialog, outside the view, closes it.
    function fillCorner() {
        const close = create("button", { type: "button", class: "pagemeld-close", "aria-label": "Close" }, "\u00d7");
        view.append(close);
        dialog.id = "pagemeld";
        dialog.append(view);
        opener.dataset.corner = tag.dataset.corner ?? "";
        document.body.append(corner);
        opener.onclick = openView;
        close.onclick = () => dialog.close();
        dialog.onmousedown = ({ target }) => {
            if (target === dialog) {
                dialog.close();
            }
        };
        dialog.onclose = () => {
            document.documentElement.classList.remove("pagemeld-held");
            keepQuery();
        };
        addEventListener("popstate", () => dialog.close()); // a link led to another place of this page
        ["keydown", "keypress", "keyup"].forEach((type) => addEventListener(type, onDialogKey, true));
    }

    function listen() {
        addEventListener("keydown", onKey);
        box.onfocus = () => { needIndex(); };
        box.oninput = filter.onchange = update;
        box.onblur = () => keepQuery();
        more.onclick = showMore;
        tabs.forEach((tab) => { tab.onclick = () => selectTab(tab); });
        view.onclick = ({ target }) => {
            const link = target.closest("a");
            if (link) {
                keepQuery(link.href);
            }
        };
        form.onsubmit = (event) => {
            event.preventDefault();
            results.querySelector(".pagemeld-best")?.click();
        };
    }

    async function start() {
        if (document.readyState === "loading") {
            await happened(document, "DOMContentLoaded");
        }
        if (document.body?.localName !== "body") {
            return; // a frame set
        }
        const place = document.getElementById("pagemeld");
        const query = new URLSearchParams(location.search).get("pagemeld");
        if (!place && !query && document.readyState !== "complete") {
            await happened(window, "load"); // which a style sheet would put off
        }
        const style = create("link", { rel: "stylesheet", href: new URL("pagemeld.css", ownAddress).href });
        await loaded(style, document.head ?? document.documentElement);
        listen();
        selectTab(tabs[0]);
        if (place) {
            fillPlace(place);
        } else {
            fillCorner();
        }
        watchPage();
        if (query) {
            restoreQuery(query);
        }
        if (query && !place) {
            openView();
        }
    }

    start();
}());
