"""Finds the titles of pages: what a <title> says without what most titles of a set have in common."""
import collections
import re

from messages import warn

# Where a frame such as " \u2014 Project 1.0 documentation" or "Project: " may be cut off.
TAIL = re.compile(r"\s+[-\u2013\u2014|\u00b7]\s|\s\(|:\s")
HEAD = re.compile(r"\s[-\u2013\u2014|\u00b7]\s+|:\s+")
# The scripts escape only the quotes of titles.
LOOK_ALIKES = {ord("\\"): "\u2216", 0x7F: "\u2421", **{code: 0x2400 + code for code in range(0x20)}}
# Titles of start pages that have only such words and numbers don't say of which module they are.
GENERIC = set(
    "a an and api class contents documentation for guide hierarchy home index introduction list main manual of "
    "overview package packages page pages project read readme redirect redirecting redirection reference search "
    "start table the title to top tree user version welcome".split())


def replace_unwritable(text):
    """Returns text with letters that look like those that would break the scripts."""
    return text.translate(LOOK_ALIKES)


def make_title(text, place):
    """Returns text as a title, and warns if it had to be changed."""
    title = replace_unwritable(text)
    if title != text:
        warn(f'{place}: what would break the scripts is replaced in the title "{title}"')
    return title


def find_shared(titles, cut):
    """Returns the longest of the pieces that cut(title) returns that more than half of the titles have, or ""."""
    uses = collections.Counter(piece for title in titles for piece in cut(title))
    shared = [piece for piece, count in uses.items() if count > 1 and 2 * count > len(titles)]
    return max(shared, key=lambda piece: (len(piece), piece), default="")


def find_frame(titles):
    """Returns what most titles have before and after their subject, such as "Project: " and " (1.0)"."""
    titles = set(titles)
    tail = find_shared(titles, lambda title: {title[match.start():] for match in TAIL.finditer(title)})
    titles = {title.removesuffix(tail) for title in titles}
    head = find_shared(titles, lambda title: {title[:match.end()] for match in HEAD.finditer(title)})
    return head, tail


def is_generic(title):
    words = re.findall(r"\w+", title.lower())
    return all(word in GENERIC or not word.isalpha() for word in words)


def choose_titles(pages, start, directory):
    """Returns the title of each page: its <title> without the frame, or the main heading if there is none, if several
    pages have that title, or if the start page's is generic, such as "Main Page"; or else the path."""
    head, tail = find_frame(page.title for page in pages.values() if page.title)
    subjects = {path: page.title.removesuffix(tail).removeprefix(head).strip() for path, page in pages.items()}
    uses = collections.Counter(subjects.values())
    titles = {}
    for path, page in pages.items():
        subject = subjects[path] or page.title
        if page.heading and (uses[subject] > 1 or path == start and is_generic(subject)):
            subject = page.heading
        titles[path] = make_title(subject or page.heading or path, f"{directory}/{path}")
    return titles
