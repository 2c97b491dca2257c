"""Makes documentation modules to measure with: the same bytes on every machine and in every run.

A corpus is a directory of module roots m000, m001, ... All randomness comes from random.Random(seed).random(),
whose sequence the language guarantees.

No term is a number: a JavaScript object would put it before the others, and the Node alternative could not keep the
order of terms.
"""

import json
import random

SETS = ("Manual", "ScriptReference")
TERMS = (50_000, 100_000, 200_000, 400_000, 800_000)
SIBLINGS = (5_000, 10_000, 20_000, 40_000, 80_000, 160_000)

COMMON_WORDS = 40  # the first words of the vocabulary: too common to be searched for
SHARED_WORDS = 20_000
OWN_WORDS = 6_000  # of each module
OWN_WORD_SHARE = 0.15
INFOS_PER_PAGE = 2
WORDS_PER_INFO = 16
GROUPS = 12  # on the first level, each with as many on the second
FLAT_SHARE = 0.5  # of the pages are in the flat group
SHARED_PAGE_SHARE = 0.1  # of the pages there are in every module's


# The kinds of corpora: they yield module, documentation sets, search index and table of contents.


def realistic(modules, manual_pages, reference_pages):
    for module in range(modules):
        for set_name, page_count in zip(SETS, (manual_pages, reference_pages)):
            yield module, [set_name], *realistic_documents(module, set_name, page_count)


def many_terms(count):
    """Two modules that share all their terms."""
    for module in range(2):
        rng = random.Random(f"terms {module}")
        terms = {word(i): [int(rng.random() * 1_000) for _ in range(1 + i % 3)] for i in range(count)}
        yield module, SETS, search_index(1_000, terms), root(None)


def many_siblings(count):
    """Two modules with one flat group: half of the second's entries are the first's too."""
    for module in range(2):
        first = module * count // 2
        entries = [leaf(word(i)) for i in range(first, first + count)]
        yield module, SETS, search_index(1, {"term": [0]}), root([node("null", "All", entries)])


def deep_contents(depth):
    """Two modules that share all groups, each within the one before, and differ at the bottom."""
    for module in range(2):
        entry = leaf(f"bottom{module}")
        for level in range(depth):
            entry = node("null", f"Level {level}", [entry])
        yield module, SETS, search_index(1, {"term": [0]}), root([entry])


CORPORA = {
    "small": lambda: realistic(3, 200, 400),
    "medium": lambda: realistic(10, 2_000, 4_000),
    "large": lambda: realistic(30, 3_300, 6_600),
    "many-modules": lambda: realistic(300, 3, 3),
    "one-module": lambda: realistic(1, 200_000, 200_000),
    "deep": lambda: deep_contents(2_000),
    **{f"terms-{count}": lambda count=count: many_terms(count) for count in (*TERMS, 1_000_000)},
    **{f"siblings-{count}": lambda count=count: many_siblings(count) for count in (*SIBLINGS, 200_000)},
}


def make(name, directory):
    """Writes the corpus of that name into a directory that has no modules yet."""
    for module, set_names, index, toc in CORPORA[name]():
        # A line for each member, as documentation builds write it.
        members = ",\n".join(f'"{member}": {json.dumps(value, ensure_ascii=False)}' for member, value in index.items())
        for set_name in set_names:
            docdata = directory / f"m{module:03}" / set_name / "docdata"
            docdata.mkdir(parents=True)
            (docdata / "index.json").write_text("{" + members + "}\n", encoding="utf-8")
            (docdata / "toc.json").write_text(json.dumps(toc, ensure_ascii=False), encoding="utf-8")


SYLLABLES = [c + v for c in "bcdfglmnprstv" for v in "aeiou"]


def word(number):
    """Returns the word of that number: no two are the same, the first ones are short."""
    syllables = []
    number += len(SYLLABLES)
    while number >= 0:
        syllables.append(SYLLABLES[number % len(SYLLABLES)])
        number = number // len(SYLLABLES) - 1
    return "".join(reversed(syllables))


def realistic_documents(module, set_name, page_count):
    """Returns the search index and the table of contents of one module in one set."""
    rng = random.Random(f"{set_name} {module}")
    shared = [word(i) for i in range(SHARED_WORDS)]
    own = [word(SHARED_WORDS + module * OWN_WORDS + i) for i in range(OWN_WORDS)]

    def draw():
        """Returns a word by Zipf's law: the logarithm of its rank is evenly distributed."""
        words = own if rng.random() < OWN_WORD_SHARE else shared
        return words[int(len(words) ** rng.random()) - 1]

    titles = [page_title(draw, i) for i in range(page_count)]
    links = [f"{title.split()[0]}-{module}-{i}.html" for i, title in enumerate(titles)]
    common = dict.fromkeys(shared[:COMMON_WORDS], 1)
    return realistic_index(draw, common, titles, links), realistic_toc(rng, titles, links)


def page_title(draw, number):
    title = f"{draw().capitalize()} {draw().capitalize()}"
    return title + ' ("r\u00e9sum\u00e9")' if number % 50 == 0 else title


def realistic_index(draw, common, titles, links):
    info = []
    terms = {}
    for page in range(len(titles)):
        for _ in range(INFOS_PER_PAGE):
            words = [draw() for _ in range(WORDS_PER_INFO)]
            for term in dict.fromkeys(words):
                if term not in common:
                    terms.setdefault(term, []).append(len(info))
            info.append([" ".join(words).capitalize() + ".", page])
    return {"pages": [*zip(links, titles)], "info": info, "common": common, "searchIndex": terms}


def realistic_toc(rng, titles, links):
    """A tree of groups that all modules share, two deep, and one flat group of thousands of entries."""
    groups = [[[] for _ in range(GROUPS)] for _ in range(GROUPS)]
    flat = []
    for number, (title, link) in enumerate(zip(titles, links)):
        if rng.random() < FLAT_SHARE:
            flat.append(leaf(word(number)) if rng.random() < SHARED_PAGE_SHARE else node(link, title, None))
        else:
            groups[int(GROUPS * rng.random())][int(GROUPS * rng.random())].append(node(link, title, None))
    children = [
        node("null", f"Group {i}", [node("null", f"Topic {i}.{j}", pages) for j, pages in enumerate(topics) if pages])
        for i, topics in enumerate(groups)
    ]
    return root(children + [node("null", "All classes", flat)])


def search_index(page_count, terms):
    """Returns an index of plain pages with one text each."""
    pages = [[f"page{i}.html", f"Page {i}"] for i in range(page_count)]
    info = [[f"Text of page {i}", i] for i in range(page_count)]
    return {"pages": pages, "info": info, "common": {}, "searchIndex": terms}


def node(link, title, children):
    return {"link": link, "title": title, "children": children}


def leaf(name):
    return node(f"{name}.html", name, None)


def root(children):
    return node("toc", "toc", children)
