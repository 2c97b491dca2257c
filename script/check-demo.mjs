// Checks the combined example modules as a browser would load them.
//
//     node check-demo.mjs DIRECTORY MESSAGES FINDINGS
//
// DIRECTORY holds the modules, MESSAGES is the file with what pagemeld printed, and FINDINGS the one with what
// pagemeld-check printed before. Both scripts of every module and set are evaluated as classic scripts; every link must
// lead from that module's directory to a page with the title that the link has. Ends with status 1 at the first fault.

import assert from "node:assert/strict";
import { existsSync, readdirSync, readFileSync } from "node:fs";
import path from "node:path";
import vm from "node:vm";

const combined = ["acquire", "charts", "logbook"];
const broken = "telemetry";
const sharedGroups = { Manual: "Getting started", ScriptReference: "Classes" };

const [directory, messagesFile, findingsFile] = process.argv.slice(2);

function loadScripts(setDirectory) {
    const globals = vm.createContext({});
    for (const name of ["global_toc.js", "global_index.js"]) {
        const filename = path.join(setDirectory, "docdata", name);
        vm.runInContext(readFileSync(filename, "utf8"), globals, { filename });
    }
    return globals;
}

// Returns the module that the link leads to.
function checkLink(setDirectory, link, title) {
    const page = path.join(setDirectory, link);
    assert(existsSync(page), `${setDirectory}: "${title}" leads to ${page}, which does not exist`);
    assert(readFileSync(page, "utf8").includes(`<h1>${title}</h1>`), `${page} is not "${title}"`);
    return path.relative(directory, page).split(path.sep)[0];
}

// Returns the modules that the nodes of a list, and everything below, lead to.
function checkTocNodes(setDirectory, nodes) {
    return (nodes ?? []).flatMap(({ link, title, children }) => [
        ...(link === "null" ? [] : [checkLink(setDirectory, link, title)]),
        ...checkTocNodes(setDirectory, children),
    ]);
}

function checkModules(found, where) {
    assert.deepEqual([...new Set(found)].sort(), combined, `modules in ${where}`);
}

function filesBelow(directory) {
    return readdirSync(directory, { withFileTypes: true }).flatMap((entry) =>
        entry.isDirectory() ? filesBelow(path.join(directory, entry.name)) : [path.join(directory, entry.name)]);
}

function checkSet(module, set) {
    const setDirectory = path.join(directory, module, set);
    const { toc, pages, info, common, searchIndex } = loadScripts(setDirectory);

    assert(existsSync(path.join(setDirectory, toc.link)), `${setDirectory}: the root's ${toc.link} does not exist`);
    checkModules(checkTocNodes(setDirectory, toc.children), `${setDirectory}, contents`);
    const groups = toc.children.filter(({ title }) => title === sharedGroups[set]);
    assert.equal(groups.length, 1, `${setDirectory}: groups "${sharedGroups[set]}"`);
    checkModules(checkTocNodes(setDirectory, groups[0].children), `${setDirectory}, "${sharedGroups[set]}"`);

    checkModules(pages.map(([link, title]) => checkLink(setDirectory, link, title)), `${setDirectory}, pages`);
    assert(info.length > 0 && info.every(([, page]) => page in pages), `${setDirectory}: page numbers`);
    const numbers = Object.values(searchIndex).flat();
    assert.deepEqual(new Set(numbers), new Set(info.keys()), `${setDirectory}: info numbers`);
    assert(common.the === 1, `${setDirectory}: common words`);
    return pages.length;
}

// The checker must find the broken module's two faults in each set, and nothing else.
function checkFindings(lines) {
    const faults = Object.keys(sharedGroups).flatMap((set) => [
        `${directory}/${broken}/${set}/docdata/index.json:6:43: error: [not-json]`,
        `${directory}/${broken}/${set}/docdata/toc.json: error: [unreadable]`,
    ]);
    const missing = Object.keys(sharedGroups).map((set) =>
        `from the search of ${set}: ${broken}; from its contents: ${broken}`);
    assert.deepEqual(lines.map((line) => line.replace(/error: .* \[/, "error: [")), [
        ...faults, `4 modules, ${faults.length} errors, 0 warnings; missing ${missing.join("; ")}`, ""]);
}

checkFindings(readFileSync(findingsFile, "utf8").split("\n"));
const messages = readFileSync(messagesFile, "utf8");
for (const set of Object.keys(sharedGroups)) {
    const index = path.join(directory, broken, set, "docdata/index.json");
    const said = `Failed to parse JSON file ${index}, error at offset: `;
    assert(messages.includes(said), `no message about ${index}`);
    const pageCounts = [...combined, broken].map((module) => checkSet(module, set));
    console.log(`${set}: every link works, from each of ${pageCounts.length} modules to ` +
        `${pageCounts[0]} pages of ${combined.join(", ")}`);
}
const strays = filesBelow(directory).filter((name) => name.endsWith(".tmp"));
assert.deepEqual(strays, [], "temporary files that stayed");
