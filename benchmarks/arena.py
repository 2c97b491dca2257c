"""A corpus made ready to be combined by one program after another."""

import hashlib
import os
import shlex
import shutil
import sys
from pathlib import Path

import corpus
import measurement

BLOCK = 1 << 20
ALTERNATIVES = Path(__file__).parent / "alternatives"
INPUTS = ("index.json", "toc.json")
INDEX_OUTPUT = "global_index.json"
OUTPUTS = (INDEX_OUTPUT, "global_index.js", "global_toc.json", "global_toc.js")


def blocks_of(path):
    with open(path, "rb") as file:
        yield from iter(lambda: file.read(BLOCK), b"")


class Arena:
    def __init__(self, name, folder, tool):
        self.folder = corpus.make(name, folder)
        self.roots = sorted(self.folder.glob("m*"))
        self._tool = str(tool)
        self._ready = self.folder / "ready"
        self._make_ready_outputs()

    def prepare(self):
        """Removes all outputs, waits for the disk, and brings what is read into the page cache."""
        self.remove_outputs()
        os.sync()
        for file in [*self._inputs(self.roots), *self._ready.glob("*/*")]:
            for _ in blocks_of(file):
                pass

    def require_outputs(self, roots=None, outputs=OUTPUTS):
        """Ends the program if an output is missing or too short, as on a full disk: the run was no run then."""
        for root in roots or self.roots:
            for set_name in corpus.SETS:
                for output in outputs:
                    written = root / set_name / "docdata" / output
                    ready = self._ready / set_name / output
                    if not written.exists() or written.stat().st_size < ready.stat().st_size:
                        raise SystemExit(f"{written} was not written whole")

    def remove_outputs(self):
        for output in self.folder.glob("*/*/docdata/global_*"):
            output.unlink()

    # The contenders, as commands.

    def pagemeld(self, roots=None):
        return [self._tool, *map(str, roots or self.roots)]

    def node(self):
        return ["node", str(ALTERNATIVES / "combine.mjs"), *map(str, self.roots)]

    def python(self):
        return [sys.executable, str(ALTERNATIVES / "combine.py"), *map(str, self.roots)]

    def jq(self):
        """Only the search index, and of that only the JSON file."""
        return ["sh", str(ALTERNATIVES / "combine_index.sh"), *map(str, self.roots)]

    def limit(self, roots=None):
        """Reads all inputs and copies finished outputs into all modules: one cat, and one cp a docdata folder."""
        roots = roots or self.roots
        lines = [f"cat {self._quoted(self._inputs(roots))} > /dev/null"]
        for set_name in corpus.SETS:
            ready = self._quoted(self._ready / set_name / output for output in OUTPUTS)
            lines += [f"cp {ready} {shlex.quote(str(root / set_name / 'docdata'))}" for root in roots]
        script = self.folder / f"limit-{len(roots)}.sh"
        script.write_text("set -e\n" + "\n".join(lines) + "\n")
        return ["sh", str(script)]

    # What there is to be known about the corpus.

    def receivers(self, count):
        """Returns the roots of further modules that have no files of their own and receive all outputs."""
        roots = [self.folder / f"receiver{i:03}" for i in range(count)]
        for root in roots:
            for set_name in corpus.SETS:
                (root / set_name / "docdata").mkdir(parents=True, exist_ok=True)
        return roots

    def digest_after(self, command, outputs=OUTPUTS):
        """Runs the command and returns one digest of the outputs of those names in all modules."""
        self.remove_outputs()
        measurement.run(command)
        digest = hashlib.sha256()
        for root in self.roots:
            for set_name in corpus.SETS:
                for output in outputs:
                    for block in blocks_of(root / set_name / "docdata" / output):
                        digest.update(block)
        return digest.hexdigest()

    def memory_goal(self):
        """Returns 3.5 times the input, and the rendered texts that are in memory at once: those of one set."""
        texts = max(self._ready_size(set_name) for set_name in corpus.SETS)
        return 3.5 * sum(self._input_size(set_name) for set_name in corpus.SETS) + texts

    def memory_goal_of_set(self):
        """Returns the same with only the input that is in memory at once: that of the larger set."""
        return max(3.5 * self._input_size(set_name) + self._ready_size(set_name) for set_name in corpus.SETS)

    def _make_ready_outputs(self):
        measurement.run(self.pagemeld())
        for set_name in corpus.SETS:
            ready = self._ready / set_name
            ready.mkdir(parents=True, exist_ok=True)
            for output in OUTPUTS:
                shutil.copy(self.roots[0] / set_name / "docdata" / output, ready)

    def _inputs(self, roots, sets=corpus.SETS):
        files = (root / set_name / "docdata" / name for root in roots for set_name in sets for name in INPUTS)
        return [file for file in files if file.exists()]

    def _input_size(self, set_name):
        return sum(file.stat().st_size for file in self._inputs(self.roots, [set_name]))

    def _ready_size(self, set_name):
        return sum(file.stat().st_size for file in (self._ready / set_name).iterdir())

    @staticmethod
    def _quoted(paths):
        return " ".join(shlex.quote(str(path)) for path in paths)
