"""Puts the tag of the page script into pages, and the script beside the outputs."""
import glob
import os
import re
import shutil

from markup import TOKEN, find_encoding

HERE = os.path.dirname(os.path.realpath(__file__))
# Where the program is installed, and in the sources.
WEB_DIRECTORIES = (os.path.join(HERE, "..", "web"), os.path.join(HERE, "..", "..", "..", "web"))
TAG = re.compile(r"""<script\b[^>]*\bsrc\s*=\s*["']?[^"'>]*\bdocdata/pagemeld\.js\b[^>]*>\s*</script\s*>""", re.I)
XHTML = re.compile(r"""\s*<\?xml\b|<html\b[^>]*\bxmlns\s*=""", re.I)


def make_tag(path, encoding):
    """Returns the tag for the page at path. It is sound in HTML and in XHTML; without charset a page in UTF-16 would have
    the script read as UTF-16."""
    charset = ' charset="utf-8"' if encoding.startswith("utf-16") else ""
    return f'<script src="{"../" * path.count("/")}docdata/pagemeld.js"{charset} defer="defer"></script>'


def find_end(text, names):
    """Returns where the end tag of the body begins, or else that of the page, or else the end of the text; None if the
    page can't have a tag, because it is a frame set, or XHTML without an end tag of the body."""
    if "frameset" in names:
        return None
    if "/body" in names:
        return names["/body"]
    return None if XHTML.search(text[:2000]) else names.get("/html", len(text))


def put_tag(text, tag):
    """Returns text with the tag before the end of its body, and without change if it has one or can't have it."""
    names = {}
    for token in TOKEN.finditer(text):
        if TAG.fullmatch(token[0]):
            return text
        names[(token[2] or "").lower()] = token.start()
    end = find_end(text, names)
    return text if end is None else text[:end] + tag + text[end:]


def take_tags(text):
    """Returns text without tags of the page script."""
    return TOKEN.sub(lambda token: "" if TAG.fullmatch(token[0]) else token[0], text)


def change_page(data, change):
    """Returns the bytes of a page after change(text, encoding). What is not changed keeps its bytes: of text in other
    encodings than UTF-16 only the ASCII letters have a meaning here."""
    encoding = find_encoding(data)
    is_wide = encoding.startswith("utf-16")
    codec, errors = (encoding, "surrogatepass") if is_wide else ("latin-1", "strict")
    even = data[:len(data) // 2 * 2] if is_wide else data
    return change(even.decode(codec, errors), encoding).encode(codec, errors) + data[len(even):]


def write_page(file, data):
    """Writes a page by a temporary file, so that it is there whole or as it was. A link stays a link."""
    file = os.path.realpath(file)
    with open(file + ".tmp", "wb") as stream:
        stream.write(data)
    shutil.copymode(file, file + ".tmp")
    os.replace(file + ".tmp", file)


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


def list_web_files():
    directory = next(filter(os.path.isdir, WEB_DIRECTORIES))
    return [file for kind in ("*.js", "*.css") for file in sorted(glob.glob(os.path.join(glob.escape(directory), kind)))]


def copy_script(docdata):
    """Copies the page script into the directory docdata."""
    for file in list_web_files():
        copy = os.path.join(docdata, os.path.basename(file))
        shutil.copyfile(file, copy + ".tmp")
        os.replace(copy + ".tmp", copy)


def remove_script(docdata):
    for file in list_web_files():
        copy = os.path.join(docdata, os.path.basename(file))
        if os.path.exists(copy):
            os.remove(copy)
