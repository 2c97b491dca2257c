// Checks the combined example modules as a browser would meet them.
//
//     node check-demo.mjs FOLDER MESSAGES FINDINGS
//
// FOLDER holds the modules, MESSAGES is the file with what pagemeld said, and FINDINGS the one with what
// pagemeld-check said before. Both scripts of every module and
// set are evaluated as classic scripts; every link must lead from that module's folder to a page with the
// title that it promises. Ends with status 1 at the first fault.

import assert from "node:assert/strict";
import { existsSync, readdirSync, readFileSync } from "node:fs";
import path from "node:path";
import vm from "node:vm";

const combined = ["acquire", "charts", "logbook"];
const broken = "telemetry";
const sharedGroups = { Manual: "Getting started", ScriptReference: "Classes" };

const [folder, messagesFile, findingsFile] = process.argv.slice(2);

function loadScripts(setFolder) {
    const globals = vm.createContext({});
    for (const name of ["global_toc.js", "global_index.js"]) {
        const filename = path.join(setFolder, "docdata", name);
        vm.runInContext(readFileSync(filename, "utf8"), globals, { filename });
    }
    return globals;
}

// Returns the module that the link leads to.
function checkLink(setFolder, link, title) {
    const page = path.join(setFolder, link);
    assert(existsSync(page), `${setFolder}: "${title}" leads to ${page}, which does not exist`);
    assert(readFileSync(page, "utf8").includes(`<h1>${title}</h1>`), `${page} is not "${title}"`);
    return path.relative(folder, page).split(path.sep)[0];
}

// Returns the modules that the nodes of a list, and everything below, lead to.
function checkTocNodes(setFolder, nodes) {
    return (nodes ?? []).flatMap(({ link, title, children }) => [
        ...(link === "null" ? [] : [checkLink(setFolder, link, title)]),
        ...checkTocNodes(setFolder, children),
    ]);
}

function checkModules(found, where) {
    assert.deepEqual([...new Set(found)].sort(), combined, `modules in ${where}`);
}

function filesBelow(folder) {
    return readdirSync(folder, { withFileTypes: true }).flatMap((entry) =>
        entry.isDirectory() ? filesBelow(path.join(folder, entry.name)) : [path.join(folder, entry.name)]);
}

function checkSet(module, set) {
    const setFolder = path.join(folder, module, set);
    const { toc, pages, info, common, searchIndex } = loadScripts(setFolder);

    assert(existsSync(path.join(setFolder, toc.link)), `${setFolder}: the root's ${toc.link} does not exist`);
    checkModules(checkTocNodes(setFolder, toc.children), `${setFolder}, contents`);
    const groups = toc.children.filter(({ title }) => title === sharedGroups[set]);
    assert.equal(groups.length, 1, `${setFolder}: groups "${sharedGroups[set]}"`);
    checkModules(checkTocNodes(setFolder, groups[0].children), `${setFolder}, "${sharedGroups[set]}"`);

    checkModules(pages.map(([link, title]) => checkLink(setFolder, link, title)), `${setFolder}, pages`);
    assert(info.length > 0 && info.every(([, page]) => page in pages), `${setFolder}: page numbers`);
    const numbers = Object.values(searchIndex).flat();
    assert.deepEqual(new Set(numbers), new Set(info.keys()), `${setFolder}: info numbers`);
    assert(common.the === 1, `${setFolder}: common words`);
    return pages.length;
}

// The checker must find the broken module's two faults in each set, and nothing else.
function checkFindings(lines) {
    const faults = Object.keys(sharedGroups).flatMap((set) => [
        `${folder}/${broken}/${set}/docdata/index.json:6:43: error: [not-json]`,
        `${folder}/${broken}/${set}/docdata/toc.json: error: [unreadable]`,
    ]);
    const missing = Object.keys(sharedGroups).map((set) =>
        `from the search of ${set}: ${broken}; from its contents: ${broken}`);
    assert.deepEqual(lines.map((line) => line.replace(/error: .* \[/, "error: [")), [
        ...faults, `4 modules, ${faults.length} errors, 0 warnings; missing ${missing.join("; ")}`, ""]);
}

checkFindings(readFileSync(findingsFile, "utf8").split("\n"));
const messages = readFileSync(messagesFile, "utf8");
for (const set of Object.keys(sharedGroups)) {
    const index = path.join(folder, broken, set, "docdata/index.json");
    const said = `Failed to parse JSON file ${index}, error at offset: `;
    assert(messages.includes(said), `no word about ${index}`);
    const pageCounts = [...combined, broken].map((module) => checkSet(module, set));
    console.log(`${set}: every link holds, from each of ${pageCounts.length} modules to ` +
        `${pageCounts[0]} pages of ${combined.join(", ")}`);
}
const strays = filesBelow(folder).filter((name) => name.endsWith(".tmp"));
assert.deepEqual(strays, [], "temporary files that stayed");
