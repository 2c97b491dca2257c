"""Makes the docdata of one set directory."""
import os
from typing import NamedTuple

from contents import list_directories, list_links, make_contents
from docdata_files import copy_script, remove_script, write_inputs
from generators import find_generator
from list_reader import ListReader
from messages import say, warn
from page_files import Task, list_paths, read_file, read_pages
from page_script import remove_from_page
from search_index import make_index
from titles import choose_titles, is_generic, make_title


class SetOptions(NamedTuple):
    """What the command line says of the sets."""
    root_link: str
    root_title: str  # "" for the name of the set directory
    title: str  # "" for that of the start page
    lists: list
    shared_groups: list
    excluded: list
    adds_script: bool
    jobs: int


def choose_lists(directory, titles, options):
    """Returns the pages whose lists are contents, and whether these lists are navigation."""
    if options.lists:
        for path in options.lists:
            if path not in titles:
                warn(f"{directory}: there is no page {path}")
        return [path for path in options.lists if path in titles], False
    first = options.root_link if options.root_link in titles else next(iter(titles))
    generator = find_generator(directory, read_file(os.path.join(directory, first)))
    if not generator:
        return [], False
    lists = [next((path for path in alternatives if path in titles), None) for alternatives in generator.lists]
    return list(filter(None, lists)), generator.is_list_in_navigation


def list_rows(directory, titles, options):
    """Returns the rows of each page with lists that lead somewhere, or those of the directories if there is none."""
    lists, is_navigation_read = choose_lists(directory, titles, options)
    found = []
    for path in lists:
        items = ListReader(is_navigation_read).read(read_file(os.path.join(directory, path)))
        rows = list_links(items, path, titles, directory)
        if any(row.link != "null" for row in rows):
            found.append(rows)
        elif options.lists:
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


def make_set_contents(directory, titles, options):
    """Returns the value of toc.json. All modules need the same root."""
    title = options.root_title or os.path.basename(directory)
    root = {"link": options.root_link, "title": make_title(title, directory)}
    module = make_module_entry(directory, titles, options)
    return make_contents(root, module, list_rows(directory, titles, options), options.shared_groups)


def read_set(directory, paths, options):
    """Returns the pages by path without those that only lead to another page, but with the start page, where the root
    of the contents leads; and the number of those that were left out."""
    pages = read_pages([Task(directory, path, options.adds_script) for path in paths], options.jobs)
    kept = {path: page for path, page in pages.items() if not page.is_redirect or path == options.root_link}
    return kept, len(pages) - len(kept)


def make_docdata(directory, options):
    """Writes both files of a set directory, and what the page script needs if the options say so. Returns whether the
    directory has pages."""
    pages, redirect_count = read_set(directory, list_paths(directory, options.excluded), options)
    if not pages:
        return False
    titles = choose_titles(pages, options.root_link, directory)
    contents = make_set_contents(directory, titles, options)
    index = make_index(pages, titles)
    docdata = os.path.join(directory, "docdata")
    write_inputs(docdata, index, contents)
    if options.adds_script:
        copy_script(docdata)
    say(f"{directory}: {len(titles)} pages, {len(index.entries) - len(titles)} places, {len(index.texts)} texts, "
        f"{index.term_count} terms" + (f"; {redirect_count} redirects left out" if redirect_count else ""))
    return True


def remove_page_script(directory, options):
    """Takes the tag of the page script out of the pages of a set directory, and the script out of its docdata. Returns
    whether the directory has pages."""
    paths = list_paths(directory, options.excluded)
    for path in paths:
        remove_from_page(directory, path)
    remove_script(os.path.join(directory, "docdata"))
    say(f"{directory}: {len(paths)} pages without the page script")
    return bool(paths)
