"""Makes documentation modules to measure with: the same bytes on every machine and in every run.

A corpus is a folder of module roots m000, m001, ... Words follow Zipf's law, so that a few terms are found on
many pages and most on a few. The modules share part of their vocabulary, the groups of their tables of contents
and some of the entries; the rest is each module's own. All randomness comes from random.Random(seed).random(),
whose sequence the language guarantees.

No term is a number: an object of JavaScript would put it in front of the others, and the Node alternative could
not keep the order of terms.
"""

import hashlib
import json
import random
import shutil
import subprocess
import sys
from dataclasses import dataclass
from pathlib import Path

SETS = ("Manual", "ScriptReference")

COMMON_WORDS = 40  # the first words of the vocabulary: too common to be searched for
SHARED_WORDS = 20_000
OWN_WORDS = 6_000  # of each module
INFOS_PER_PAGE = 2
WORDS_PER_INFO = 16
GROUPS = 12  # on the first level, each with as many on the second
OWN_WORD_SHARE = 0.15
FLAT_SHARE = 0.5  # of the pages stand in the flat group
SHARED_PAGE_SHARE = 0.1  # of the pages there stand in every module's


@dataclass(frozen=True)
class Shape:
    """Modules of realistic content: how many, and how many pages each has in each set."""

    modules: int
    manual_pages: int
    reference_pages: int
    has_contents: bool = True  # otherwise the tables of contents are empty

    def write(self, folder):
        for module in range(self.modules):
            for set_name, pages in zip(SETS, (self.manual_pages, self.reference_pages)):
                index, toc = module_documents(module, set_name, pages)
                write_documents(folder, module, index, toc if self.has_contents else EMPTY_TOC, [set_name])


@dataclass(frozen=True)
class TermSeries:
    """Two modules that share all their terms, with a small table of contents."""

    terms: int

    def write(self, folder):
        infos = 1_000
        for module in range(2):
            rng = random.Random(f"terms {module}")
            index = {
                "pages": [[f"page{i}.html", f"Page {i}"] for i in range(infos)],
                "info": [[f"Text of page {i}", i] for i in range(infos)],
                "common": {},
                "searchIndex": {
                    word(i): [int(rng.random() * infos) for _ in range(1 + i % 3)] for i in range(self.terms)
                },
            }
            write_documents(folder, module, index, EMPTY_TOC)


@dataclass(frozen=True)
class SiblingSeries:
    """Two modules with one flat group: half of the second's entries are the first's too."""

    siblings: int

    def write(self, folder):
        index = {"pages": [["p.html", "P"]], "info": [["Text", 0]], "common": {}, "searchIndex": {"term": [0]}}
        for module in range(2):
            first = module * self.siblings // 2
            entries = [node(f"{word(i)}.html", word(i), None) for i in range(first, first + self.siblings)]
            write_documents(folder, module, index, node("toc", "toc", [node("null", "All", entries)]))


EMPTY_TOC = {"link": "toc", "title": "toc", "children": None}

SHAPES = {
    "small": Shape(3, 200, 400),
    "medium": Shape(10, 2_000, 4_000),
    "large": Shape(30, 3_300, 6_600),
    "medium-index": Shape(10, 2_000, 4_000, has_contents=False),
    **{f"terms-{n}": TermSeries(n) for n in (50_000, 100_000, 200_000, 400_000, 800_000)},
    **{f"siblings-{n}": SiblingSeries(n) for n in (5_000, 10_000, 20_000, 40_000, 80_000, 160_000)},
}


def make(name, folder):
    """Returns the folder of the corpus of that name below folder; makes it unless it is there already."""
    corpus = Path(folder) / name
    complete = corpus / "complete"  # empty, or the digest of the generator that made all of it
    generator = hashlib.sha256(Path(__file__).read_bytes()).hexdigest()
    if corpus.exists() and not complete.exists():
        raise SystemExit(f"{corpus} was not made here, or is incomplete: remove it")
    if not corpus.exists() or complete.read_text(encoding="utf-8") != generator:
        shutil.rmtree(corpus, ignore_errors=True)
        corpus.mkdir(parents=True)
        complete.touch()
        # In a process of its own: a child that is measured begins with the peak memory of its parent.
        subprocess.run([sys.executable, __file__, name, str(corpus)], check=True)
        complete.write_text(generator, encoding="utf-8")
    return corpus


