"""Finds and reads the pages of a set, with all processors."""
import fnmatch
import multiprocessing
import os
import pickle
import zlib
from typing import NamedTuple

from generators import DIRECTORY_PAGES, GENERATED
from markup import decode
from messages import warn
from page import read_headings, read_page
from search_index import UNWRITABLE

PAGE_NAMES = (".html", ".htm", ".xhtml")
PAGES_AT_ONCE = 8


class PackedPage(NamedTuple):
    """A page whose sections are packed, since all pages of a set are in memory before the first is in the index."""
    title: str
    heading: str
    headings: tuple  # those of the sections, each once
    packed: bytes

    def unpack(self):
        return pickle.loads(zlib.decompress(self.packed))


def pack(page):
    headings = tuple({section.heading: None for section in page.sections})
    return PackedPage(page.title, page.heading, headings, zlib.compress(pickle.dumps(page.sections), 1))


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


def try_page(task):
    """Returns the page in a file, packed, or what is wrong with the file."""
    directory, path = task
    try:
        html = read_file(os.path.join(directory, path))
    except OSError as error:
        return str(error)
    return pack(read_headings(html) if GENERATED.fullmatch(path) else read_page(html))


def read_pages(directory, paths, jobs):
    """Returns the pages by path."""
    pages = {}
    with multiprocessing.Pool(min(jobs, len(paths) // PAGES_AT_ONCE + 1)) as pool:
        tasks = [(directory, path) for path in paths]
        for path, page in zip(paths, pool.imap(try_page, tasks, PAGES_AT_ONCE)):
            if isinstance(page, str):
                warn(f"{os.path.join(directory, path)}: left out: {page}")
            else:
                pages[path] = page
    return pages
