"""Takes HTML apart. One regular expression finds the tags as browsers do, also in broken pages, and passes over what is
no text; html.parser does the same with a Python call for every step, and takes five times as long."""
import re
from html import unescape

# A quote begins a value only after "=", and what is never closed reaches to the end: so the first try always matches,
# and time is linear without possessive groups, which Python 3.11.2 reads wrongly. Groups: the content of a listing; the
# name of a tag, with its "/", and its attributes.
TOKEN = re.compile(r"""
    <!--(?:-?>|.*?(?:--!?>|\Z)) | <!\[CDATA\[.*?(?:\]\]>|\Z) | <[!?][^>]*(?:>|\Z)
    | <(?:script|style|svg)\b(?![^>]*/>).*?(?:</(?:script|style|svg)\s*>|\Z)
    | <pre\b[^>]*>(.*?)(?:</pre\s*>|\Z)
    | <(/?[a-z][^\s/>]*)([^>=]*(?:=\s*(?:"[^"]*"|'[^']*')?[^>=]*)*)(?:>|\Z)""", re.X | re.S | re.I)
ATTRIBUTE = re.compile(r"""([^\s=/"'>]+)(?:\s*=\s*(?:"([^"]*)"|'([^']*)'|([^\s>]+)))?""")
TAG = re.compile("<[^>]*>")
ENCODING = re.compile(rb"""(?:charset|encoding)\s*=\s*["']?\s*([\w.:-]+)""")
# Byte order marks, and the "<" with which pages in UTF-16 without a mark begin.
FIRST_BYTES = {b"\xff\xfe": "utf-16-le", b"\xfe\xff": "utf-16-be", b"\xef\xbb": "utf-8",
               b"<\0": "utf-16-le", b"\0<": "utf-16-be"}


def find_encoding(data):
    """Returns the encoding of a page: that of its first two bytes, or UTF-8 if it is that, or the declared one."""
    encoding = FIRST_BYTES.get(data[:2])
    if encoding:
        return encoding
    try:
        data.decode()
        return "utf-8"
    except UnicodeDecodeError:
        return find_declared_encoding(data)


def find_declared_encoding(data):
    """Returns the encoding that a page declares, or else windows-1252."""
    declared = ENCODING.search(data[:4096])
    try:
        name = declared[1].decode() if declared else "cp1252"
        "".encode(name)
        return name
    except (LookupError, ValueError):  # no such encoding, or not one of texts
        return "cp1252"


def decode(data):
    """Returns the text of a page, without a byte order mark; bytes that mean nothing are replaced."""
    return data.decode(find_encoding(data), "replace").removeprefix("\ufeff")


def read_attributes(text):
    """Returns the attributes of a tag as a dictionary; names are in lower case."""
    values = {}
    for name, *quoted in ATTRIBUTE.findall(text):
        values.setdefault(name.lower(), unescape("".join(quoted)))
    return values


def squeeze(text):
    """Returns text without tags as it is shown: entities replaced, runs of white space as one space."""
    return " ".join((unescape(text) if "&" in text else text).split())


def first_line(listing):
    """Returns the first line of a listing, which may have tags, that is not empty."""
    lines = map(squeeze, TAG.sub("", listing[:2000]).splitlines())
    return next(filter(None, lines), "")
