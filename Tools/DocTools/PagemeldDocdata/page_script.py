"""Puts the tag of the page script into pages, and takes it out."""
import os
import re
import shutil

from docdata_files import write_whole
from markup import find_encoding, read_attributes

EMPTY_SCRIPT = re.compile(r"<script\b([^>]*)>\s*</script\s*>", re.I)
ADDRESS = re.compile(r"\bdocdata/pagemeld\.js\b", re.I)
XHTML = re.compile(r"""\s*<\?xml\b|<html\b[^>]*\bxmlns\s*=""", re.I)
# What decides on the place of the tag. Comments and scripts are matched whole, so that nothing in them counts.
MARK = re.compile(r"""<!--.*?(?:-->|\Z) | <script\b.*?(?:</script\s*>|\Z)
                      | <(/body|/html|frameset|base(?=\s[^<>]*\bhref))\b""", re.S | re.I | re.X)


def make_tag(path, encoding):
    """Returns the tag for the page at path, sound in HTML and XHTML. Without charset, browsers would read the script of
    a page in UTF-16 as UTF-16."""
    charset = ' charset="utf-8"' if encoding.startswith("utf-16") else ""
    return f'<script src="{"../" * path.count("/")}docdata/pagemeld.js"{charset} defer="defer"></script>'


def find_place(text):
    """Returns where the tag goes: before a <base>, after which its address would mean another file; or else before the
    end tag of the body, or that of the page, or at the end. None if the page can't have a tag, because it is a frame
    set, or XHTML without an end tag of the body."""
    marks = {(mark[1] or "").lower(): mark.start() for mark in MARK.finditer(text)}
    if "frameset" in marks:
        return None
    if "base" in marks:
        return marks["base"]
    if "/body" in marks:
        return marks["/body"]
    return None if XHTML.search(text[:2000]) else marks.get("/html", len(text))


def is_tag(mark):
    """Returns whether a match of MARK is the tag, also one that somebody wrote by hand."""
    script = EMPTY_SCRIPT.fullmatch(mark[0])
    return bool(script and ADDRESS.search(read_attributes(script[1]).get("src", "")))


def has_tag(text):
    return "pagemeld.js" in text and any(map(is_tag, MARK.finditer(text)))


def put_tag(text, tag):
    """Returns text with the tag, and without change if it has one or can't have it, as in a script without an end."""
    place = None if has_tag(text) else find_place(text)
    changed = text if place is None else text[:place] + tag + text[place:]
    return changed if has_tag(changed) else text


def take_tags(text):
    """Returns text without tags of the page script."""
    return MARK.sub(lambda mark: "" if is_tag(mark) else mark[0], text)


def change_page(data, change):
    """Returns the bytes of a page after change(text, encoding). What is not changed keeps its bytes: of text in other
    encodings than UTF-16 only the ASCII letters have a meaning here."""
    encoding = find_encoding(data)
    is_wide = encoding.startswith("utf-16")
    codec, errors = (encoding, "surrogatepass") if is_wide else ("latin-1", "strict")
    even = data[:len(data) // 2 * 2] if is_wide else data
    return change(even.decode(codec, errors), encoding).encode(codec, errors) + data[len(even):]


def write_page(file, data):
    """Writes a page that keeps its mode. A link stays a link."""
    file = os.path.realpath(file)

    def write(temporary):
        with open(temporary, "wb") as stream:
            stream.write(data)
        shutil.copymode(file, temporary)
    write_whole(file, write)


def add_to_page(directory, path, data):
    """Puts the tag into the page that has data, unless it is there. Returns what the page has then."""
    changed = change_page(data, lambda text, encoding: put_tag(text, make_tag(path, encoding)))
    if changed != data:
        write_page(os.path.join(directory, path), changed)
    return changed


def remove_from_page(directory, path):
    """Takes the tag out of a page."""
    file = os.path.join(directory, path)
    with open(file, "rb") as stream:
        data = stream.read()
    changed = change_page(data, lambda text, _: take_tags(text))
    if changed != data:
        write_page(file, changed)
