"""What the program says on the error stream."""
import sys
import time

PROGRAM = "pagemeld-docdata"
SECONDS_BETWEEN = 0.2


def say(message):
    print(f"{PROGRAM}: {message}", file=sys.stderr)


def warn(message):
    say(f"warning: {message}")


class Progress:
    """A line on a terminal that says how many pages are done, and is gone at the end. Nothing elsewhere."""

    def __init__(self, count):
        self.count, self.done, self.shown = count, 0, time.monotonic()

    def advance(self, directory):
        self.done += 1
        if time.monotonic() - self.shown > SECONDS_BETWEEN:
            self.shown = time.monotonic()
            self.show(f"{directory}: {self.done} of {self.count} pages")

    def clear(self):
        self.show("")

    @staticmethod
    def show(text):
        if sys.stderr.isatty():
            print(f"\r\033[K{text}", end="", file=sys.stderr, flush=True)
