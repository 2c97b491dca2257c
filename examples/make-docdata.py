#!/usr/bin/env python3
"""Makes docdata/index.json and docdata/toc.json of documentation sets from their HTML pages.

The search index has every page below a set directory, with each heading and the first paragraph after it. The contents
have an entry for the module, its start page, and below it the directories with their pages; or, with --toc, the links
of lists that the documentation has: pages FILE in each set directory, such as Doxygen's pages.html and annotated.html,
Sphinx's contents.html or javadoc's overview-tree.html. Pages that no list has are found only by the search.

Groups without a page at the top stand beside the module's entry, so that all modules with such a group share it. All
modules of a set need the same root; by default it has the name of the set directory and leads to index.html.

If a page has a <main>, what comes before it is skipped. The same pages always give the same files.
"""
import argparse
import collections
import json
import os
import re
import sys
import unicodedata
from html.parser import HTMLParser
from urllib.parse import unquote

COMMON = dict.fromkeys("a an and are as at be by for from has in is it its of on one or that the to with".split(), 1)
# Queries are split into runs of letters, marks, digits and "_". \w matches all of these except the marks.
MARKS = "".join(c for c in map(chr, range(0x300, 0xE0200)) if unicodedata.category(c)[0] == "M")
WORD = re.compile(f"[\\w{MARKS}]+")

# The scripts escape only the quotes of titles, and nothing in paths and links. "#" would end a path.
LOOK_ALIKES = {ord("\\"): "\u2216", 0x7F: "\u2421", **{code: 0x2400 + code for code in range(0x20)}}
UNWRITABLE = re.compile('["\\\\#\0-\x1f\x7f\ud800-\udfff]')
SCHEME = re.compile("[a-zA-Z][a-zA-Z0-9+.-]*:")

HEADINGS = {"h1", "h2", "h3", "h4", "h5", "h6"}
LISTS = {"ul", "ol"}
BLOCKS = HEADINGS | LISTS | set("blockquote body dd div dl dt hr li main p pre section table td th title tr".split())
UNREAD_TAGS = {"nav", "noscript", "script", "style"}
UNREAD_PARTS = {("a", "headerlink"),  # from Sphinx; the others from Doxygen
                ("span", "permalink"), ("span", "arrow"), ("span", "icon"), ("ul", "tablist"), ("div", "navpath"),
                ("tr", "inherit")}
# Doxygen lists members in table rows. A member without a section of its own has no heading: its anchor is in the row.
READ_PARTS = {("div", "title"): "h1", ("div", "block"): "p", ("div", "textblock"): "p", ("dt", "sig"): "h6",
              ("td", "fieldname"): "h6", ("td", "memItemRight"): "member", ("td", "memTemplItemRight"): "member",
              ("td", "inherit_header"): "member", ("td", "mdescRight"): "p"}
DIRECTORY_PAGES = ("index.html", "index.htm", "package-summary.html")


def warn(message):
    print(f"make-docdata.py: warning: {message}", file=sys.stderr)


def make_title(text, place):
    title = text.translate(LOOK_ALIKES)
    if title != text:
        warn(f'{place}: what would break the scripts is replaced in the title "{title}"')
    return title


def decode(data):
    try:
        return data.decode()
    except UnicodeDecodeError:
        declared = re.search(rb"""(?:charset|encoding)\s*=\s*["']?\s*([\w.:-]+)""", data[:4096])
    try:
        return data.decode(declared[1].decode() if declared else "cp1252", "replace")
    except (LookupError, ValueError):  # of no such encoding, or not for texts
        return data.decode("cp1252", "replace")


