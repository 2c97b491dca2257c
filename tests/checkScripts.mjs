// Loads the scripts of a docdata directory as a page does, and compares them with the JSON files next to them.

import assert from 'node:assert/strict';
import { readFileSync } from 'node:fs';
import { join } from 'node:path';
import vm from 'node:vm';

const docdata = process.argv[2];
const readText = name => readFileSync(join(docdata, name), 'utf8');
const readJson = name => JSON.parse(readText(name));

function load(name) {
    const globals = vm.createContext({});
    vm.runInContext(readText(name), globals);
    return JSON.parse(JSON.stringify(globals));
}

function expectedNode(node, prefixes) {
    const isGroup = node.link === 'null' || node.module === undefined;
    return {
        link: isGroup ? node.link : prefixes[`p${node.module}`] + node.link,
        title: node.title,
        children: node.children && node.children.map(child => expectedNode(child, prefixes)),
    };
}

const { pages, info, common, searchIndex, ...prefixes } = load('global_index.js');
const index = readJson('global_index.json');
assert.deepEqual(pages, index.pages.map(([path, title, module]) => [prefixes[`p${module}`] + path, title]));
assert.deepEqual({ info, common, searchIndex }, { info: index.info, common: index.common, searchIndex: index.searchIndex });

const { toc, ...tocPrefixes } = load('global_toc.js');
const { link, title, children } = readJson('global_toc.json');
assert.deepEqual(tocPrefixes, prefixes);
assert.deepEqual(toc, { link, title, children: (children ?? []).map(child => expectedNode(child, prefixes)) });
console.log(`${pages.length} pages, ${Object.keys(searchIndex).length} terms`);
