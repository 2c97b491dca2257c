"""What the program says on the error stream."""
import sys

PROGRAM = "pagemeld-docdata"


def say(message):
    print(f"{PROGRAM}: {message}", file=sys.stderr)


def warn(message):
    say(f"warning: {message}")
