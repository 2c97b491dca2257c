"""Makes the docdata of one set directory."""
import fnmatch
import json
import multiprocessing
import os
from typing import NamedTuple

from contents import ListReader, list_directories, list_links, make_contents
from generators import DIRECTORY_PAGES, GENERATED, find_generator
from markup import decode
from messages import say, warn
from page import read_page
from search_index import UNWRITABLE, make_index
from titles import choose_titles, is_generic, make_title

PAGE_NAMES = (".html", ".htm", ".xhtml")
PAGES_AT_ONCE = 16


class SetOptions(NamedTuple):
    """What the command line says of the sets."""
    root_link: str
    root_title: str  # "" for the name of the set directory
    title: str  # "" for that of the start page
    lists: list
    shared_groups: list
    excluded: list
    jobs: int


def list_paths(directory, excluded):
    """Returns the paths of the pages, a directory's own first and its subdirectories last."""
    paths = []
    for place, directories, names in os.walk(directory):
        directories[:] = sorted(name for name in directories if (place, name) != (directory, "docdata"))
        for name in sorted(names, key=lambda name: (name not in DIRECTORY_PAGES, name)):
            path = os.path.relpath(os.path.join(place, name), directory)
            if not name.lower().endswith(PAGE_NAMES) or any(fnmatch.fnmatchcase(path, one) for one in excluded):
                continue
            if UNWRITABLE.search(path) or "#" in path:
                warn(f"{ascii(os.path.join(place, name))}: left out: the scripts can't hold its path")
            else:
                paths.append(path)
    return paths


def read_file(file):
    with open(file, "rb") as stream:
        return decode(stream.read())


def try_page(file):
    """Returns the page in a file, or what is wrong with the file."""
    try:
        return read_page(read_file(file))
    except OSError as error:
        return str(error)


def read_pages(directory, paths, jobs):
    """Returns the pages by path."""
    pages = {}
    files = [os.path.join(directory, path) for path in paths]
    with multiprocessing.Pool(min(jobs, len(files) // PAGES_AT_ONCE + 1)) as pool:
        for path, page in zip(paths, pool.imap(try_page, files, PAGES_AT_ONCE)):
            if isinstance(page, str):
                warn(f"{os.path.join(directory, path)}: left out: {page}")
            else:
                pages[path] = page
    return pages


def choose_lists(directory, titles, options):
    """Returns the pages whose lists are contents, and whether these lists are navigation."""
    if options.lists:
        return options.lists, False
    first = options.root_link if options.root_link in titles else next(iter(titles))
    generator = find_generator(directory, read_file(os.path.join(directory, first)))
    if not generator:
        return [], False
    lists = [next((path for path in alternatives if path in titles), None) for alternatives in generator.lists]
    return list(filter(None, lists)), generator.is_list_in_navigation


def list_rows(directory, titles, options):
    """Returns the rows of each list that there is, or those of the directories if there is none."""
    lists, is_navigation_read = choose_lists(directory, titles, options)
    found = []
    for path in lists:
        if path not in titles:
            warn(f"{directory}: there is no page {path}")
            continue
        items = ListReader(is_navigation_read).read(read_file(os.path.join(directory, path)))
        rows = list_links(items, path, titles, directory)
        if any(row.link != "null" for row in rows):
            found.append(rows)
        elif path in options.lists:
            warn(f"{directory}/{path}: its lists lead to no page of the set")
    if options.lists and not found:
        warn(f"{directory}: the contents are made from the directories")
    return found or [list_directories(titles, options.root_link)]


def make_module_entry(directory, titles, options):
    """Returns the entry of the module: its start page with that page's title, unless it is generic."""
    name = os.path.basename(os.path.dirname(directory))
    start = options.root_link
    if start not in titles:
        warn(f"{directory}: there is no page {start}, where the root of the contents leads")
    title = options.title or titles.get(start, "")
    return {"link": start if start in titles else "null",
            "title": make_title(name if is_generic(title) else title, directory)}


def make_docdata(directory, options):
    """Returns the values of both files, or None if there are no pages."""
    pages = read_pages(directory, list_paths(directory, options.excluded), options.jobs)
    if not pages:
        return None
    titles = choose_titles(pages, options.root_link, directory)
    root = {"link": options.root_link, "title": make_title(options.root_title or os.path.basename(directory), directory)}
    module = make_module_entry(directory, titles, options)
    contents = make_contents(root, module, list_rows(directory, titles, options), options.shared_groups)
    index = make_index(pages, titles, lambda path: GENERATED.fullmatch(path))
    say(f"{directory}: {len(pages)} pages, {len(index['pages']) - len(pages)} places, {len(index['info'])} texts, "
        f"{len(index['searchIndex'])} terms")
    return {"index.json": write_index(index), "toc.json": write_contents(contents)}


encode = json.JSONEncoder(ensure_ascii=False).encode


def write_index(index):
    """Returns the text of index.json, with a line for each entry."""
    rows = {name: ",\n".join(map(encode, index[name])) for name in ("pages", "info")}
    terms = ",\n".join(f"{encode(term)}: {numbers}" for term, numbers in index["searchIndex"].items())
    return (f'{{"pages": [\n{rows["pages"]}\n],\n"info": [\n{rows["info"]}\n],\n"common": {encode(index["common"])},\n'
            f'"searchIndex": {{\n{terms}\n}}}}\n')


def write_contents(contents):
    return json.dumps(contents, ensure_ascii=False, indent=1) + "\n"
