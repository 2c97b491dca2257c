"""Runs commands and tells what they cost."""

import os
import random
import statistics
import subprocess
import time
from dataclasses import dataclass


@dataclass(frozen=True)
class Cost:
    wall: float  # seconds, as the three below
    user: float
    system: float
    peak: int  # bytes of resident memory; never below what this program itself has

    @property
    def cpu(self):
        return self.user + self.system


def run(command):
    """Runs a command that must succeed, its output thrown away."""
    start = time.perf_counter()
    process = subprocess.Popen(command, stdout=subprocess.DEVNULL, stderr=subprocess.DEVNULL)
    _, status, usage = os.wait4(process.pid, 0)
    wall = time.perf_counter() - start
    process.returncode = os.waitstatus_to_exitcode(status)
    if process.returncode != 0:
        raise SystemExit(f"{' '.join(command[:3])} ... ended with {process.returncode}")
    return Cost(wall, usage.ru_utime, usage.ru_stime, usage.ru_maxrss * 1024)


class Rounds:
    """The costs of several contenders, measured in turn, round by round, so that a slow moment hits all alike."""

    def __init__(self, contenders, rounds, prepare, check):
        """Contenders are commands by name; prepare() is called before each run, check(name) after it."""
        self._costs = {name: [] for name in contenders}
        for _ in range(rounds):
            order = list(contenders.items())
            random.shuffle(order)
            for name, command in order:
                prepare()
                self._costs[name].append(run(command))
                check(name)

    def names(self):
        return list(self._costs)

    def median(self, name, measure):
        return statistics.median(getattr(cost, measure) for cost in self._costs[name])

    def ratio(self, name, other, measure):
        """Returns the median, over the rounds, of one contender's cost divided by another's."""
        return statistics.median(
            getattr(cost, measure) / getattr(base, measure)
            for cost, base in zip(self._costs[name], self._costs[other])
        )

    def growth_ratio(self, pair, other_pair, measure):
        """Returns the median ratio of two differences, each of the costs of a larger run and of a smaller one."""

        def growths(names):
            larger, smaller = (self._costs[name] for name in names)
            return [getattr(a, measure) - getattr(b, measure) for a, b in zip(larger, smaller)]

        return statistics.median(a / b for a, b in zip(growths(pair), growths(other_pair)))
