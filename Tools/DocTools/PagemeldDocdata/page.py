"""Reads a page: its title, and its sections. A section begins at a heading or at the name of a member, and has an
anchor if one leads there."""
import functools
import re
from typing import NamedTuple

from generators import LISTING, MEMBER, NAME, PARTS, SKIP, SKIPPED_ROLES, SKIPPED_TAGS, TEXT, UNUSED
from markup import TAG, TOKEN, first_line, read_attributes, squeeze
from sections import OpenSection, Section
from words import find_words

NUMBER = re.compile(r"^[\dA-Z]+(\.\d+)*\.?\s+")  # of a section, before its name
LONGEST_TITLE = 2000
MAIN = "main"
REDIRECT = "redirect"
MARKED = re.compile(r"\b(?:id|class|name|role|http-equiv)\s*=", re.I)
AFTER_SECONDS = re.compile(r"[\d.]*[;,\s]+\S")  # the address to which a page refreshes itself

# The texts end at the next tag of that kind, so that tags that are never closed take linear time.
TITLE = re.compile(r"<title[^<>]*>((?:(?!</?title).){0,2000})</title", re.S | re.I)
HEADING = re.compile(r"<h([1-6])\b[^<>]*>((?:(?!</?h[1-6]).){0,2000})</h\1", re.S | re.I)

LEVELS = {"h1": 1, "h2": 2, "h3": 3, "h4": 4, "h5": 5, "h6": 6, "dt": 7, MEMBER: 7}
KINDS = {**{name: name for name in ("h1", "h2", "h3", "h4", "h5", "h6", "dt", "title")}, "p": TEXT}
BLOCKS = KINDS.keys() | set(
    "article aside blockquote body caption center dd details div dl figure form header hr li main ol section summary "
    "table tbody td th thead tr ul".split())
READ_WITHOUT_ATTRIBUTES = BLOCKS | SKIPPED_TAGS | {"br"}


class Page(NamedTuple):
    title: str
    heading: str  # the main one
    sections: list  # the first is the beginning of the page
    is_redirect: bool = False  # it only leads to another page


@functools.lru_cache(maxsize=4096)
def read_traits(name, attributes):
    """Returns what the tables say of an element, "" if nothing, and its anchor, "" if it has none."""
    values = read_attributes(attributes) if MARKED.search(attributes) else {}
    role = values.get("role")
    if name in SKIPPED_TAGS or role in SKIPPED_ROLES:
        return SKIP, ""
    part = next((PARTS[name, one] for one in values.get("class", "").split() if (name, one) in PARTS), "")
    if name == "main" or role == "main":
        part = MAIN
    elif values.get("http-equiv", "").lower() == "refresh" and AFTER_SECONDS.match(values.get("content", "").strip()):
        part = REDIRECT
    return part, values.get("id") or name == "a" and values.get("name") or ""


