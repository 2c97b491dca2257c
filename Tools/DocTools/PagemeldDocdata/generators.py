"""What is peculiar to the programs that make HTML: how they mark what is read, and what is not; nothing else of this
program knows one of them."""
import os
import re
from typing import NamedTuple

from markup import read_attributes

# What an element is to the reader of a page. SKIP: no text of the page. LISTING: code, of which the first line counts.
# NAME: the name in the heading of a member. MEMBER: a heading if there was an anchor since the last one. TEXT: a
# paragraph. UNUSED: anchors count, text does not. Anything else is the level of a heading.
SKIP, LISTING, NAME, MEMBER, TEXT, UNUSED = "skip", "listing", "name", "member", "text", "unused"
PARTS = {
    # Doxygen. Members without a section of their own are only in the table rows of a class: the row has the anchor.
    ("span", "permalink"): SKIP, ("span", "overload"): SKIP, ("span", "arrow"): SKIP, ("span", "icon"): SKIP,
    ("ul", "tablist"): SKIP, ("div", "navpath"): SKIP, ("tr", "inherit"): SKIP, ("address", "footer"): SKIP,
    ("div", "ingroups"): SKIP, ("div", "memtemplate"): SKIP, ("td", "memItemLeft"): UNUSED,
    ("td", "memTemplParams"): UNUSED, ("td", "memTemplItemLeft"): UNUSED, ("div", "fragment"): LISTING,
    ("div", "title"): "h1", ("div", "textblock"): TEXT, ("td", "mdescRight"): TEXT, ("td", "fieldname"): "h6",
    ("td", "memItemRight"): MEMBER, ("td", "memTemplItemRight"): MEMBER, ("td", "inherit_header"): MEMBER,
    # Sphinx
    ("a", "headerlink"): SKIP, ("span", "viewcode-link"): SKIP, ("div", "sphinxsidebar"): SKIP, ("dt", "sig"): "h6",
    ("span", "descname"): NAME, ("span", "descclassname"): NAME, ("code", "descname"): NAME,
    ("code", "descclassname"): NAME,
    # javadoc: its tables of members repeat the first sentences of what follows
    ("div", "block"): TEXT, ("table", "memberSummary"): SKIP, ("section", "method-summary"): SKIP,
    ("section", "field-summary"): SKIP, ("section", "constructor-summary"): SKIP, ("div", "inherited-list"): SKIP,
    ("ul", "horizontal"): SKIP,
    # DocBook and gtk-doc
    ("div", "navheader"): SKIP, ("div", "navfooter"): SKIP, ("table", "navigation"): SKIP,
    # rustdoc
    ("a", "src"): SKIP, ("a", "srclink"): SKIP, ("span", "out-of-band"): SKIP, ("a", "anchor"): SKIP,
    ("a", "doc-anchor"): SKIP, ("a", "fn"): NAME, ("a", "fnname"): NAME, ("a", "method"): NAME,
    # texinfo
    ("a", "copiable-link"): SKIP, ("a", "copiable-anchor"): SKIP, ("div", "nav-panel"): SKIP,
    ("strong", "def-name"): NAME,
}
SKIPPED_TAGS = {"nav", "noscript", "template", "button", "select", "footer"}
SKIPPED_ROLES = {"navigation", "search", "contentinfo", "banner"}

# Pages that only list what other pages have: of these, title and headings are searched.
GENERATED = re.compile("|".join((
    # Doxygen
    r".*_source\.html", r".*-members\.html", r".*(^|/)(functions|globals|namespacemembers)(_\w+)?\.html",
    r".*(^|/)(classes|hierarchy|inherits|graph_legend|doxygen_crawl)\.html", r".*(^|/)dir_[0-9a-f]{32}\.html",
    # Sphinx
    r".*(^|/)(genindex(-\w+)?|\w+-modindex|search)\.html", r"(.*/)?_modules/.*",
    # javadoc
    r"(.*/)?(class-use|src-html|index-files)/.*", r".*(^|/)(package|overview)-(use|tree|frame)\.html",
    r".*(^|/)(index-all|index-\d+|all(classes|packages)(-index|-frame|-noframe)?)\.html",
    # DocBook and gtk-doc
    r".*(^|/)(api-index-[\w.-]+|ix\d+)\.html",
    # mdBook, rustdoc, texinfo
    r".*(^|/)(print|toc|all)\.html", r"src/.*\.rs\.html", r".*(^|/)[A-Z][a-z]+-Index\.html")))
DIRECTORY_PAGES = ("index.html", "index.htm", "package-summary.html")


class Generator(NamedTuple):
    """How a generator is recognised, by its <meta name="generator"> or by a file in the set directory, and which of its
    pages list the others: of each tuple the first that there is."""
    name: str
    meta: str
    files: tuple
    lists: tuple
    is_list_in_navigation: bool = False


GENERATORS = (
    Generator("Doxygen", "doxygen", ("doxygen.css",),
              (("pages.html",), ("topics.html", "modules.html"), ("annotated.html",))),
    Generator("javadoc", "javadoc", ("element-list", "package-list"), (("overview-tree.html", "package-tree.html"),)),
    Generator("rustdoc", "rustdoc", (), ()),  # a directory for each of its modules
    Generator("mdBook", "mdbook", ("book.js",), (("toc.html", "index.html"),), True),
    Generator("MkDocs", "mkdocs", ("mkdocs", "search/search_index.json"), (("index.html",),), True),
    Generator("texinfo", "makeinfo|texi2any|texinfo", (), (("index.html",),)),
    Generator("DocBook", "docbook|gtk-doc", (), (("index.html",),)),
    Generator("Sphinx", "sphinx", ("objects.inv", "searchindex.js"), (("contents.html", "index.html"),)),
)
META = re.compile(r"<meta(\s[^<>]*)", re.I)


def read_meta(html):
    """Returns what the <meta name="generator"> of a page says, "" if there is none."""
    for attributes in map(read_attributes, META.findall(html)):
        if attributes.get("name", "").lower() == "generator":
            return attributes.get("content", "")
    return ""


def find_generator(directory, start_html):
    """Returns the generator of the pages in directory, whose start page is given; None if it isn't in the table."""
    meta = read_meta(start_html)
    for generator in GENERATORS:
        if re.search(generator.meta, meta, re.I):
            return generator
    for generator in GENERATORS:
        if any(os.path.exists(os.path.join(directory, file)) for file in generator.files):
            return generator
    return None
