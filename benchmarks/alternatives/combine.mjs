// Combines documentation modules: what pagemeld does with sound input, as a build script in Node.
// Usage: node combine.mjs <module root> ...

import fs from "node:fs";
import path from "node:path";

const readJson = (file) => JSON.parse(fs.readFileSync(file, "utf8"));

function writeOutput(file, ...buffers) {
    const descriptor = fs.openSync(`${file}.tmp`, "w");
    for (const buffer of buffers) fs.writeFileSync(descriptor, buffer);
    fs.closeSync(descriptor);
    fs.renameSync(`${file}.tmp`, file);
}

function combineIndexes(documents) {
    const pages = [];
    const info = [];
    const terms = new Map();
    for (const [module, document] of documents.entries()) {
        const pageOffset = pages.length;
        const infoOffset = info.length;
        for (const [link, title] of document.pages) pages.push([link, title, module]);
        for (const [text, page] of document.info) info.push([text, page + pageOffset]);
        for (const [term, numbers] of Object.entries(document.searchIndex)) {
            const known = terms.get(term);
            if (known === undefined) {
                terms.set(term, numbers.map((number) => number + infoOffset));
            } else {
                for (const number of numbers) known.push(number + infoOffset);
            }
        }
    }
    const common = documents.map((document) => document.common).find((words) => Object.keys(words).length > 0) ?? {};
    return { pages, info, common, searchIndex: Object.fromEntries(terms) };
}

function tag(node, module) {
    node.module = module;
    for (const child of node.children ?? []) tag(child, module);
}

const keyOf = (node) => `${node.link}\0${node.title}`;

const siblings = new WeakMap(); // from a list of the combined tree to its nodes by their keys

function siblingsIn(list) {
    if (!siblings.has(list)) siblings.set(list, new Map([...list].reverse().map((node) => [keyOf(node), node])));
    return siblings.get(list);
}

function mergeNode(target, source) {
    if (source.children === null || target.children === null) {
        target.children ??= source.children;
        return;
    }
    const known = siblingsIn(target.children);
    for (const node of source.children) {
        const key = keyOf(node);
        const same = known.get(key);
        if (same !== undefined) {
            mergeNode(same, node);
        } else {
            known.set(key, node);
            target.children.push(node);
        }
    }
}

function combineTocs(documents) {
    documents.forEach(tag);
    const [toc, ...others] = documents;
    for (const other of others) if (keyOf(other) === keyOf(toc)) mergeNode(toc, other);
    return toc;
}

const quoted = (text) => `"${text.replaceAll('"', '\\"')}"`;

function indexScript({ pages, info, common, searchIndex }) {
    const rows = pages.map(([link, title, module]) => `[p${module} + "${link}", ${quoted(title)}]`);
    return (
        `pages = [\n${rows.join(",\n")}\n];\ninfo = ${JSON.stringify(info)}\n` +
        `common = ${JSON.stringify(common)};\nsearchIndex = ${JSON.stringify(searchIndex)};\n`
    );
}

const nodesScript = (nodes) => (nodes ?? []).map(nodeScript).join(",");

function nodeScript({ link, title, children, module }) {
    const prefix = link === "null" ? "" : `p${module}+`;
    const list = children === null ? "null" : `[${nodesScript(children)}]`;
    return `{"link": ${prefix}"${link}","title": ${quoted(title)},"children": ${list}}`;
}

const tocScript = ({ link, title, children }) =>
    `toc = {\n"link": ${quoted(link)},"title": ${quoted(title)},"children": [${nodesScript(children)}]};\n`;

function prefixVariables(modulePath, modulePaths) {
    const prefixes = modulePaths.map((other) => path.posix.relative(modulePath, other));
    return prefixes.map((prefix, i) => `var p${i} = "${prefix && `${prefix}/`}";\n`).join("");
}

function combineSet(moduleRoots, set) {
    const modulePaths = moduleRoots.map((root) => `${root}/${set}`);
    const index = combineIndexes(modulePaths.map((module) => readJson(`${module}/docdata/index.json`)));
    const toc = combineTocs(modulePaths.map((module) => readJson(`${module}/docdata/toc.json`)));
    const indexJson = Buffer.from(JSON.stringify(index, null, 4));
    const indexJs = Buffer.from(indexScript(index));
    const tocJson = Buffer.from(JSON.stringify(toc, null, 4));
    const tocJs = Buffer.from(tocScript(toc));
    for (const module of modulePaths) {
        const prefixes = Buffer.from(prefixVariables(module, modulePaths));
        writeOutput(`${module}/docdata/global_index.json`, indexJson);
        writeOutput(`${module}/docdata/global_index.js`, prefixes, indexJs);
        writeOutput(`${module}/docdata/global_toc.json`, tocJson);
        writeOutput(`${module}/docdata/global_toc.js`, prefixes, tocJs);
    }
}

for (const set of ["Manual", "ScriptReference"]) combineSet(process.argv.slice(2), set);