SYLLABLES = [c + v for c in ("b", "c", "d", "f", "g", "l", "m", "n", "p", "r", "s", "t", "v") for v in "aeiou"]


def word(number):
    """Returns the word of that number: no two are the same, the first ones are short."""
    syllables = []
    number += len(SYLLABLES)
    while number >= 0:
        syllables.append(SYLLABLES[number % len(SYLLABLES)])
        number = number // len(SYLLABLES) - 1
    return "".join(reversed(syllables))


class Vocabulary:
    """The words of one module: shared ones and its own, both drawn by Zipf's law."""

    def __init__(self, module):
        self._shared = [word(i) for i in range(SHARED_WORDS)]
        first_own = SHARED_WORDS + module * OWN_WORDS
        self._own = [word(i) for i in range(first_own, first_own + OWN_WORDS)]

    @property
    def common(self):
        return self._shared[:COMMON_WORDS]

    def draw(self, rng):
        words = self._own if rng.random() < OWN_WORD_SHARE else self._shared
        # The logarithm of a Zipf-distributed rank is evenly distributed.
        return words[int(len(words) ** rng.random()) - 1]


def module_documents(module, set_name, page_count):
    """Returns the search index and the table of contents of one module in one set."""
    rng = random.Random(f"{set_name} {module}")
    vocabulary = Vocabulary(module)
    titles = [page_title(vocabulary, rng, i) for i in range(page_count)]
    links = [f"{title.split()[0]}-{module}-{i}.html" for i, title in enumerate(titles)]
    return search_index(vocabulary, rng, titles, links), table_of_contents(rng, titles, links)


def page_title(vocabulary, rng, number):
    title = " ".join(vocabulary.draw(rng).capitalize() for _ in range(2))
    if number % 50 == 0:
        return title + ' ("r\u00e9sum\u00e9")'
    return title


def search_index(vocabulary, rng, titles, links):
    info = []
    terms = {}
    common = set(vocabulary.common)
    for page in range(len(titles)):
        for _ in range(INFOS_PER_PAGE):
            words = [vocabulary.draw(rng) for _ in range(WORDS_PER_INFO)]
            for term in dict.fromkeys(words):
                if term not in common:
                    terms.setdefault(term, []).append(len(info))
            info.append([" ".join(words).capitalize() + ".", page])
    return {
        "pages": [list(page) for page in zip(links, titles)],
        "info": info,
        "common": dict.fromkeys(vocabulary.common, 1),
        "searchIndex": terms,
    }


def table_of_contents(rng, titles, links):
    """A tree of groups that all modules share, two deep, and one flat group of thousands of entries."""
    groups = [[[] for _ in range(GROUPS)] for _ in range(GROUPS)]
    flat = []
    for number, (title, link) in enumerate(zip(titles, links)):
        if rng.random() < FLAT_SHARE:
            is_shared = rng.random() < SHARED_PAGE_SHARE
            name = word(number) if is_shared else title
            flat.append(node(f"{name}.html" if is_shared else link, name, None))
        else:
            groups[int(GROUPS * rng.random())][int(GROUPS * rng.random())].append(node(link, title, None))
    children = [
        node("null", f"Group {i}", [node("null", f"Topic {i}.{j}", pages) for j, pages in enumerate(topics) if pages])
        for i, topics in enumerate(groups)
    ]
    return node("toc", "toc", children + [node("null", "All classes", flat)])


def node(link, title, children):
    return {"link": link, "title": title, "children": children}


def write_documents(folder, module, index, toc, sets=SETS):
    """Writes both documents of one module, a line for each member of the index, as documentation builds do."""
    lines = ",\n".join(f'"{name}": {json.dumps(value, ensure_ascii=False)}' for name, value in index.items())
    for set_name in sets:
        docdata = Path(folder) / f"m{module:03}" / set_name / "docdata"
        docdata.mkdir(parents=True, exist_ok=True)
        (docdata / "index.json").write_text("{" + lines + "}\n", encoding="utf-8")
        (docdata / "toc.json").write_text(json.dumps(toc, ensure_ascii=False), encoding="utf-8")


if __name__ == "__main__":
    SHAPES[sys.argv[1]].write(sys.argv[2])
