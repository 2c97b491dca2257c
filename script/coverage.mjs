// Sums up what gcov reports for every object file, one line of JSON each on standard input.
import { createInterface } from 'node:readline';

const OWN = /^(Tools|Runtime|Modules)\//;
const LEAST = { lines: 95, branches: 90 };

const root = process.argv[2] + '/';
const files = new Map(); // of { lines, branches }, each of counts by place

// Code in headers is in several objects: what is reached in one of them counts as reached.
function add(counts, place, count) {
    counts.set(place, (counts.get(place) ?? 0) + count);
}

for await (const object of createInterface({ input: process.stdin })) {
    for (const { file, lines } of JSON.parse(object).files) {
        const name = file.replace(root, '');
        if (!OWN.test(name)) {
            continue;
        }
        const { lines: lineCounts, branches } =
            files.get(name) ?? files.set(name, { lines: new Map(), branches: new Map() }).get(name);
        for (const line of lines) {
            add(lineCounts, line.line_number, line.count);
            line.branches.forEach(({ count, throw: isException }, i) => {
                if (!isException) {
                    add(branches, `${line.line_number} ${line.function_name} ${i}`, count);
                }
            });
        }
    }
}

function percent(counts) {
    return counts.length === 0 ? 100 : (100 * counts.filter((count) => count > 0).length) / counts.length;
}

function missed(counts) {
    return [...new Set([...counts].filter(([, count]) => count === 0).map(([place]) => parseInt(place)))];
}

for (const [name, { lines, branches }] of [...files].sort()) {
    const [lineNumbers, branchNumbers] = [missed(lines), missed(branches)];
    if (lineNumbers.length > 0 || branchNumbers.length > 0) {
        console.log(`${name}: lines ${lineNumbers.join(' ') || 'all'}; branches of ${branchNumbers.join(' ') || 'all'}`);
    }
}
let isEnough = files.size > 0;
for (const [kind, least] of Object.entries(LEAST)) {
    const reached = percent([...files.values()].flatMap((file) => [...file[kind].values()]));
    console.log(`${kind}: ${reached.toFixed(1)} % of ${files.size} files, at least ${least} % required`);
    isEnough &&= reached >= least;
}
process.exit(isEnough ? 0 : 1);
