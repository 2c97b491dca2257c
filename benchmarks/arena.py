"""Corpora on which programs run in turn, and what the runs cost."""

import hashlib
import os
import random
import shutil
import statistics
import subprocess
import sys
from pathlib import Path
from typing import NamedTuple

import corpus

LAUNCHER = Path(__file__).parent / "launch.py"
ALTERNATIVES = Path(__file__).parent / "alternatives"
BLOCK = 1 << 20
OUTPUTS = ("global_index.json", "global_index.js", "global_toc.json", "global_toc.js")


class Cost(NamedTuple):
    wall: float  # seconds, as the three below
    user: float
    system: float
    cpu: float
    peak: float  # bytes of resident memory


def run(command):
    """Runs a command that must succeed, its output thrown away."""
    launch = [sys.executable, "-S", str(LAUNCHER), *command]
    status, wall, user, system, peak = map(float, subprocess.check_output(launch).split())
    if status != 0:
        raise SystemExit(f"{' '.join(command[:3])} ... ended with {status:.0f}")
    return Cost(wall, user, system, user + system, peak)


def blocks_of(files):
    for path in files:
        with open(path, "rb") as file:
            yield from iter(lambda: file.read(BLOCK), b"")


class Arena:
    """A corpus, made below directory, with finished outputs to copy and to compare with."""

    def __init__(self, name, directory, tool):
        self._corpus = Path(directory) / name
        corpus.make(name, self._corpus)
        roots = sorted(map(str, self._corpus.glob("m*")))
        self._commands = {
            "limit": ["sh", str(ALTERNATIVES / "limit.sh"), str(self._corpus)],
            "pagemeld": [str(tool), *roots],
            "node": ["node", str(ALTERNATIVES / "combine.mjs"), *roots],
            "python": [sys.executable, str(ALTERNATIVES / "combine.py"), *roots],
        }
        self.run("pagemeld")
        self.set_sizes = [self._make_ready(set_name) for set_name in corpus.SETS]

    def _make_ready(self, set_name):
        """Keeps the outputs of one documentation set; returns the bytes of all its inputs and of the outputs."""
        ready = self._corpus / "ready" / set_name
        ready.mkdir(parents=True)
        for output in OUTPUTS:
            shutil.copy(self._corpus / "m000" / set_name / "docdata" / output, ready)
        files = [*self._corpus.glob(f"m*/{set_name}/docdata/[it]*.json")], [*ready.iterdir()]
        return [sum(file.stat().st_size for file in group) for group in files]

    def run(self, program):
        """Returns what the run cost; the outputs stay."""
        return run(self._commands[program])

    def prepare(self):
        """Removes all outputs, waits for the disk, and brings what is read into the page cache."""
        for output in self._corpus.glob("m*/*/docdata/global_*"):
            output.unlink()
        os.sync()
        for _ in blocks_of([*self._corpus.glob("m*/*/docdata/*"), *self._corpus.glob("ready/*/*")]):
            pass

    def require_outputs(self):
        """Ends the benchmark if an output is missing or too short, as on a full disk: such a run does not count."""
        for output in self._outputs():
            ready = self._corpus / "ready" / output.parts[-3] / output.name
            if not output.exists() or output.stat().st_size < ready.stat().st_size:
                raise SystemExit(f"{output} was not written whole")

    def require_same_outputs(self, program):
        """Ends the benchmark unless the program makes, to the byte, the outputs that pagemeld makes."""
        digests = []
        for each in ("pagemeld", program):
            self.prepare()
            self.run(each)
            digests.append(hashlib.sha256())
            for block in blocks_of(self._outputs()):
                digests[-1].update(block)
        if digests[0].digest() != digests[1].digest():
            raise SystemExit(f"{self._corpus.name}: the outputs of {program} differ from those of pagemeld")
        print(f"{self._corpus.name}: {program} makes the same outputs as pagemeld", file=sys.stderr)

    def _outputs(self):
        directories = sorted(self._corpus.glob("m*/*/docdata"))
        return [directory / output for directory in directories for output in OUTPUTS]


class Rounds:
    """The costs of several contenders, measured in turn, round by round, so that a slow moment affects all alike."""

    def __init__(self, contenders, count):
        """Contenders are pairs of arena and program, by name."""
        self.contenders = contenders
        self._costs = {name: [] for name in contenders}
        for _ in range(count):
            for name in random.sample(list(contenders), len(contenders)):
                self._measure(name)

    def _measure(self, name):
        for each, _ in self.contenders.values():
            each.prepare()
        arena, program = self.contenders[name]
        self._costs[name].append(arena.run(program))
        arena.require_outputs()

    def median(self, name, measure):
        return statistics.median(getattr(cost, measure) for cost in self._costs[name])

    def ratio(self, name, base, measure):
        """Returns the median, over the rounds, of one contender's cost divided by another's."""
        pairs = zip(self._costs[name], self._costs[base])
        return statistics.median(getattr(cost, measure) / getattr(other, measure) for cost, other in pairs)
