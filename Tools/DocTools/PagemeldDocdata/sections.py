"""The sections of a page: what is read of them, and what the index needs."""
from typing import NamedTuple

from words import find_plain_words, find_words

SHOWN_LENGTH = 300


class Section(NamedTuple):
    level: int  # of its heading, 0 for the beginning of the page
    anchor: str  # "" if nothing leads there
    heading: str
    name: str  # the heading, of a member without its parameters
    lead: str  # the beginning of its first paragraph
    words: str  # those of heading and first paragraph, with a space between them
    more_words: str  # the others


def shorten(text):
    """Returns text with at most SHOWN_LENGTH letters, cut between words."""
    if len(text) <= SHOWN_LENGTH:
        return text
    return text[:SHOWN_LENGTH - 1].rpartition(" ")[0] + " \u2026"


class OpenSection:
    """A section while it is read."""

    def __init__(self, level, anchor="", heading="", name=""):
        self.level, self.anchor, self.heading, self.name = level, anchor, heading, name
        self.lead, self.texts = "", []

    def add(self, text, is_paragraph=False):
        if is_paragraph and not self.lead:
            self.lead = text.removesuffix(" More...")
        elif text:
            self.texts.append(text)

    def close(self):
        lead = self.lead or (self.texts.pop(0) if self.texts else "")
        words = find_words(self.heading) | find_plain_words(lead)
        more_words = find_plain_words(" ".join(self.texts)) - words
        return Section(self.level, self.anchor, self.heading, self.name, shorten(lead), " ".join(words),
                       " ".join(more_words))
