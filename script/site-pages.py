#!/usr/bin/env python3
"""Makes the pages of our guides and manual pages: site-pages.py BUILD SITE

The manual pages and the README to install are taken from the build directory BUILD. Each module of SITE gets the set
directory Manual. Ends with an error if a page links to a heading that is not there, or to a file that is neither in the
site nor a picture.
"""
import html
import os
import re
import shutil
import subprocess
import sys
from pathlib import Path

# What becomes a page of each module. The first is its start page.
SOURCES = {
    "pagemeld": ["README.md", "docs/INTEGRATION.md", "docs/READER.md", "docs/FORMATS.md", "docs/MESSAGES.md",
                 "docs/ROBUSTNESS.md", "SECURITY.md", "docs/PERFORMANCE.md", "docs/ARCHITECTURE.md", "CONTRIBUTING.md",
                 "docs/RELEASING.md", "CHANGELOG.md", "man/pagemeld.1", "man/pagemeld-docdata.1",
                 "man/pagemeld.5"],
    "checker": ["docs/CHECKING.md", "docs/RULES.md", "man/pagemeld-check.1"],
    "runtime": ["docs/SELF-TESTS.md"],
}
PAGE = """<!DOCTYPE html>
<html lang="en">
<head>
<meta charset="utf-8">
<meta name="viewport" content="width=device-width, initial-scale=1">
<title>{title}</title>
<link rel="stylesheet" href="site.css">
</head>
<body>
<main>
{content}</main>
</body>
</html>
"""


def place_pages():
    """Returns the page of each source, relative to the site: README.md is pagemeld/Manual/index.html."""
    return {source: f"{module}/Manual/{Path(source).name.removesuffix('.md') if number else 'index'}.html"
            for module, sources in SOURCES.items() for number, source in enumerate(sources)}


def run(*command):
    return subprocess.run(command, check=True, stdout=subprocess.PIPE, encoding="utf-8").stdout


def text_of(markup):
    return html.unescape(re.sub("<[^>]*>", "", markup))


def add_anchor(heading):
    """Gives a heading the anchor that code hosts give it, which links between guides rely on."""
    level, markup = heading.groups()
    anchor = re.sub(r"[^\w\- ]", "", text_of(markup).lower()).replace(" ", "-")
    return f'<h{level} id="{anchor}">{markup}</h{level}>'


def convert_guide(source, file):
    content = re.sub("<h([1-6])>(.*?)</h[1-6]>", add_anchor, run("cmark-gfm", "--extension", "table", file))
    manual_pages = os.path.relpath("man", Path(source).parent)
    return re.sub(r"(<code>(pagemeld[\w-]*)\((\d)\)</code>)", rf'<a href="{manual_pages}/\2.\3">\1</a>', content)


def convert_manual_page(source, build):
    name, section = Path(source).stem, Path(source).suffix[1:]
    content = run("mandoc", "-Thtml", "-O", "fragment,man=%N.%S", build / f"man/man{section}/{name}.{section}")
    _, _, body = content.partition("</table>\n")  # a table with the name comes first, one with the date last
    body, _, _ = body.rpartition('<table class="foot">')
    # Emphasised words and members of files have anchors too, as options do. They would be places for the search.
    for anchor in re.findall('<a class="permalink" href="#([^"]*)"><i ', body):
        body = body.replace(f' id="{anchor}"', "").replace(f' href="#{anchor}"', "")
    body = re.sub('<dt id="[^"]*"><var ', "<dt><var ", body)
    sections = re.sub("<(/?)h1", r"<\1h2", body)
    return f"<h1>{name}({section})</h1>\n{sections}"


def convert(source, build):
    if source.endswith(".md"):
        return convert_guide(source, build / source if source == "README.md" else source)
    return convert_manual_page(source, build)


def mend_links(contents, source, pages, site):
    """Returns the content of a page with links to the pages of other sources, and puts its pictures beside it."""
    directory = Path(pages[source]).parent

    def mend(link):
        attribute, address, fragment = link.groups("")
        target = os.path.normpath(Path(source).parent / address) if address else source
        if target in pages and (not fragment or f'id="{fragment}"' in contents[target]):
            path = os.path.relpath(pages[target], directory) if address else ""
            return f'{attribute}="{path}{fragment and "#" + fragment}"'
        if fragment or Path(target).suffix not in (".png", ".svg"):
            sys.exit(f"{source}: links to {address}#{fragment}, which is not in the site")
        shutil.copy(target, site / directory)
        return f'{attribute}="{Path(target).name}"'
    return re.sub('(href|src)="(?!https?:)([^"#]*)(?:#([^"]*))?"', mend, contents[source])


def write_page(file, content):
    title = text_of(re.search("<h1.*?>(.*?)</h1>", content)[1])
    file.write_text(PAGE.format(title=html.escape(title), content=content), encoding="utf-8")


def main():
    build, site = map(Path, sys.argv[1:])
    for module in SOURCES:
        (site / module / "Manual").mkdir(parents=True)
        shutil.copy("docs/site.css", site / module / "Manual")
    pages = place_pages()
    contents = {source: convert(source, build) for source in pages}
    for source, page in pages.items():
        write_page(site / page, mend_links(contents, source, pages, site))


main()
