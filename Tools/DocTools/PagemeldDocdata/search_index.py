"""Makes the search index of a set from its pages: entries for pages and for the places in them, the texts that are
shown, and for each word the texts that have it."""
import collections
import json
import re
from array import array

from titles import replace_unwritable
from words import COMMON, find_words

# The scripts escape nothing in paths.
UNWRITABLE = re.compile('["\\\\\0-\x1f\x7f\ud800-\udfff]')
REPEATED_SHARE = 0.25  # of the pages: a heading on more of them, such as "Examples", names no place
REPEATED_LEAST = 10
FREQUENT_SHARE = 0.05  # of the texts: a word in more of them is left out beyond headings and first paragraphs
FREQUENT_LEAST = 20

encode = json.JSONEncoder(ensure_ascii=False).encode


def find_repeated_headings(pages):
    uses = collections.Counter(heading for page in pages for heading in page.headings)
    least = max(REPEATED_LEAST, REPEATED_SHARE * len(pages))
    return {heading for heading, count in uses.items() if count > least}


def join_shown(section, title):
    return " \u2013 ".join(part for part in (section.heading, section.lead) if part and part != title) or title


class IndexMaker:
    """Collects the entries, texts and words of the pages, in the order in which they are added. Entries and texts are
    kept as lines of the file, which takes the least memory."""

    def __init__(self, repeated_headings):
        self.repeated_headings = repeated_headings
        self.entries, self.texts = [], []
        self.words = collections.defaultdict(lambda: array("I"))  # in headings and first paragraphs, with their texts
        self.more_words = collections.defaultdict(lambda: array("I"))  # elsewhere
        self.last_entry = -1  # that has a text
        self.term_count = 0  # once they are written

    def add_page(self, path, title, sections):
        """Adds the entry of a page, then those of its places. A section that is no place belongs to the place before it
        that has a larger heading, or to the page."""
        around = [(0, self.add_entry(path, title), title)]
        for section in sections:
            while around[-1][0] >= section.level > 0:
                around.pop()
            if self.is_place(section):
                name = replace_unwritable(section.name)
                around.append((section.level, self.add_entry(f"{path}#{section.anchor}", name), name))
            _, entry, title = around[-1]
            self.add_section(entry, title, section)

    def add_entry(self, path, title):
        self.entries.append(encode([path, title]))
        return len(self.entries) - 1

    def is_place(self, section):
        anchor = section.anchor
        return anchor and section.heading not in self.repeated_headings and not UNWRITABLE.search(anchor)

    def add_section(self, entry, title, section):
        """Adds the text of a section. A heading without text, such as "Member Function Documentation", is left out, but
        each entry gets a text, by which its title is found."""
        is_first = entry > self.last_entry
        if is_first or section.lead or section.more_words:
            words = set(section.words.split())
            self.add_text(entry, join_shown(section, title), words | find_words(title) if is_first else words,
                          section.more_words.split())

    def add_text(self, entry, shown, words, more_words):
        number = len(self.texts)
        for word in words:
            self.words[word].append(number)
        for word in more_words:
            self.more_words[word].append(number)
        if words or more_words:
            self.texts.append(encode([shown, entry]))
            self.last_entry = max(entry, self.last_entry)

    def list_terms(self):
        """Returns the words with the numbers of their texts, in order, as lines of the file."""
        most = max(FREQUENT_LEAST, FREQUENT_SHARE * len(self.texts))
        for word in sorted(self.words.keys() | self.more_words.keys()):
            numbers, more = self.words.get(word, array("I")), self.more_words.get(word, array("I"))
            if len(numbers) + len(more) <= most:
                numbers = sorted(numbers + more)
            if numbers:
                yield f"{encode(word)}: {list(numbers)}"

    def write(self, file):
        """Writes index.json, with a line for each page, text and term, and counts the terms."""
        file.write('{"pages": [\n' + ",\n".join(self.entries))
        file.write('\n],\n"info": [\n' + ",\n".join(self.texts))
        file.write(f'\n],\n"common": {encode(COMMON)},\n"searchIndex": {{')
        self.term_count = 0
        for line in self.list_terms():
            file.write(("," if self.term_count else "") + "\n" + line)
            self.term_count += 1
        file.write("\n}}\n")


def make_index(pages, titles):
    """Returns the maker of the index of pages, which are packed, by path. Takes them out of the dictionary, since texts
    and pages together would need twice the memory."""
    maker = IndexMaker(find_repeated_headings(pages.values()))
    for path, title in titles.items():
        maker.add_page(path, title, pages.pop(path).unpack())
    return maker