class PageReader:
    """Goes through the tokens of a page and collects the texts between the boundaries of blocks."""

    def __init__(self):
        self.title, self.is_redirect = "", False
        self.block = ""  # what the block being read is
        self.data = []  # the pieces of its text
        self.part, self.part_tag, self.part_depth, self.part_start = "", "", 0, 0
        self.start_over()

    def start_over(self):
        """Forgets what came before <main>."""
        self.section = OpenSection(0)
        self.sections = [self.section]
        self.anchor, self.anchor_at = "", 0  # the last one, and how much of the block's text was there
        self.row_anchor = ""  # the last one since the last heading
        self.names = []
        self.outer = []  # the sections around lists, to which what follows a list belongs

    def read(self, html):
        self.read_tokens(html)
        self.end_block()
        sections = [section.close() for section in self.sections]
        return Page(self.title, sections[0].heading, sections, self.is_redirect)

    def read_tokens(self, html):
        position = 0
        for token in TOKEN.finditer(html):
            if token.start() > position:
                self.data.append(html[position:token.start()])
            position = token.end()
            listing, name, attributes = token.groups()
            if name is None:
                self.add_listing(listing)  # None of a comment
            elif name.lower() == "/main":
                return
            elif name[0] == "/":
                self.end(name[1:].lower())
            elif attributes or name.lower() in READ_WITHOUT_ATTRIBUTES or self.part:
                self.start(name.lower(), attributes)
        self.data.append(html[position:])

    def start(self, name, attributes):
        if self.part:
            self.part_depth += name == self.part_tag
            return
        part, anchor = read_traits(name, attributes)
        if part in (SKIP, LISTING, NAME):
            self.part, self.part_tag, self.part_depth, self.part_start = part, name, 1, len(self.data)
        elif part or name in BLOCKS:
            self.start_block(name, part)
        elif name == "br":
            self.data.append(" ")
        if anchor:
            self.anchor, self.anchor_at = anchor, len(self.data)
            self.row_anchor = anchor if name == "a" else self.row_anchor

    def start_block(self, name, part):
        self.end_block()
        if part == MAIN:
            self.start_over()
        elif part == REDIRECT:
            self.is_redirect = True
        self.block = part or KINDS.get(name, "")
        if self.block in LEVELS:
            self.names = []
        if name == "dt":  # an anchor before it leads to the list
            self.anchor = ""
        elif name == "dl":
            self.outer.append(self.section)

    def end(self, name):
        if self.part:
            self.part_depth -= name == self.part_tag
            if self.part_depth == 0:
                self.end_part()
        elif name in BLOCKS:
            self.end_block()
            if name == "dl" and self.outer:
                self.section = self.outer.pop()

    def end_part(self):
        part, text = self.part, "".join(self.data[self.part_start:])
        self.part = ""
        if part == NAME:
            self.names.append(text)
            return
        del self.data[self.part_start:]
        if part == LISTING:
            self.add_listing(text)

    def add_listing(self, listing):
        if listing and not self.part:
            self.end_block()
            self.section.add(first_line(listing))

    def end_block(self):
        """Puts the text since the last boundary where it belongs. An anchor before text leads to nothing later."""
        block, self.block = self.block, ""
        if not self.data:
            return
        text = squeeze("".join(self.data))
        if block in LEVELS:
            self.end_heading(block, text)
        elif self.anchor and "".join(self.data[self.anchor_at:]).strip():
            self.anchor = ""
        if block == "title":
            self.title = self.title or text[:LONGEST_TITLE]
        elif block not in LEVELS and block != UNUSED:
            self.section.add(text, block == TEXT)
        self.data.clear()
        self.anchor_at = 0

    def end_heading(self, block, text):
        """Begins a section, unless the heading is that of the page, has no text, or is a term that nothing leads to."""
        anchor = self.row_anchor if block == MEMBER else self.anchor
        if not text or block == "dt" and not anchor:
            self.section.add(text)
        elif len(self.sections) == 1 and not self.section.heading and self.is_of_page(block, text):
            self.section = self.sections[0] = OpenSection(0, "", text, text)
        else:
            name = find_name(text, squeeze("".join(self.names)), block)
            self.section = OpenSection(LEVELS[block], anchor, text, name)
            if block != MEMBER or anchor:  # a row that links to a section of its own is not read
                self.sections.append(self.section)
        self.anchor = self.row_anchor = ""

    def is_of_page(self, block, text):
        return block == "h1" or NUMBER.sub("", text) in self.title


def find_name(heading, name, block):
    """Returns the title of a place: of a member its name."""
    if name:
        return name
    return heading.partition("(")[0].rstrip() or heading if LEVELS[block] > 5 else heading


def read_page(html):
    """Returns the page that a text describes."""
    return PageReader().read(html)


def read_headings(html):
    """Returns the page with its title and headings only; where headings stand makes no difference."""
    titles = [squeeze(TAG.sub(" ", text)) for text in TITLE.findall(html)]
    headings = [squeeze(TAG.sub(" ", text)) for _, text in HEADING.findall(html)]
    title = titles[0] if titles else ""
    heading = headings[0] if headings else ""
    return Page(title, heading, [Section(0, "", heading, heading, "", " ".join(find_words(" ".join(headings))), "")])
