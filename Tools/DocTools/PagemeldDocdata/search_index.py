"""Makes the search index of a set from its pages: entries for pages and for the places in them, the texts that are
shown, and for each word the texts that have it."""
import collections
import re
from typing import NamedTuple

from page import COMMON, find_words
from titles import replace_unwritable

# The scripts escape nothing in paths, and "#" ends one.
UNWRITABLE = re.compile('["\\\\\0-\x1f\x7f\ud800-\udfff]')
REPEATED_SHARE = 0.25  # of the pages: a heading on more of them, such as "Examples", names no place
REPEATED_LEAST = 10
FREQUENT_SHARE = 0.05  # of the texts: a word in more of them is left out beyond headings and first paragraphs
FREQUENT_LEAST = 20


class Text(NamedTuple):
    """A text with the words that it is found by, those shown and the others, in the entry that it belongs to."""
    entry: int
    shown: str
    words: str
    more_words: str


def find_repeated_headings(pages):
    uses = collections.Counter(heading for page in pages.values()
                               for heading in {section.heading for section in page.sections})
    least = max(REPEATED_LEAST, REPEATED_SHARE * len(pages))
    return {heading for heading, count in uses.items() if count > least}


def join_shown(section, title):
    return " \u2013 ".join(part for part in (section.heading, section.lead) if part and part != title) or title


class IndexMaker:
    """Collects the entries and texts of all pages, then orders the words."""

    def __init__(self, repeated_headings):
        self.repeated_headings = repeated_headings
        self.entries, self.texts = [], []

    def add_page(self, path, title, page, is_generated):
        self.entries.append([path, title])
        if is_generated:
            self.add_headings(page)
            return
        around = [(0, len(self.entries) - 1)]  # the places that hold the section, with the levels of their headings
        for section in page.sections:
            while around[-1][0] >= section.level > 0:
                around.pop()
            if self.is_place(section):
                around.append((section.level, len(self.entries)))
                self.entries.append([f"{path}#{section.anchor}", replace_unwritable(section.name)])
            self.add_text(around[-1][1], section)

    def is_place(self, section):
        return section.anchor and section.heading not in self.repeated_headings and not UNWRITABLE.search(section.anchor)

    def add_headings(self, page):
        """Adds only what a generated page is called."""
        path, title = self.entries[-1]
        words = find_words(" ".join([title, *(section.heading for section in page.sections)]))
        self.texts.append(Text(len(self.entries) - 1, title, words, ()))

    def add_text(self, entry, section):
        title = self.entries[entry][1]
        is_first = not self.texts or self.texts[-1].entry < entry
        if not (is_first or section.lead or section.more_words):
            return  # a heading without text, such as Doxygen's "Member Function Documentation"
        words = set(section.words.split())
        if is_first:
            words |= find_words(title)
        if words or section.more_words:
            self.texts.append(Text(entry, join_shown(section, title), words, section.more_words.split()))

    def order_words(self):
        """Returns the numbers of the texts that have a word, by word."""
        found, more = collections.defaultdict(list), collections.defaultdict(list)
        for number, text in enumerate(self.texts):
            for word in text.words:
                found[word].append(number)
            for word in text.more_words:
                more[word].append(number)
        most = max(FREQUENT_LEAST, FREQUENT_SHARE * len(self.texts))
        for word, numbers in more.items():
            if len(numbers) + len(found.get(word, ())) <= most:
                found[word] = sorted(found[word] + numbers) if word in found else numbers
        return dict(sorted(found.items()))


def make_index(pages, titles, is_generated):
    """Returns the value of index.json."""
    maker = IndexMaker(find_repeated_headings(pages))
    for path, page in pages.items():
        maker.add_page(path, titles[path], page, is_generated(path))
    return {"pages": maker.entries, "info": [[text.shown, text.entry] for text in maker.texts], "common": COMMON,
            "searchIndex": maker.order_words()}
