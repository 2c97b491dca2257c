"""Reads the lists in a page that may be contents."""
from generators import PARTS, SKIP, SKIPPED_ROLES, SKIPPED_TAGS
from markup import TOKEN, read_attributes

LISTS = {"ul", "ol", "dl"}
DEEPEST = 50  # level of items; of lists that are never closed each one would be deeper than the last


class Item:
    """An item of a list: its text in pieces, and the first address in it with the number of pieces before."""

    def __init__(self, depth):
        self.depth, self.pieces, self.address, self.link_start = depth, [], None, 0


class ListReader:
    """Reads the items of the lists of a page: those of HTML's lists, the rows of Doxygen's tables, and the first cells
    of javadoc's."""

    def __init__(self, is_navigation_read):
        self.skipped_tags = SKIPPED_TAGS - {"nav"} if is_navigation_read else SKIPPED_TAGS
        self.skipped_roles = set() if is_navigation_read else SKIPPED_ROLES
        self.is_navigation_read = is_navigation_read
        self.items, self.item, self.depth = [], None, 0
        self.skipped_tag, self.skipped_depth = "", 0

    def read(self, html):
        position = 0
        for token in TOKEN.finditer(html):
            if self.item and not self.skipped_tag:
                self.item.pieces.append(html[position:token.start()])
            position = token.end()
            _, name, attributes = token.groups(default="")
            if name.startswith("/"):
                self.end(name[1:].lower())
            elif name:
                self.start(name.lower(), read_attributes(attributes))
        return self.items

    def start(self, name, attributes):
        if self.skipped_tag:
            self.skipped_depth += name == self.skipped_tag
            return
        classes = attributes.get("class", "").split()
        role = attributes.get("role")
        if name in self.skipped_tags or role in self.skipped_roles or any(
                PARTS.get((name, one)) == SKIP for one in classes):
            self.skipped_tag, self.skipped_depth = name, 1
            return
        if (name == "main" or role == "main") and not self.is_navigation_read:
            self.items, self.item, self.depth = [], None, 0
        self.start_item(name, attributes, classes)

    def start_item(self, name, attributes, classes):
        row = attributes.get("id", "") if name == "tr" else ""
        if name in LISTS:
            self.depth, self.item = self.depth + 1, None
        elif name in ("li", "dt") or row.startswith("row_") or "col-first" in classes:
            depth = row.count("_") - 1 if row else max(self.depth, 1)
            self.item = Item(min(depth, DEEPEST))
            self.items.append(self.item)
        elif attributes.get("rel") in ("next", "prev"):
            self.item = None  # leads through the pages
        elif name == "a" and self.item and self.item.address is None and "href" in attributes:
            self.item.address, self.item.link_start = attributes["href"], len(self.item.pieces)

    def end(self, name):
        if self.skipped_tag:
            self.skipped_depth -= name == self.skipped_tag
            self.skipped_tag = self.skipped_tag if self.skipped_depth else ""
            return
        if name in LISTS:
            self.depth = max(self.depth - 1, 0)
        is_link_over = name == "a" and self.item and self.item.address is not None
        if name in LISTS or name in ("li", "dt", "td") or is_link_over:
            self.item = None
