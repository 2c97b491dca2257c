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

    const fresh = document.documentElement.appendChild(create("iframe", {}));
    const { Map, Set, URL } = fresh.contentWindow; // a page may redefine these
    fresh.remove();
    const tag = document.currentScript; // a later <base> did not change where it led
    const isBeforeBase = document.querySelector("base[href]")?.compareDocumentPosition(tag) & 2;
    const ownAddress = isBeforeBase ? new URL(tag.getAttribute("src"), document.URL) : tag.src;
    const shared = tag.dataset.docdata;
    const docdata = shared ? new URL(shared.replace(/\/?$/, "/"), document.URL) : new URL(".", ownAddress);
    const setFolder = new URL("..", docdata).href;
    const docdataName = docdata.href.slice(setFolder.length);

    const box = create("input", { type: "search", autocomplete: "off", spellcheck: "false" });
    const filter = create("select", {}, create("option", { value: "" }, "All"));
    const form = create("form", { role: "search" }, create("label", {}, "Search all modules ", box));
    const status = create("p", { role: "status" });
    const results = create("ul", { class: "pagemeld-results" });
    const more = create("button", { type: "button", hidden: "" }, "More results");
    const finder = create("div", {}, form, status, results, more);
    const contents = create("div", { class: "pagemeld-contents" });
    const contentsButton = createButton("Contents", contents);
    const view = create("div", { class: "pagemeld-view", hidden: "" },
        finder, create("nav", { "aria-label": "Contents" }, contentsButton, contents));

    const indexes = []; // of the sets that are loaded, the own one first
    let found = { pages: [] };

    function create(name, attributes, ...children) {
        const element = document.createElementNS("http://www.w3.org/1999/xhtml", name);
        Object.entries(attributes).forEach(([key, value]) => element.setAttribute(key, value));
        element.append(...children);
        return element;
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

    // A link is a path on disk, in which only "#" has a meaning. The outputs put the prefix before whole addresses
    // too. "std::list.html" is not one, and "javascript:" must not run.
    function addressOf(link, prefixes, folder = setFolder) {
        const prefix = prefixOf(link, prefixes);
        const rest = link.slice(prefix.length);
        if (/^(?!javascript:)[a-z][a-z\d+.-]+:(?!:)/i.test(rest)) {
            return rest;
        }
        const end = `${rest}#`.indexOf("#");
        const path = encode(prefix, /[\0- %?#\\]/g) + encode(rest.slice(0, end), /[\0- %?\\]/g);
        return folder + path + rest.slice(end);
    }

    const createLink = (link, title, prefixes, folder) =>
        create("a", { href: addressOf(link, prefixes, folder), target: "_self" }, title.trim() || link);

    // The module directory: "charts" for ".../charts/Manual/".
    const nameOf = (address, level) => decode(new URL(address).pathname.split("/").at(level) ?? "");

    // Runs the index of a set and the search in a frame that stays: its functions are used. Null if the index did not
    // run. Makes way for the reader's events now and then.
    async function openIndex(folder, complaint) {
        const frame = await openFrame();
        const { values, prefixes } = await runOutput(frame, `${folder}${docdataName}global_index.js`,
            ["pages", "info", "common", "searchIndex"], "Search is", complaint);
        await loaded(create("script", { src: new URL("pagemeld-search.js", ownAddress) }), frame.contentDocument.head);
        const { prepareIndex } = frame.contentWindow;
        if (!values || !prepareIndex) {
            frame.remove();
            return null;
        }
        const names = new Map(["", ...prefixes].map((prefix) => [prefix, nameOf(addressOf(prefix, [prefix], folder), -3)]));
        const set = nameOf(folder, -2);
        const steps = prepareIndex({ ...values, prefixes });
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
        const shown = indexes[0].search.describePage(page, found.details);
        const linkTo = ({ link, title }) => createLink(link, title, prefixes, folder);
        const source = indexes.length > 1 ? `${moduleOf(lookup, page.page)}, ${set}` : moduleOf(lookup, page.page);
        const places = shown.places.map((place) => create("li", {}, linkTo(place)));
        const result = create("li", {}, linkTo(shown), " ", create("span", {}, source),
            create("p", {}, ...shown.pieces.map((piece, i) => (i % 2 === 1 ? create("mark", {}, piece) : piece))),
            places.length > 0 ? create("ul", {}, ...places) : "");
        if (shown.isAsked) {
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

    function describeFound({ isCommonOnly, pages }) {
        const count = pages.length;
        const whole = pages.filter(({ isWhole }) => isWhole).length;
        const rest = whole === count ? "" : `, ${whole || "none"} with all words`;
        return isCommonOnly ? "Only common words, which are not searched for" : box.value.trim() === "" ? ""
            : count === 0 ? "Nothing found" : (count === 1 ? "1 page found" : `${count} pages found`) + rest;
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

    // The results that are shown stay where they are; those of the index come after them.
    function join(index) {
        indexes.push(index);
        const { set, names } = index;
        const modules = [...new Set(index.prefixes.map((prefix) => names.get(prefix)))].sort();
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
        box.onfocus = null;
        status.textContent = "Loading the search index";
        const own = nameOf(setFolder, -2);
        const sets = (tag.dataset.sets ?? SETS.join(" ")).split(" ").filter((set) => set !== own && SETS.includes(own));
        for (const set of [own, ...sets]) {
            const folder = set === own ? setFolder : new URL(`../${set}/`, setFolder).href;
            const index = await openIndex(folder, set === own ? status : create("p", {}));
            if (index) {
                join(index);
            }
        }
    }

    // Writes the query into the address and leaves the rest to the page.
    function keepQuery() {
        const address = new URL(document.URL);
        const others = address.search.slice(1).split("&").filter((part) => part && !part.startsWith("pagemeld="));
        const query = box.value.trim();
        address.search = others.concat(query ? "pagemeld=" + encodeURIComponent(query) : []).join("&");
        window.history.replaceState(window.history.state, "", address);
    }

    // A button that shows and hides a list, and calls fill before it shows an empty one.
    function createButton(title, list, fill = () => {}) {
        const button = create("button", { type: "button" }, title);
        button.onclick = () => {
            list.hasChildNodes() || fill();
            list.hidden = !list.hidden;
            button.setAttribute("aria-expanded", !list.hidden);
        };
        button.setAttribute("aria-expanded", false);
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
            isLink && button.setAttribute("aria-label", `Below ${name.text}`);
            way.slice(0, -1).includes(node) && button.click();
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
            const current = contents.querySelector("[aria-current]");
            contents.scrollTop = current ? current.offsetTop - contents.clientHeight / 2 : 0;
        }
    }

    const isPlain = (event) => !event.isComposing &&
        !["Control", "Alt", "Meta", "AltGraph"].some((key) => event.getModifierState(key));

    // "/" leads to the box, unless it is typed text or the page uses it.
    function onPageKey(event) {
        const [target] = event.composedPath();
        const isTyped = target.isContentEditable || /^(input|textarea|select)$/.test(target.localName);
        if (event.key === "/" && !isTyped && !event.defaultPrevented && isPlain(event)) {
            event.preventDefault();
            box.focus();
            box.select();
        }
    }

    // Down and Up lead through the box and the results, Escape to the box, and clears it there.
    function onFinderKey(event) {
        const { key, target } = event;
        const stops = [box, ...results.querySelectorAll("a"), ...(more.hidden ? [] : [more])];
        const step = stops.includes(target) ? { ArrowDown: 1, ArrowUp: -1 }[key] : 0;
        const next = key === "Escape" ? box : step && stops[stops.indexOf(target) + step];
        if (next && !event.shiftKey && isPlain(event)) {
            event.preventDefault();
            next.focus();
            if (next === target) {
                box.value = "";
                update();
            }
        }
    }

    function listen() {
        addEventListener("keydown", onPageKey);
        finder.addEventListener("keydown", onFinderKey);
        box.onfocus = loadIndex;
        box.oninput = filter.onchange = update;
        box.onblur = results.onclick = keepQuery;
        more.onclick = () => showMore().querySelector("a").focus();
        form.onsubmit = () => { (results.querySelector("li:first-child [data-asked]") ?? results.querySelector("a"))?.click(); return false; };
    }

    // The first thing in the body, or in what fills the window by itself, as javadoc's pages do.
    function createPlace() {
        const place = create("div", { id: "pagemeld", class: "pagemeld-top" });
        const filler = [...document.body.children].find((part) => getComputedStyle(part).position === "fixed" &&
            part.clientWidth >= innerWidth && part.clientHeight >= innerHeight);
        (filler ?? document.body).prepend(place);
        return place;
    }

    async function start() {
        if (document.body?.localName !== "body") {
            return; // a frame set
        }
        (document.getElementById("pagemeld") ?? createPlace()).append(view);
        listen();
        matchMedia("(min-width: 48em)").matches && contentsButton.click();
        box.value = new URLSearchParams(location.search).get("pagemeld") ?? "";
        box.value && loadIndex();
        await loaded(create("link", { rel: "stylesheet", href: new URL("pagemeld.css", ownAddress) }), view);
        view.hidden = false;
        (window.requestIdleCallback ?? setTimeout)(loadContents);
    }

    document.readyState === "loading" ? addEventListener("DOMContentLoaded", start) : start();
}());
