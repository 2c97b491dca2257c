"""Finds the terms of texts."""
import re
import unicodedata

COMMON = dict.fromkeys("a an and are as at be by for from has in is it its of on one or that the to with".split(), 1)
# Queries are split into runs of letters, marks, digits and "_". \w matches all of these except the marks.
MARKS = "".join(c for c in map(chr, [*range(0x300, 0x1F000), *range(0xE0100, 0xE01F0)])
                if unicodedata.category(c)[0] == "M")
WORD = re.compile(f"[\\w{MARKS}]+")
ASCII_WORD = re.compile(r"\w+", re.A)
LONG_NUMBER = re.compile(r"\d{5,}")
LONGEST_WORD = 40


def find_words(text):
    """Returns the set of terms of a text, without the one that sets the prototype of an object in a script."""
    text = text.lower()
    return set((ASCII_WORD if text.isascii() else WORD).findall(text)) - COMMON.keys() - {"__proto__"}


def find_plain_words(text):
    """Returns the terms of a text that readers may ask for."""
    return {word for word in find_words(text) if len(word) <= LONGEST_WORD and not LONG_NUMBER.fullmatch(word)}
