// Search and contents of all modules, in a documentation page.
//
// A page on disk can't fetch anything, so the outputs run as classic scripts. A page's own "const p0" would make their
// globals a syntax error, so each runs in a hidden frame, removed once its values are taken. The contents load when the
// page is idle, the search index when the reader turns to the box. Titles and texts enter the page as text only.

(function () {
    "use strict";

    const RESULTS_AT_ONCE = 10;
    const SLICE = 30; // ms of work without a pause
    const SETS = ["Manual", "ScriptReference"];

    const resolve = createResolver();
    const tag = document.currentScript; // a later <base> did not change where it led
    const isBeforeBase = document.querySelector("base[href]")?.compareDocumentPosition(tag) & 2;
    const ownAddress = isBeforeBase ? resolve(tag.getAttribute("src"), document.URL).href : tag.src;
    const shared = tag.dataset.docdata;
    const docdata = shared ? resolve(shared.replace(/\/?$/, "/"), document.URL).href : resolve(".", ownAddress).href;
    const setFolder = resolve("..", docdata).href;

    const docdataName = docdata.slice(setFolder.length);

    const language = { lang: document.documentElement.lang }; // of what is not the view's own words
    const box = create("input", { type: "search", autocomplete: "off", spellcheck: "false" });
    const filter = create("select", language, create("option", { value: "", lang: "en" }, "All"));
    const form = create("form", { role: "search", "aria-label": "All modules" },
        create("label", {}, "Search all modules ", box));
    const status = create("p", { role: "status" });
    const results = create("ul", { class: "pagemeld-results", ...language });
    const more = create("button", { type: "button", hidden: "" }, "More results");
    const finder = create("div", { class: "pagemeld-finder" }, form, status, results, more);
    const contents = create("div", { class: "pagemeld-contents", ...language });
    const nav = create("nav", { "aria-label": "All modules" }, contents);
    const view = create("div", { class: "pagemeld-view", lang: "en", role: "region", "aria-label": "All modules" },
        finder, nav);
    const opener = create("button", { type: "button", class: "pagemeld-open", "aria-keyshortcuts": "/", lang: "en" },
        "Search all modules ", create("kbd", { "aria-hidden": "true" }, "/"));
    const dialog = create("dialog", { id: "pagemeld", "aria-label": "All modules", lang: "en" });

    const systemIsDark = matchMedia("(prefers-color-scheme: dark)");

    let isDialogKey = false;
    const indexes = []; // of the sets that are loaded, the own one first
    let found = { pages: [] };

    function create(name, attributes, ...children) {
        const element = document.createElementNS("http://www.w3.org/1999/xhtml", name);
        Object.entries(attributes).forEach(([key, value]) => element.setAttribute(key, value));
        element.append(...children);
        return element;
    }

    // Resolves an address against another, in a document of its own: a page may redefine URL and have a <base>.
    // The link that it returns is taken apart at once; the next call uses it again.
    function createResolver() {
        const inert = document.implementation.createHTMLDocument("");
        const base = inert.head.appendChild(inert.createElement("base"));
        const link = inert.createElement("a");
        return (address, from) => {
            base.href = from;
            link.href = address;
            return link;
        };
    }

    // Does something at the first call, and returns the same at each.
    function once(act) {
        let result;
        return () => (result ??= act());
    }

    const loaded = (element, parent) =>
        new Promise((done) => { element.onload = element.onerror = done; parent.append(element); });

    // A hidden document in UTF-8.
    async function openFrame() {
        const frame = create("iframe", {});
        frame.style.display = "none";
        await loaded(frame, view);
        return frame;
    }

    // Runs an output in a frame. Returns the named globals, null if one is missing, and p0, p1, ... as prefixes, longest
    // first. A script that throws has a load event too: what it assigned tells whether it ran.
    async function runOutput(frame, address, names, subject, complaint) {
        await loaded(create("script", { src: address }), frame.contentDocument.head);
        const source = frame.contentWindow;
        const prefixes = Object.keys(source).filter((key) => /^p\d+$/.test(key)).map((key) => source[key]);
        const isThere = names.every((name) => source[name] instanceof source.Object);
        const file = address.split("/").at(-1);
        complaint.textContent = isThere ? "" : `${subject} not available: ${file} did not run`;
        return {
            values: isThere ? Object.fromEntries(names.map((name) => [name, source[name]])) : null,
            prefixes: prefixes.sort((a, b) => b.length - a.length),
        };
    }

    const decode = (text) => { try { return decodeURIComponent(text); } catch { return text; } }; // not UTF-8
    const encode = (path, special) => path.replace(special, encodeURIComponent);
    const prefixOf = (link, prefixes) => prefixes.find((prefix) => link.startsWith(prefix)) || "";

    // A link is a path on disk, in which only "#" has a meaning: "File:a.html" and "javascript:" are names of files.
    // The outputs put the prefix before whole addresses too.
    function addressOf(link, prefixes, folder = setFolder) {
        const prefix = prefixOf(link, prefixes);
        const rest = link.slice(prefix.length);
        if (/^(https?|ftp|mailto):(?!:)/i.test(rest)) {
            return rest;
        }
        const end = `${rest}#`.indexOf("#");
        const path = encode(prefix, /[\0- %?#\\]/g) + encode(rest.slice(0, end), /[\0- %?\\]/g);
        return folder + path + rest.slice(end);
    }

    const createLink = (link, title, prefixes, folder) =>
        create("a", { href: addressOf(link, prefixes, folder), target: "_self" }, title.trim() || link);

    // The module directory: "charts" for ".../charts/Manual/".
    const nameOf = (address, level) => decode(resolve(address, docdata).pathname.split("/").at(level) ?? "");

    // Runs the index of a set and the search in a frame that stays: its functions are used. Null if the index did not
    // run. Makes way for the reader's events now and then.
    async function openIndex(folder, complaint) {
        const frame = await openFrame();
        const { values, prefixes } = await runOutput(frame, `${folder}${docdataName}global_index.js`,
            ["pages", "info", "common", "searchIndex"], "Search is", complaint);
        await loaded(create("script", { src: resolve("pagemeld-search.js", ownAddress).href }), frame.contentDocument.head);
        const { prepareIndex, Map } = frame.contentWindow;
        if (!values || !prepareIndex) {
            frame.remove();
            return null;
        }
        const names = new Map(["", ...prefixes].map((prefix) => [prefix, nameOf(addressOf(prefix, [prefix], folder), -3)]));
        const set = nameOf(folder, -2);
        const steps = prepareIndex(values, prefixes);
        for (let end = performance.now() + SLICE, step; ;) {
            step = steps.next();
            if (step.done) {
                return { search: frame.contentWindow, lookup: step.value, folder, prefixes, names, set };
            }
            if (performance.now() > end) {
                await new Promise((done) => setTimeout(done));
                end = performance.now() + SLICE;
            }
        }
    }

    const sourceOf = (lookup) => indexes.find((index) => index.lookup === lookup);
    const moduleOf = (lookup, page) => sourceOf(lookup).names.get(lookup.prefixes[page]);

    function createResult(page) {
        const { lookup } = page.weighed;
        const { folder, prefixes, set } = sourceOf(lookup);
        const shown = indexes[0].search.describePage(page, found.query);
        const linkTo = ({ link, title }) => createLink(link, title, prefixes, folder);
        const source = indexes.length > 1 ? `${moduleOf(lookup, page.page)}, ${set}` : moduleOf(lookup, page.page);
        const places = shown.places.map((place) => create("li", {}, linkTo(place)));
        const result = create("li", {}, linkTo(shown), " ", create("span", {}, source),
            create("p", {}, ...shown.pieces.map((piece, i) => (i % 2 === 1 ? create("mark", {}, piece) : piece))),
            places.length > 0 ? create("ul", {}, ...places) : "");
        if (shown.isPlaceMeant) {
            result.querySelector("ul a").dataset.asked = "";
        }
        return result;
    }

    // Returns the first result that it adds.
    function showMore() {
        const shown = results.childElementCount;
        results.append(...found.pages.slice(shown, shown + RESULTS_AT_ONCE).map(createResult));
        more.hidden = results.childElementCount === found.pages.length;
        return results.children[shown];
    }

    function describeFound({ query, pages }) {
        const count = pages.length;
        const whole = pages.filter(({ isWhole }) => isWhole).length;
        const rest = whole === count ? "" : `, ${whole || "none"} with all words`;
        return query.keys.length === 0 ? ""
            : count === 0 ? (query.isCommon ? "Only common words, which are not searched for" : "Nothing found") : (count === 1 ? "1 page found" : `${count} pages found`) + rest;
    }

    function accepts(lookup, page) {
        const { set } = sourceOf(lookup);
        return ["", set, `${set}/${moduleOf(lookup, page)}`].includes(filter.value);
    }

    function findAll() {
        found = indexes[0].search.findPages(indexes.map(({ lookup }) => lookup), box.value, accepts);
        status.textContent = describeFound(found);
    }

    function update() {
        if (indexes.length > 0) {
            findAll();
            results.replaceChildren();
            showMore();
        }
    }

    const isFirst = (value, i, values) => values.indexOf(value) === i;

    // The results that are shown stay where they are; those of the index come after them.
    function join(index) {
        indexes.push(index);
        const { set, names } = index;
        const modules = index.prefixes.map((prefix) => names.get(prefix)).filter(isFirst).sort();
        const options = modules.map((name) => create("option", { value: `${set}/${name}` }, name));
        filter.append(create("optgroup", { label: set }, create("option", { value: set }, `All of ${set}`), ...options));
        if (!filter.isConnected && (indexes.length > 1 || modules.length > 1)) {
            form.append(create("label", {}, "Search in ", filter));
        }
        const shown = found.pages.slice(0, results.childElementCount);
        findAll();
        const isShown = (page) => shown.some((other) => other.page === page.page && other.weighed.lookup === page.weighed.lookup);
        found.pages = [...shown, ...found.pages.filter((page) => !isShown(page))];
        showMore();
    }

    // The set being read, then the other one; data-sets names those that are searched.
    async function loadIndex() {
        status.textContent = "Loading the search index";
        const own = nameOf(setFolder, -2);
        const sets = (tag.dataset.sets ?? SETS.join(" ")).split(" ").filter((set) => set !== own && SETS.includes(own));
        for (const set of [own, ...sets]) {
            const folder = set === own ? setFolder : resolve(`../${set}/`, setFolder).href;
            const index = await openIndex(folder, set === own ? status : create("p", {}));
            if (index) {
                join(index);
            }
        }
    }

    const needIndex = once(loadIndex);
    const linksFound = () => [...results.querySelectorAll("a")];

    // Writes the query of an open view into the address, and which module and link were chosen into the entry of the
    // history, so that Back finds them. The rest of both is the page's.
    function keepQuery(chosen) {
        box.defaultValue = box.value; // to which WebKit resets the box after Back
        const query = dialog.isConnected && !dialog.open ? "" : box.value.trim();
        const address = resolve(document.URL, document.URL);
        const others = address.search.slice(1).split("&").filter((part) => part && !part.startsWith("pagemeld="));
        address.search = others.concat(query ? "pagemeld=" + encodeURIComponent(query) : []).join("&");
        const { state } = window.history;
        const kept = { module: filter.value, shown: results.childElementCount, chosen };
        window.history.replaceState(typeof state === "object" ? { ...state, pagemeld: kept } : state, "", address.href);
    }

    // Once the index is there: as it was when the reader left for a result.
    async function restoreQuery(query) {
        box.value = query;
        await needIndex();
        const { module = "", shown = 0, chosen } = window.history.state?.pagemeld ?? {};
        if (box.value === query) {
            filter.value = module;
            update();
            while (results.childElementCount < shown && !more.hidden) {
                showMore();
            }
            linksFound().find(({ href }) => href === chosen)?.focus();
        }
    }

    // A button that shows and hides a list, and calls fill before it shows an empty one.
    function createButton(title, list, fill = () => {}) {
        const button = create("button", { type: "button", "aria-expanded": "false" }, title);
        button.onclick = () => {
            if (!list.hasChildNodes()) {
                fill();
            }
            list.hidden = !list.hidden;
            button.setAttribute("aria-expanded", !list.hidden);
        };
        list.hidden = true;
        return button;
    }

    const pathOf = ({ pathname }) => decode(pathname.replace(/\/$/, "/index.html"));

    // Tests whether a link leads to this page. Takes few links apart.
    function createPageTest(prefixes) {
        const name = pathOf(location).split("/").at(-1);
        return (link) => {
            const address = link.includes(name) && create("a", { href: addressOf(link, prefixes) });
            return address && address.host === location.host && pathOf(address) === pathOf(location);
        };
    }

    // The nodes down to the first whose link passes the test, or null.
    function findWay(nodes, test) {
        for (const node of nodes || []) {
            const below = test(node.link) ? [] : findWay(node.children, test);
            if (below) {
                return [node, ...below];
            }
        }
        return null;
    }

    // The entries of a list. Those on the way to the page are opened.
    function createEntries(nodes, way, prefixes) {
        return nodes.map((node) => {
            const { link, title, children } = node;
            const isLink = link !== "null";
            const name = isLink ? createLink(link, title, prefixes) : create("span", {}, title.trim() || link);
            if (node === way.at(-1)) {
                name.setAttribute("aria-current", "page");
            }
            if (!children?.length) {
                return create("li", {}, name);
            }
            const list = create("ul", {});
            const button = createButton(isLink ? "" : name, list,
                () => list.append(...createEntries(children, way, prefixes)));
            if (isLink) {
                button.setAttribute("aria-label", `Below ${name.text}`);
            }
            if (way.slice(0, -1).includes(node)) {
                button.click();
            }
            return create("li", {}, button, isLink ? name : "", list);
        });
    }

    async function loadContents() {
        const frame = await openFrame();
        const { values, prefixes } = await runOutput(frame, `${docdata}global_toc.js`, ["toc"], "Contents are", contents);
        frame.remove();
        if (values) {
            const { toc } = values;
            const isPage = createPageTest(prefixes);
            const way = findWay(toc.children, (link) => !link.includes("#") && isPage(link)) ??
                findWay(toc.children, isPage) ?? [];
            const entries = createEntries(toc.children, way, prefixes);
            contents.append(create("p", {}, toc.title), create("ul", {}, ...entries));
            showCurrent();
        }
    }

    const needContents = once(loadContents);

    function showCurrent() {
        const current = contents.querySelector("[aria-current]");
        contents.scrollTop = current ? current.offsetTop - contents.clientHeight / 2 : 0;
    }


    const isPlain = (event) => !event.isComposing &&
        !["Control", "Alt", "Meta", "AltGraph"].some((key) => event.getModifierState(key));

    const isTyped = (target) => target.isContentEditable || /^(input|textarea|select)$/.test(target.localName);

    // "/" leads to the box, unless it is typed text or the page uses it.
    function onSlash(event) {
        if (event.key === "/" && !isTyped(event.composedPath()[0]) && !event.defaultPrevented && isPlain(event)) {
            event.preventDefault();
            openView();
        }
    }

    // Down and Up lead through the box and the results.
    function onArrow(event) {
        const stops = [box, ...linksFound(), ...(more.hidden ? [] : [more])];
        const at = stops.indexOf(event.target);
        const next = stops[at + { ArrowDown: 1, ArrowUp: -1 }[event.key]];
        if (at >= 0 && next && !event.shiftKey && isPlain(event)) {
            event.preventDefault();
            next.focus();
        }
    }

    // Escape closes the dialog. In a page's own place it leads to the box, and clears it there.
    function onEscape(event) {
        if (event.key !== "Escape" || !isPlain(event)) {
            return;
        }
        event.preventDefault();
        if (dialog.open) {
            dialog.close();
        } else if (event.target === box) {
            box.value = "";
            update();
        } else {
            box.focus();
        }
    }

    // The page does not see the keys that are pressed while the dialog is open, nor how the last one is let go.
    function onDialogKey(event) {
        if (event.type === "keydown") {
            isDialogKey = dialog.open;
        }
        if (isDialogKey) {
            event.stopPropagation();
        }
        if (isDialogKey && event.type === "keydown") {
            [onSlash, onArrow, onEscape].forEach((handle) => handle(event));
        }
    }

    // A link within this page does not leave it, but the dialog.
    function onLink(event) {
        const link = event.target.closest("a");
        if (link) {
            keepQuery(link.href);
            if (link.href.split("#")[0] === document.URL.split("#")[0] && dialog.open) {
                setTimeout(() => { dialog.close(); }); // writing the address now would stop the browser on its way
            }
        }
    }

    function listen() {
        addEventListener("keydown", onSlash);
        box.onfocus = needIndex;
        box.oninput = filter.onchange = update;
        box.onblur = () => keepQuery();
        view.onclick = onLink;
        more.onclick = () => showMore().querySelector("a").focus();
        form.onsubmit = (event) => {
            event.preventDefault();
            (results.querySelector("li:first-child [data-asked]") ?? results.querySelector("a"))?.click();
        };
    }

    function openView() {
        if (dialog.isConnected && !dialog.open) {
            matchPage();
            holdPage();
            dialog.showModal();
            needIndex();
            needContents();
        }
        box.focus();
        box.select();
    }

    // The page keeps its place while it can't be scrolled; where it would not, because a browser does not keep the room
    // of the scroll bar, it can. Where the root has no overflow of its own, that of the body is the window's, and would
    // become the body's.
    function holdPage() {
        const { documentElement: root, body } = document;
        const width = root.offsetWidth;
        const held = getComputedStyle(root).overflowX === "visible" ? [root, body] : [root];
        held.forEach((part) => part.classList.add("pagemeld-held"));
        if (root.offsetWidth !== width) {
            releasePage();
        }
    }

    const releasePage = () =>
        document.querySelectorAll(".pagemeld-held").forEach((part) => { part.classList.remove("pagemeld-held"); });

    // Light text is on a dark page. What the system says decides where the color is not given as red, green, and blue.
    function matchPage() {
        const { color } = getComputedStyle((dialog.isConnected ? opener : view).parentElement.parentElement);
        const [red, green, blue] = /^rgb/.test(color) ? color.match(/[\d.]+/g) : [];
        const isDark = blue === undefined ? systemIsDark.matches : 0.21 * red + 0.72 * green + 0.07 * blue > 127;
        [view, opener].forEach((part) => part.classList.toggle("pagemeld-dark", isDark));
    }

    // Themes are switched by an attribute of the root or the body.
    function watchPage() {
        const observer = new MutationObserver(matchPage);
        [document.documentElement, document.body].forEach((part) => observer.observe(part, { attributes: true }));
        systemIsDark.onchange = matchPage;
        matchPage();
    }

    // In a place of the page: contents that can be closed, and a way around both.
    function fill(place) {
        const button = createButton("Contents", contents);
        const end = create("span", { tabindex: "-1" });
        const skip = create("a", { href: "#pagemeld", class: "pagemeld-skip" }, "Skip search and contents");
        skip.onclick = (event) => {
            event.preventDefault();
            end.focus();
        };
        view.prepend(skip);
        nav.prepend(button);
        place.append(view, end);
        finder.addEventListener("keydown", onArrow);
        finder.addEventListener("keydown", onEscape);
        if (matchMedia("(min-width: 48em)").matches) {
            button.click();
        }
        (window.requestIdleCallback ?? setTimeout)(needContents);
    }

    // Tabs choose one of the parts where there is no room for both.
    function createTabs() {
        const tabs = ["Search", "Contents"].map((name) => create("button", { type: "button", role: "tab" }, name));
        const select = (chosen) => {
            tabs.forEach((tab) => tab.setAttribute("aria-selected", tab === chosen));
            view.classList.toggle("pagemeld-at-contents", chosen === tabs[1]);
            showCurrent();
        };
        tabs.forEach((tab) => { tab.onclick = () => select(tab); });
        select(tabs[0]);
        return create("div", { role: "tablist", class: "pagemeld-tabs", "aria-label": "Parts" }, ...tabs);
    }

    // A button in a corner, and the dialog that it opens.
    function createDialog() {
        const close = create("button", { type: "button", class: "pagemeld-close", "aria-label": "Close" }, "\u00d7");
        view.prepend(createTabs());
        view.append(close);
        dialog.append(view);
        opener.dataset.corner = tag.dataset.corner ?? "";
        document.body.append(create("div", { class: "pagemeld-corner", role: "region", "aria-label": "Search", lang: "en" },
            opener, dialog));
        let pressed = null; // a selection of text may end beside the view
        dialog.onmousedown = ({ target }) => { pressed = target; };
        dialog.onclick = ({ target }) => {
            if (target === close || (target === dialog && pressed === dialog)) {
                dialog.close();
            }
        };
        dialog.onclose = () => {
            releasePage();
            keepQuery();
        };
        opener.onclick = openView;
        ["keydown", "keypress", "keyup"].forEach((type) => addEventListener(type, onDialogKey, true));
    }

    async function start() {
        if (document.body?.localName !== "body") {
            return; // a frame set
        }
        const place = document.getElementById("pagemeld");
        const query = new URLSearchParams(location.search).get("pagemeld");
        if (!place && !query && document.readyState !== "complete") {
            await new Promise((done) => addEventListener("load", done)); // which a style sheet would put off
        }
        await loaded(create("link", { rel: "stylesheet", href: resolve("pagemeld.css", ownAddress).href }),
            document.head ?? document.documentElement);
        if (place) {
            fill(place);
        } else {
            createDialog();
        }
        listen();
        watchPage();
        if (query) {
            restoreQuery(query);
        }
        if (query && !place) {
            openView();
        }
    }

    if (document.readyState === "loading") {
        addEventListener("DOMContentLoaded", start);
    } else {
        start();
    }
}());