class Page(HTMLParser):
    """What is read from a page: its title, its main heading, its texts (each heading with the first paragraph after
    it) and its list items (depth, address or None, text, where in the text the link begins). Items are those of lists,
    the rows of Doxygen's tables and the first cells of javadoc's."""

    def __init__(self, html, place):
        super().__init__()
        self.place = place
        self.title = ""
        self.clear()
        self.unread = None  # the tag that is skipped, and how many of it are open
        self.block, self.data = None, ""
        self.item, self.list_depth = None, 0
        self.anchored = False  # whether there was an anchor after the last heading or member
        self.feed(html)
        self.close()
        self.end_block()

    def clear(self):
        self.heading, self.text, self.items = "", ["", ""], []
        self.texts = [self.text]

    def handle_starttag(self, tag, attributes):
        attributes = {name: value or "" for name, value in attributes}
        classes = attributes.get("class", "").split()
        if tag == "br":
            self.handle_data(" ")
        elif self.unread:
            self.unread[1] += tag == self.unread[0]
        elif tag in UNREAD_TAGS or attributes.get("role") == "navigation" or any(
                (tag, name) in UNREAD_PARTS for name in classes):
            self.unread = [tag, 1]
        else:
            if tag == "main" or attributes.get("role") == "main":
                self.clear()
            self.start_block(tag, attributes, classes)
            self.start_item(tag, attributes, classes)

    def start_block(self, tag, attributes, classes):
        if tag in BLOCKS:
            self.end_block()
        if tag in HEADINGS | {"p", "title"}:
            self.block = tag
        elif tag == "dt" and "id" in attributes:
            self.block = "h6"
        elif tag == "a" and "id" in attributes:
            self.anchored = True
        for name in classes:
            self.block = READ_PARTS.get((tag, name), self.block)

    def start_item(self, tag, attributes, classes):
        row = attributes.get("id", "") if tag == "tr" else ""
        if tag in LISTS:
            self.list_depth, self.item = self.list_depth + 1, None
        elif tag == "li" or row.startswith("row_") or "col-first" in classes:
            self.item = [row.count("_") - 1 if row else max(self.list_depth, 1), None, "", 0]
            self.items.append(self.item)
        elif tag == "a" and self.item and "href" in attributes:
            self.item[1], self.item[3] = attributes["href"], len(self.item[2])

    def handle_data(self, data):
        if self.block and not self.unread:
            self.data += data
        if self.item and not self.unread:
            self.item[2] += data

    def handle_endtag(self, tag):
        if self.unread:
            self.unread[1] -= tag == self.unread[0]
            self.unread = self.unread if self.unread[1] else None
            return
        if tag in BLOCKS:
            self.end_block()
        if tag in LISTS:
            self.list_depth = max(self.list_depth - 1, 0)
        if tag in LISTS or tag in ("li", "td") or (tag == "a" and self.item and self.item[1] is not None):
            self.item = None

    def end_block(self):
        text, block = " ".join(self.data.split()), self.block
        self.block, self.data = None, ""
        if block == "title":
            self.title = self.title or text
        elif block == "member" or block in HEADINGS and text:
            self.text = [text, ""]
            if block != "member" or self.anchored:
                self.texts.append(self.text)
            self.heading = self.heading or (text if block == "h1" else "")
            self.anchored = False
        elif block == "p":
            self.text[1] = self.text[1] or text.removesuffix(" More...")


def read_pages(directory):
    """Returns the pages by path, a directory's own first and its subdirectories last."""
    pages = {}
    for place, directories, names in os.walk(directory):
        directories[:] = sorted(name for name in directories if (place, name) != (directory, "docdata"))
        for name in sorted(names, key=lambda name: (name not in DIRECTORY_PAGES, name)):
            file = os.path.join(place, name)
            path = os.path.relpath(file, directory)
            if not name.lower().endswith((".html", ".htm", ".xhtml")):
                continue
            if UNWRITABLE.search(path):
                warn(f"{ascii(file)}: left out: the scripts can't hold its path")
                continue
            try:
                with open(file, "rb") as stream:
                    pages[path] = Page(decode(stream.read()), file)
            except (OSError, AssertionError) as error:  # the parser asserts what it can't read
                warn(f"{file}: left out: {error}")
    return pages


def find_frame(pages):
    """Returns what most titles have before and after their subject, such as "Project: " by Doxygen or " \u2014 Project
    documentation" by Sphinx. The titles that contain the main heading of their page show it."""
    titles = {page.title for page in pages.values()}
    frames = collections.Counter(page.title.partition(page.heading)[::2] for page in pages.values()
                                 if page.heading and page.heading in page.title and page.heading != page.title)
    for (before, after), _ in frames.most_common(1):
        if 2 * sum(title.startswith(before) and title.endswith(after) for title in titles) > len(titles):
            return before, after
    return "", ""


def choose_titles(pages, start):
    """Shortens each <title> to its subject. That of the start page, such as "Main Page", does not say of which module,
    and one that several pages share does not say which page: then the main heading is better."""
    before, after = find_frame(pages)
    subjects = {path: page.title.removeprefix(before).removesuffix(after) for path, page in pages.items()}
    uses = collections.Counter(subjects.values())
    for path, page in pages.items():
        subject = subjects[path]
        if uses[subject] > 1 or path == start and subject != page.title:
            subject = page.heading or subject
        page.title = make_title(subject or page.heading or path, page.place)


def make_index(pages):
    info, terms = [], {}
    for number, (path, page) in enumerate(pages.items()):
        texts = [" \u2013 ".join(part for part in text if part and part != page.title) for text in page.texts]
        extra = page.title
        for text in list(filter(None, texts)) or [page.title]:
            words = set(WORD.findall(f"{extra} {text}".lower())) - COMMON.keys()
            extra = ""
            for word in words:
                terms.setdefault(word, []).append(len(info))
            info += [[text, number]] if words else []
    return {"pages": [[path, page.title] for path, page in pages.items()],
            "info": info, "common": COMMON, "searchIndex": dict(sorted(terms.items()))}


