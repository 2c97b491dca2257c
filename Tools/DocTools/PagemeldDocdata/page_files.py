"""Finds and reads the pages of a set, with all processors."""
import fnmatch
import multiprocessing
import os
import pickle
import zlib
from typing import NamedTuple

from generators import DIRECTORY_PAGES, GENERATED
from markup import decode
from messages import Progress, warn
from page import read_headings, read_page
from page_script import add_to_page
from search_index import UNWRITABLE

PAGE_NAMES = (".html", ".htm", ".xhtml")
PAGES_AT_ONCE = 8


class PackedPage(NamedTuple):
    """A page whose sections are packed, since all pages of a set are in memory before the first is in the index."""
    title: str
    heading: str
    headings: tuple  # those of the sections, each once
    packed: bytes
    is_redirect: bool

    def unpack(self):
        return pickle.loads(zlib.decompress(self.packed))


def pack(page):
    headings = tuple({section.heading: None for section in page.sections})
    return PackedPage(page.title, page.heading, headings, zlib.compress(pickle.dumps(page.sections), 1),
                      page.is_redirect)


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


class Task(NamedTuple):
    """What is done with a page."""
    directory: str
    path: str
    adds_script: bool


def try_page(task):
    """Returns the page in a file, packed, or what is wrong with the file. Puts the tag of the page script into the file
    if the task says so."""
    try:
        with open(os.path.join(task.directory, task.path), "rb") as stream:
            data = stream.read()
        if task.adds_script:
            data = add_to_page(task.directory, task.path, data)
    except OSError as error:
        return str(error)
    html = decode(data)
    return pack(read_headings(html) if GENERATED.fullmatch(task.path) else read_page(html))


def try_pages(tasks, jobs):
    """Yields the results of try_page in the order of the tasks, whatever the number of processes."""
    processes = min(jobs, len(tasks) // PAGES_AT_ONCE)
    if processes < 2:
        yield from map(try_page, tasks)
        return
    with multiprocessing.Pool(processes) as pool:
        yield from pool.imap(try_page, tasks, PAGES_AT_ONCE)


def read_pages(tasks, jobs):
    """Returns the pages by path, without those that can't be read."""
    pages, failures = {}, []
    progress = Progress(len(tasks))
    for task, page in zip(tasks, try_pages(tasks, jobs)):
        progress.advance(task.directory)
        if isinstance(page, str):
            failures.append(f"{task.directory}/{task.path}: left out: {page}")
        else:
            pages[task.path] = page
    progress.clear()
    for failure in failures:
        warn(failure)
    return pages
