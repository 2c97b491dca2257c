"""What is measured on one file system: the sizes, the index part, the two series, and one more module."""

from dataclasses import dataclass, field

import corpus
from arena import INDEX_OUTPUT, OUTPUTS, Arena
from measurement import Rounds

SIZES = ("small", "medium", "large")
RECEIVERS = 10


@dataclass
class Study:
    """The measurements on one file system; None or absent where it was not asked for."""

    file_system: str
    sizes: dict = field(default_factory=dict)  # rounds by the name of the corpus
    arenas: dict = field(default_factory=dict)
    index_part: Rounds = None
    series: dict = field(default_factory=dict)  # lists of (count, CPU seconds, ratio to the step before), by name
    one_more: float = None


def outputs_of(contender):
    return [INDEX_OUTPUT] if contender == "jq" else OUTPUTS


def check_outputs(arena, names):
    """Ends the program unless every contender named makes the outputs that pagemeld makes."""
    for name in names:
        outputs = outputs_of(name)
        if arena.digest_after(getattr(arena, name)(), outputs) != arena.digest_after(arena.pagemeld(), outputs):
            raise SystemExit(f"{arena.folder}: the outputs of {name} differ from those of pagemeld")
        print(f"{arena.folder}: {name} makes the same outputs as pagemeld", flush=True)


def measure_size(study, name, folder, tool, rounds):
    arena = Arena(name, folder, tool)
    alternatives = [] if name == "large" else ["node", "python"]
    check_outputs(arena, alternatives)
    contenders = {each: getattr(arena, each)() for each in ["limit", "pagemeld", *alternatives]}
    study.sizes[name] = Rounds(contenders, rounds, arena.prepare, lambda _: arena.require_outputs())
    study.arenas[name] = arena
    arena.remove_outputs()


def measure_index_part(study, folder, tool, rounds):
    arena = Arena("medium-index", folder, tool)
    check_outputs(arena, ["jq"])

    def check(name):
        arena.require_outputs(outputs=outputs_of(name))

    study.index_part = Rounds({"pagemeld": arena.pagemeld(), "jq": arena.jq()}, rounds, arena.prepare, check)
    arena.remove_outputs()


def measure_series(study, series, folder, tool, rounds):
    """Measures the corpora of one series in turn, each against the one before."""
    names = [name for name in corpus.SHAPES if name.startswith(series)]
    arenas = {name: Arena(name, folder, tool) for name in names}

    def prepare():
        for arena in arenas.values():
            arena.prepare()

    contenders = {name: arenas[name].pagemeld() for name in names}
    measured = Rounds(contenders, rounds, prepare, lambda name: arenas[name].require_outputs())
    study.series[series] = [
        (
            int(name.rpartition("-")[2]),
            measured.median(name, "cpu"),
            measured.ratio(name, before, "cpu") if before else None,
        )
        for before, name in zip([None, *names], names)
    ]
    for arena in arenas.values():
        arena.remove_outputs()


def measure_one_more_module(study, folder, tool, rounds):
    """Compares what further modules cost that have no content of their own with copying the outputs to them."""
    arena = Arena("medium", folder, tool)
    roots = arena.roots + arena.receivers(RECEIVERS)
    contenders = {
        "pagemeld": arena.pagemeld(),
        "pagemeld, more": arena.pagemeld(roots),
        "limit": arena.limit(),
        "limit, more": arena.limit(roots),
    }
    measured = Rounds(
        contenders, rounds, arena.prepare, lambda name: arena.require_outputs(roots if "more" in name else None)
    )
    study.one_more = measured.growth_ratio(("pagemeld, more", "pagemeld"), ("limit, more", "limit"), "wall")
    arena.remove_outputs()