def list_directories(pages, start):
    """Returns directories and pages as rows (depth, link or "null", title); a directory leads to its own page."""
    rows, last_parents = [], []
    for path, page in pages.items():
        *parents, name = path.split("/")
        rows += [(depth, "null", parent) for depth, parent in enumerate(parents, 1)
                 if parents[:depth] != last_parents[:depth]]
        if parents != last_parents and name in DIRECTORY_PAGES:
            rows[-1] = (len(parents), path, page.title)
        elif path != start:
            rows.append((len(parents) + 1, path, page.title))
        last_parents = parents
    return rows


def resolve(address, base, pages):
    """Returns path and fragment of an address in the page base; the path is empty if it leads out of the set."""
    place, _, fragment = address.strip().partition("#")
    place = unquote(place.partition("?")[0])
    path = os.path.normpath(os.path.join(os.path.dirname(base), place)) if place else base
    if SCHEME.match(address) or path.startswith(("..", "/")):
        return "", ""
    own = os.path.normpath(f"{path}/index.html")
    return own if own in pages else path, unquote(fragment)


def list_links(pages, base):
    """Returns the list items of the page base as rows; those that lead to no page of the set are "null"."""
    rows, missing = [], set()
    for depth, address, text, start in pages[base].items:
        path, fragment = resolve(address or "//", base, pages)
        title = make_title(" ".join(text[start if path in pages else 0:].split()), pages[base].place)
        if path in pages:
            link = f"{path}#{fragment}" if fragment and not UNWRITABLE.search(fragment) else path
            rows.append((depth, link, title or pages[path].title))
        else:
            rows.append((depth, "null", title))
            missing.add(path)
    for path in sorted(missing - {""}):
        warn(f"{pages[base].place}: links to {ascii(path)}, which is not a page of the set, are left out")
    return rows


def take_nodes(rows, above):
    """Takes rows from the end of the list while they are deeper than above; drops those without a link or children."""
    nodes = []
    while rows and rows[-1][0] > above:
        depth, link, title = rows.pop()
        children = take_nodes(rows, depth)
        if link != "null" or children:
            nodes.append({"link": link, "title": title, "children": children or None})
    return nodes


def list_contents(pages, lists, start, directory):
    """Returns the rows of each list that there is, or those of the directories if there is none."""
    instead = "" if pages.keys() & set(lists) else ": the contents are made from the directories"
    for path in lists:
        if path not in pages:
            warn(f"{directory}: there is no page {path}{instead}")
    return [list_links(pages, path) for path in lists if path in pages] or [list_directories(pages, start)]


def make_contents(root, module, row_lists):
    nodes = [node for rows in row_lists for node in take_nodes(rows[::-1], 0)]
    module["children"] = [node for node in nodes if node["link"] != "null"] or None
    return {**root, "children": [node for node in nodes if node["link"] == "null"] + [module]}


def make_docdata(directory, root, lists):
    """Returns the values of both files. The root is its link and title; lists are paths of pages."""
    start = root["link"]
    pages = read_pages(directory)
    if not pages:
        sys.exit(f"make-docdata.py: {directory} has no pages")
    choose_titles(pages, start)
    module = {"link": "null", "title": make_title(os.path.basename(os.path.dirname(directory)), directory)}
    if start in pages:
        module = {"link": start, "title": pages[start].title}
    else:
        warn(f"{directory}: there is no page {start}, where the root of the contents leads")
    contents = make_contents(root, module, list_contents(pages, lists, start, directory))
    index = make_index(pages)
    print(f"make-docdata.py: {directory}: {len(pages)} pages, {len(index['info'])} texts, "
          f"{len(index['searchIndex'])} terms", file=sys.stderr)
    return {"index.json": index, "toc.json": contents}


def main():
    parser = argparse.ArgumentParser(description="Makes index.json and toc.json from HTML pages.")
    parser.add_argument("--root-title", metavar="T", help="default: the name of the set directory")
    parser.add_argument("--root-link", metavar="L", default="index.html", help="default: %(default)s")
    parser.add_argument("--toc", metavar="FILE", action="append", default=[],
                        help="page in each set directory whose lists are contents; several are allowed")
    parser.add_argument("set_directories", metavar="SET_DIRECTORY", nargs="+")
    options = parser.parse_args()
    for directory in options.set_directories:
        if not os.path.isdir(directory):
            parser.error(f"{directory} is not a directory")
    for directory in map(os.path.abspath, options.set_directories):
        title = make_title(options.root_title or os.path.basename(directory), directory)
        files = make_docdata(directory, {"link": options.root_link, "title": title}, options.toc)
        os.makedirs(os.path.join(directory, "docdata"), exist_ok=True)
        for name, value in files.items():
            with open(os.path.join(directory, "docdata", name), "w", encoding="utf-8", newline="\n") as file:
                file.write(json.dumps(value, ensure_ascii=False, indent=1) + "\n")


if __name__ == "__main__":
    main()
