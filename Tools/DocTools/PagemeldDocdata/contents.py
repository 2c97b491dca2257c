"""Makes the contents of a set, from lists in its pages or from its directories."""
import os
import re
from typing import NamedTuple
from urllib.parse import unquote

from generators import DIRECTORY_PAGES, GENERATED
from markup import squeeze
from messages import warn
from search_index import UNWRITABLE
from titles import is_generic, make_title

SCHEME = re.compile("[a-zA-Z][a-zA-Z0-9+.-]*:")


class Row(NamedTuple):
    """An entry before it is part of the tree."""
    depth: int
    link: str  # "null" if it leads to no page
    title: str


def resolve(address, base, paths):
    """Returns path and fragment of an address in the page base. The path is empty if it leads out of the set, or to
    nothing, as the "#" of menus."""
    if address.strip() == "#":
        return "", ""
    place, _, fragment = address.strip().partition("#")
    place = unquote(place.partition("?")[0])
    path = os.path.normpath(os.path.join(os.path.dirname(base), place)) if place else base
    if SCHEME.match(address) or path.startswith(("..", "/")):
        return "", ""
    own = os.path.normpath(f"{path}/index.html")
    return own if own in paths else path, unquote(fragment)


def has_entry(path, titles):
    """Returns whether links to a page become entries: it is in the set, and no generated "Index" or "Search"."""
    return path in titles and not (GENERATED.fullmatch(path) and is_generic(titles[path]))


def list_links(items, base, titles, directory):
    """Returns the items of the lists of the page base as rows; those that lead to no page for an entry are "null"."""
    rows, missing = [], set()
    for item in items:
        path, fragment = resolve("//" if item.address is None else item.address, base, titles)
        is_entry = has_entry(path, titles)
        title = make_title(squeeze("".join(item.pieces[item.link_start if is_entry else 0:])), f"{directory}/{base}")
        if is_entry:
            link = f"{path}#{fragment}" if fragment and not UNWRITABLE.search(fragment) else path
            rows.append(Row(item.depth, link, title or titles[path]))
        else:
            rows.append(Row(item.depth, "null", title))
            missing.add(path)
    for path in sorted(missing - {""} - titles.keys()):
        warn(f"{directory}/{base}: links to {ascii(path)}, which is not a page of the set, are left out")
    return rows


def list_directories(titles, start):
    """Returns directories and pages as rows, without generated ones; a directory leads to its own page."""
    rows, last_parents = [], []
    for path, title in titles.items():
        if GENERATED.fullmatch(path):
            continue
        *parents, name = path.split("/")
        rows += [Row(depth, "null", parent) for depth, parent in enumerate(parents, 1)
                 if parents[:depth] != last_parents[:depth]]
        if parents != last_parents and name in DIRECTORY_PAGES:
            rows[-1] = Row(len(parents), path, title)
        elif path != start:
            rows.append(Row(len(parents) + 1, path, title))
        last_parents = parents
    return rows


def take_nodes(rows, above):
    """Takes rows from the end of the list while they are deeper than above, and returns their tree. Drops those without
    a link or children. What is below a row without title, as in mdBook's lists, goes below the row before."""
    nodes = []
    while rows and rows[-1].depth > above:
        depth, link, title = rows.pop()
        children = take_nodes(rows, depth)
        if not title and nodes:
            nodes[-1]["children"] = (nodes[-1]["children"] or []) + children or None
        elif link != "null" or children:
            nodes.append({"link": link, "title": title, "children": children or None})
    return nodes


def repeats(node, module):
    """Returns whether an entry only says again what that of the module says, as "Home" or the title page of a book."""
    return not node["children"] and (node["link"] == module["link"] or node["title"] == module["title"])


def make_contents(root, module, row_lists, shared_groups):
    """Returns the value of toc.json. Below the root is the entry of the module, and before it the shared groups."""
    nodes = [node for rows in row_lists for node in take_nodes(rows[::-1], 0)]
    shared = [node for node in nodes if node["link"] == "null" and node["title"] in shared_groups]
    own = [node for node in nodes if node not in shared and not repeats(node, module)]
    module = {**module, "children": own or None}
    return {**root, "children": [*shared, module]}
