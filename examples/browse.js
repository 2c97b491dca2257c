// Puts a search box and the contents of all modules beside a page. It is a classic script, loaded behind
// docdata/global_toc.js and docdata/global_index.js, and uses the globals that these assign.

(function () {
    const has = (object, key) => Object.prototype.hasOwnProperty.call(object, key);

    function create(tag, ...children) {
        const element = document.createElement(tag);
        element.append(...children);
        return element;
    }

    function createLink(href, text) {
        const link = create("a", text);
        link.href = href;
        return link;
    }

    function createContents(nodes) {
        return create("ul", ...nodes.map((node) => create("li",
            node.link === "null" ? node.title : createLink(node.link, node.title),
            ...(node.children ? [createContents(node.children)] : []))));
    }

    // The numbers of the texts that hold every word of the query, those too common to be indexed left out.
    function findInfos(query) {
        const words = query.toLowerCase().match(/[\p{L}\p{N}]+/gu) || [];
        const hits = words.filter((word) => !has(common, word))
            .map((word) => (has(searchIndex, word) ? searchIndex[word] : []));
        return hits.length === 0 ? [] : hits[0].filter((number) => hits.every((hit) => hit.includes(number)));
    }

    function createResult(number) {
        const [text, pageNumber] = info[number];
        const [path, title] = pages[pageNumber];
        return create("li", createLink(path, title), create("br"), text);
    }

    // Before the modules were combined there is nothing to show.
    if (typeof toc === "undefined" || typeof pages === "undefined") {
        return;
    }
    const box = create("input");
    box.type = "search";
    box.placeholder = "Search all modules";
    const results = create("ul");
    box.addEventListener("input", () => results.replaceChildren(...findInfos(box.value).map(createResult)));
    const home = createLink(toc.link, toc.title);
    document.body.append(create("nav", home, box, results, createContents(toc.children)));
})();
