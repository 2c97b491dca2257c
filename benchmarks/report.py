"""Turns what was measured into Markdown: for each file system, by its name, the rounds of each study."""

from itertools import chain, pairwise, zip_longest


def ratio(study, name, base, measure):
    return lambda rounds_of: rounds_of[study].ratio(name, base, measure)


def largest_step(study):
    return lambda rounds_of: max(rounds_of[study].ratio(b, a, "cpu") for a, b in pairwise(rounds_of[study].contenders))


def peak_share(study):
    def share(rounds_of):
        arena, _ = rounds_of[study].contenders["pagemeld"]
        inputs, texts = zip(*arena.set_sizes)
        # The sets are combined one after the other: the texts of one are in memory at once.
        return rounds_of[study].median("pagemeld", "peak") / (3.5 * sum(inputs) + max(texts))

    return share


GOALS = [
    ("medium, wall / limit", "at most 1.2", ratio("medium", "pagemeld", "limit", "wall")),
    ("large, wall / limit", "at most 1.2", ratio("large", "pagemeld", "limit", "wall")),
    ("small, wall / limit", "at most 2", ratio("small", "pagemeld", "limit", "wall")),
    ("medium, wall of Node / wall", "at least 5", ratio("medium", "node", "pagemeld", "wall")),
    ("medium, wall of Python / wall", "at least 8", ratio("medium", "python", "pagemeld", "wall")),
    ("medium, user CPU of Node / user CPU", "at least 7", ratio("medium", "node", "pagemeld", "user")),
    ("index part, wall of jq / wall", "at least 50", ratio("index part", "jq", "pagemeld", "wall")),
    ("index part, user CPU of jq / user CPU", "at least 50", ratio("index part", "jq", "pagemeld", "user")),
    ("doubling terms, CPU, largest step", "at most 2.1", largest_step("terms")),
    ("doubling siblings, CPU, largest step", "at most 2.1", largest_step("siblings")),
    ("medium, peak memory / (3.5 x input + texts)", "at most 1", peak_share("medium")),
    ("large, peak memory / (3.5 x input + texts)", "at most 1", peak_share("large")),
]


def goal_table(results):
    """Returns the goals with what was measured; those that miss their goal are bold."""
    rows = [("measure", "goal", *results), ("---",) * (2 + len(results))]
    for text, goal, measured in GOALS:
        rows.append((text, goal, *(goal_cell(goal, measured, rounds_of) for rounds_of in results.values())))
    return table(rows)


def goal_cell(goal, measured, rounds_of):
    try:
        value = measured(rounds_of)
    except KeyError:
        return "-"  # this study was left out
    bound = float(goal.split()[-1])
    is_met = value <= bound if goal.startswith("at most") else value >= bound
    return f"{value:.2f}" if is_met else f"**{value:.2f}**"


def run_table(results):
    """Returns the medians of every program, by corpus."""
    head = [f"{system}: wall, s | user, s | system, s | peak, MB" for system in results]
    rows = [("corpus", "program", *head), ("---",) * (2 + 4 * len(results))]
    for study in ("small", "medium", "large", "index part"):
        measured = [rounds_of[study] for rounds_of in results.values() if study in rounds_of]
        for program in measured[0].contenders if measured else ():
            rows.append((study, program, *(run_cells(rounds, program) for rounds in measured)))
    return table(rows)


def run_cells(rounds, program):
    times = [f"{rounds.median(program, measure):.3f}" for measure in ("wall", "user", "system")]
    return " | ".join([*times, "-" if program == "limit" else f"{rounds.median(program, 'peak') / 1e6:.0f}"])


def series_table(results):
    """Returns CPU seconds by count, and in parentheses the ratio to the step before; the series side by side."""
    series = [series_rows(study, results) for study in ("terms", "siblings")]
    return table(chain(*row) for row in zip_longest(*series, fillvalue=("-",) * (1 + len(results))))


def series_rows(study, results):
    yield study, *(f"CPU, s, {system}" for system in results)
    yield ("---",) * (1 + len(results))
    measured = [rounds_of[study] for rounds_of in results.values() if study in rounds_of]
    counts = list(measured[0].contenders) if measured else []
    for before, count in zip([None, *counts], counts):
        yield f"{count:,}", *(series_cell(rounds, count, before) for rounds in measured)


def series_cell(rounds, count, before):
    step = f" ({rounds.ratio(count, before, 'cpu'):.2f})" if before else ""
    return f"{rounds.median(count, 'cpu'):.3f}{step}"


def table(rows):
    return "\n".join(f"| {' | '.join(row)} |" for row in rows)
