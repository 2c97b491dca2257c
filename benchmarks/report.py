"""Turns what was measured into Markdown: for each file system, by its name, the rounds of each study."""

from itertools import pairwise


def run_table(results):
    """Returns the medians of every program, by corpus."""
    head = [f"{system}: wall, s | / limit | user, s | system, s | peak, MB" for system in results]
    rows = [("corpus", "program", *head), ("---",) * (2 + 5 * len(results))]
    for study in ("small", "medium", "large"):
        measured = [rounds_of[study] for rounds_of in results.values() if study in rounds_of]
        for program in measured[0].contenders if measured else ():
            rows.append((study, program, *(run_cells(rounds, program) for rounds in measured)))
    return table(rows)


def run_cells(rounds, program):
    wall, user, system = (f"{rounds.median(program, measure):.3f}" for measure in ("wall", "user", "system"))
    peak = "-" if program == "limit" else f"{rounds.median(program, 'peak') / 1e6:.0f}"
    return " | ".join([wall, f"{rounds.ratio(program, 'limit', 'wall'):.2f}", user, system, peak])


def series_table(results):
    """Returns how the CPU time grows when the size doubles, from the smallest size to the largest."""
    rows = [("doubled", *(f"{system}: CPU, s | largest step" for system in results)), ("---",) * (1 + 2 * len(results))]
    for study in ("terms", "siblings"):
        measured = [rounds_of[study] for rounds_of in results.values() if study in rounds_of]
        if measured:
            first, *_, last = measured[0].contenders
            rows.append((f"{study}, {first:,} to {last:,}", *map(series_cells, measured)))
    return table(rows)


def series_cells(rounds):
    first, *_, last = rounds.contenders
    largest_step = max(rounds.ratio(size, half, "cpu") for half, size in pairwise(rounds.contenders))
    return f"{rounds.median(first, 'cpu'):.3f} to {rounds.median(last, 'cpu'):.3f} | {largest_step:.2f}"


def table(rows):
    return "\n".join(f"| {' | '.join(row)} |" for row in rows)
