"""Turns studies into Markdown."""

from arena import Arena

MEMORY_GOALS = {
    "(3.5 x input + texts)": Arena.memory_goal,
    "the same of the larger set alone": Arena.memory_goal_of_set,
}
SERIES = {"terms": "doubling terms", "siblings": "doubling siblings"}


def goal_table(studies):
    """Returns the goals with what was measured; what misses its goal stands in bold."""
    rows = [row for row in goal_rows(studies) if any(value is not None for value in row[3])]
    lines = table_head(["measure", "goal", *(study.file_system for study in studies)])
    for measure, goal, is_met, values in rows:
        cells = ["-" if v is None else f"{v:.2f}" if is_met(v) else f"**{v:.2f}**" for v in values]
        lines.append(table_row([measure, goal, *cells]))
    return "\n".join(lines) + "\n"


def goal_rows(studies):
    def at_most(limit):
        return f"at most {limit}", lambda value: value <= limit

    def at_least(limit):
        return f"at least {limit}", lambda value: value >= limit

    def size_ratio(size, contender, other, measure="wall"):
        return [
            study.sizes[size].ratio(contender, other, measure) if size in study.sizes else None for study in studies
        ]

    def index_ratio(measure):
        return [study.index_part and study.index_part.ratio("jq", "pagemeld", measure) for study in studies]

    yield "medium, wall / limit", *at_most(1.2), size_ratio("medium", "pagemeld", "limit")
    yield "large, wall / limit", *at_most(1.2), size_ratio("large", "pagemeld", "limit")
    yield "small, wall / limit", *at_most(2), size_ratio("small", "pagemeld", "limit")
    yield "medium, wall of Node / wall", *at_least(5), size_ratio("medium", "node", "pagemeld")
    yield "medium, wall of Python / wall", *at_least(8), size_ratio("medium", "python", "pagemeld")
    yield "medium, user CPU of Node / user CPU", *at_least(7), size_ratio("medium", "node", "pagemeld", "user")
    yield "index part, wall of jq / wall", *at_least(50), index_ratio("wall")
    yield "index part, user CPU of jq / user CPU", *at_least(50), index_ratio("user")
    for series, text in SERIES.items():
        yield f"{text}, CPU, largest step", *at_most(2.1), [largest_step(study.series.get(series)) for study in studies]
    for size in ("medium", "large"):
        for text, goal in MEMORY_GOALS.items():
            yield f"{size}, peak memory / {text}", *at_most(1), [peak_share(study, size, goal) for study in studies]
    yield "one more module / copying its outputs", *at_most(1.1), [study.one_more for study in studies]


def largest_step(series):
    return max(ratio for _, _, ratio in series if ratio) if series else None


def peak_share(study, size, goal):
    if size not in study.sizes:
        return None
    return study.sizes[size].median("pagemeld", "peak") / goal(study.arenas[size])


def run_table(study):
    """Returns all sizes with every contender's medians."""
    head = ["corpus", "program", "wall, s", "user, s", "system, s", "peak, MB", "wall / limit", "wall / pagemeld"]
    lines = table_head(head)
    for size, rounds in study.sizes.items():
        for name in rounds.names():
            times = [f"{rounds.median(name, measure):.3f}" for measure in ("wall", "user", "system")]
            peak = "-" if name == "limit" else f"{rounds.median(name, 'peak') / 1e6:.0f}"
            ratios = [f"{rounds.ratio(name, other, 'wall'):.2f}" for other in ("limit", "pagemeld")]
            lines.append(table_row([size, name, *times, peak, *ratios]))
    if study.index_part:
        for name in study.index_part.names():
            times = [f"{study.index_part.median(name, measure):.3f}" for measure in ("wall", "user", "system")]
            peak = f"{study.index_part.median(name, 'peak') / 1e6:.0f}"
            ratio = f"{study.index_part.ratio(name, 'pagemeld', 'wall'):.2f}"
            lines.append(table_row(["medium, index only", name, *times, peak, "-", ratio]))
    return "\n".join(lines) + "\n"


def series_table(study):
    lines = table_head(["series", "count", "CPU, s", "ratio to the step before"])
    for series, steps in study.series.items():
        for count, cpu, ratio in steps:
            lines.append(table_row([series, f"{count:,}", f"{cpu:.3f}", f"{ratio:.2f}" if ratio else "-"]))
    return "\n".join(lines) + "\n"


def table_head(cells):
    return [table_row(cells), table_row(["---"] * len(cells))]


def table_row(cells):
    return f"| {' | '.join(cells)} |"
