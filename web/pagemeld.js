// Search and contents of all modules, in a documentation page.
//
// A page on disk can't fetch anything, so the outputs run as classic scripts. A page's own "const p0" would make their
// globals a syntax error, so each runs in a hidden frame, removed once its values are taken. The contents load when the
// page is idle, the search index when the reader turns to the box. Titles and texts enter the page as text only.

(function () {
    "use strict";

    const RESULTS_AT_ONCE = 30;
    const [EXCERPT_LENGTH, LEAD_LENGTH] = [300, 80]; // the lead comes before the first word found
    const HELD = 1 << 12; // more than all words of a query add otherwise
    const LETTER = "[\\p{L}\\p{M}\\p{N}_]";
    const WORDS = new RegExp(`${LETTER}+`, "gu");

    const fresh = document.documentElement.appendChild(create("iframe", {}));
    const { Map, Set, URL } = fresh.contentWindow; // a page may redefine these
    fresh.remove();
    const tag = document.currentScript; // a later <base> did not change where it led
    const isBeforeBase = document.querySelector("base[href]")?.compareDocumentPosition(tag) & 2;
    const ownAddress = isBeforeBase ? new URL(tag.getAttribute("src"), document.URL) : tag.src;
    const shared = tag.dataset.docdata;
    const docdata = shared ? new URL(shared.replace(/\/?$/, "/"), document.URL) : new URL(".", ownAddress);
    const setFolder = new URL("..", docdata).href;

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

    let index = null; // until it is loaded
    let found = { pages: [] };

    function create(name, attributes, ...children) {
        const element = document.createElementNS("http://www.w3.org/1999/xhtml", name);
        Object.entries(attributes).forEach(([key, value]) => element.setAttribute(key, value));
        element.append(...children);
        return element;
    }

    // The named globals, and p0, p1, ... as prefixes, longest first; null if a name is missing.
    function takeGlobals(source, names) {
        const values = Object.fromEntries(names.map((name) => [name, source[name]]));
        const prefixes = Object.keys(source).filter((key) => /^p\d+$/.test(key)).map((key) => source[key]);
        prefixes.sort((a, b) => b.length - a.length);
        return names.every((name) => values[name] instanceof source.Object) ? { ...values, prefixes } : null;
    }

    const loaded = (element, parent) =>
        new Promise((done) => { element.onload = element.onerror = done; parent.append(element); });

    // A script that throws has a load event too: what it assigned tells whether it ran. The frame is UTF-8.
    async function runOutput(name, globals, subject, complaint) {
        const frame = create("iframe", {});
        frame.style.display = "none";
        await loaded(frame, view);
        await loaded(create("script", { src: new URL(name, docdata) }), frame.contentDocument.head);
        const values = takeGlobals(frame.contentWindow, globals);
        frame.remove();
        complaint.textContent = values ? "" : `${subject} not available: ${name} did not run`;
        return values;
    }

    const decode = (text) => { try { return decodeURIComponent(text); } catch { return text; } }; // not UTF-8
    const encode = (path, special) => path.replace(special, encodeURIComponent);
    const prefixOf = (link, prefixes) => prefixes.find((prefix) => link.startsWith(prefix)) || "";

    // A link is a path on disk, in which only "#" has a meaning. The outputs put the prefix before whole addresses
    // too. "std::list.html" is not one, and "javascript:" must not run.
    function addressOf(link, prefixes) {
        const prefix = prefixOf(link, prefixes);
        const rest = link.slice(prefix.length);
        if (/^(?!javascript:)[a-z][a-z\d+.-]+:(?!:)/i.test(rest)) {
            return rest;
        }
        const end = `${rest}#`.indexOf("#");
        const path = encode(prefix, /[\0- %?#\\]/g) + encode(rest.slice(0, end), /[\0- %?\\]/g);
        return setFolder + path + rest.slice(end);
    }

    const createLink = (link, title, prefixes) =>
        create("a", { href: addressOf(link, prefixes), target: "_self" }, title.trim() || link);

    const wordsOf = (text) => text.toLowerCase().match(WORDS) || [];

    // The module directory: "charts" for ".../charts/Manual/".
    const moduleName = (prefix) => decode(new URL(addressOf(prefix, [prefix])).pathname.split("/").at(-3) ?? "");
    const moduleOf = (page) => index.modules.get(prefixOf(index.pages[page][0], index.prefixes));

    // What a search needs beside the lists themselves.
    function orderIndex(lists) {
        const titles = new Map();
        lists.pages.forEach(([, title], page) => wordsOf(title).forEach((word) => {
            titles.has(word) ? titles.get(word).push(page) : titles.set(word, [page]);
        }));
        return {
            ...lists,
            titles,
            words: [...Object.keys(lists.searchIndex), ...titles.keys()],
            pageOfText: new Int32Array(lists.info.map(([, page]) => page)),
            modules: new Map(["", ...lists.prefixes].map((prefix) => [prefix, moduleName(prefix)])),
        };
    }

    // Marks texts and pages that hold a word. A page has HELD, also 2 if in its title, and 1 if whole.
    function lookUp(word, isPrefix) {
        const { searchIndex, titles, words, pageOfText } = index;
        const texts = new Uint8Array(pageOfText.length);
        const pages = new Uint16Array(index.pages.length);
        for (const term of isPrefix ? words.filter((other) => other.startsWith(word)) : [word]) {
            const whole = term === word ? 1 : 0;
            for (const text of Object.hasOwn(searchIndex, term) ? searchIndex[term] : []) {
                texts[text] = 1;
                pages[pageOfText[text]] |= HELD | whole;
            }
            titles.get(term)?.forEach((page) => { pages[page] |= HELD | 2 | whole; });
        }
        return { texts, pages };
    }

    const addTo = (sums, marks) => { for (let i = 0; i < marks.length; i++) { sums[i] += marks[i]; } };

    // The pages that hold every word, those with the larger sum of marks first, then in their own order, and of
    // each page the text that holds most words.
    function search(words) {
        const { pages: { length }, pageOfText } = index;
        const scores = new Float64Array(length);
        const bestTexts = new Int32Array(length).fill(-1);
        const counts = new Uint16Array(pageOfText.length);
        words.forEach((word, i) => {
            const { texts, pages } = lookUp(word, i === words.length - 1);
            addTo(counts, texts);
            addTo(scores, pages);
        });
        for (let text = 0; text < counts.length; text++) {
            const page = pageOfText[text];
            bestTexts[page] = counts[text] <= counts[bestTexts[page]] ? bestTexts[page] : text;
        }
        const [ranks, least] = [[], HELD * words.length];
        scores.forEach((score, page) => score >= least && (ranks[score - least] ??= []).push(page));
        return { words, pages: ranks.reverse().flat(), bestTexts };
    }

    // Common words are left out, but for a last one that may become another: "the" finds "theory" while typed.
    function searchFor(query) {
        const words = [...new Set(wordsOf(query))];
        const rare = words.filter((word) => !Object.hasOwn(index.common, word));
        const isGrowing = rare.at(-1) !== words.at(-1) && query.toLowerCase().endsWith(words.at(-1));
        const grown = isGrowing ? search([...rare, words.at(-1)]) : null;
        return grown?.pages.length > 0 ? grown
            : rare.length > 0 ? search(rare) : { pages: [], isCommonOnly: words.length > 0 };
    }

    // Some lines around the first of the words, all of which are marked. The last one is a prefix.
    function excerpt(text, words) {
        const word = new RegExp(`(?<!${LETTER})(${words.join("|")}${LETTER}*)(?!${LETTER})`, "giu");
        const first = text.search(word);
        const end = first > LEAD_LENGTH ? text.slice(first - LEAD_LENGTH).replace(/^\S{0,40}\s/, "\u2026 ") : text;
        const cut = end.length > EXCERPT_LENGTH ? end.slice(0, EXCERPT_LENGTH).replace(/\s\S{0,40}$/, " \u2026") : end;
        return cut.split(word).map((piece, i) => (i % 2 === 1 ? create("mark", {}, piece) : piece));
    }

    function createResult(page) {
        const [path, title] = index.pages[page];
        const [text] = index.info[found.bestTexts[page]] ?? [""];
        return create("li", {}, createLink(path, title, index.prefixes), " ",
            create("span", {}, moduleOf(page)), create("p", {}, ...excerpt(text, found.words)));
    }

    // Returns the first result that it adds.
    function showMore() {
        const shown = results.childElementCount;
        results.append(...found.pages.slice(shown, shown + RESULTS_AT_ONCE).map(createResult));
        more.hidden = results.childElementCount === found.pages.length;
        return results.children[shown];
    }

    function describeFound({ isCommonOnly, words, pages: { length: count } }) {
        return isCommonOnly ? "Only common words, which are not searched for" : !words ? ""
            : count === 0 ? "Nothing found" : count === 1 ? "1 page found" : `${count} pages found`;
    }

    function update() {
        if (index) {
            found = searchFor(box.value);
            found.pages = found.pages.filter((page) => !filter.value || moduleOf(page) === filter.value);
            results.replaceChildren();
            showMore();
            status.textContent = describeFound(found);
        }
    }

    async function loadIndex() {
        box.onfocus = null;
        status.textContent = "Loading the search index";
        const lists = await runOutput("global_index.js", ["pages", "info", "common", "searchIndex"], "Search is", status);
        if (lists) {
            index = orderIndex(lists);
            const names = [...new Set(index.prefixes.map((prefix) => index.modules.get(prefix)))].sort();
            filter.append(...names.map((name) => create("option", {}, name)));
            names.length > 1 && form.append(create("label", {}, "Module ", filter));
            update();
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
        const output = await runOutput("global_toc.js", ["toc"], "Contents are", contents);
        if (output) {
            const { toc, prefixes } = output;
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
        form.onsubmit = () => { results.querySelector("a")?.click(); return false; };
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
