"""Tests pagemeld-docdata by whole outputs: pagemeldDocdataTest.py PROGRAM"""
import json
import os
import subprocess
import sys
import tempfile
import unittest

PROGRAM = sys.argv.pop(1)
PAGES = {
    "index.html": """<title>Lib: Main Page (1.0)</title><h1>Site</h1><main><nav><h2>Here</h2></nav><h1>Start</h1>
        <p>The <b>first</b><br>paragraph. <a href="#details">More...</a><p>No other.
        <ul><li>Group<ul><li><a href="a%20b.html#caf%C3%A9">Café</a><li><a href="./Foo.html">Path</a></ul>
        <li><a href="sub/#&quot;">C:\\new</a><li><a href="ftp://x/">Away</a>
        <li><a href="gone.html">Gone</a><li><a href="gone.html#x">Gone</a></ul>""",
    "Foo.html": """<title>Lib: Same (1.0)</title><h1>By “heading”</h1><dt id=x>नमस्ते x_1</dt><dd><p>It.
        <dt class="py sig">y()<tr id="row_0_"><td><span class="arrow">v</span>ns</td>
        <tr id="row_0_0_"><td><a href="latin.htm">Class</a><tr id="row_1_"><td><a href="sub/">Again</a>""",
    "a b.html": b"<meta charset=koi8-r><p>\xcd\xc9\xd2",
    "latin.htm": b"<title>Lib: \xe9t\xe9 (1.0)</title>",
    "members.html": """<title>Lib: Gauge Class (1.0)</title><div class="title">Gauge Class</div>
        <tr><td class="memItemLeft"><a id="r"></a>void <td class="memItemRight"><b>read</b> (int n)</td></tr>
        <tr><td class="mdescRight">Reads.<br></td></tr>
        <tr><td class="memItemLeft"><a href="x">T</a> <td class="memItemRight"><a href="#s">link</a> ()
        <tr><td class="mdescRight">Has a heading. <a href="#s">More...</a></td></tr>
        <tr><td><h2><a id="all"></a>Gauge Class</h2></td></tr>
        <tr><td class="inherit_header">From Base</td></tr><tr><td class="mdescRight">An enum of Base.</td></tr>
        <tr class="memitem:p inherit"><td class="memItemLeft"><a id="p"></a><td class="memItemRight">parent ()</td></tr>
        <tr><td class="memTemplParams"><a id="t"></a>template<tr><td class="memTemplItemRight">make ()</td></tr>
        <tr><td class="fieldname"><a id="f"></a>red&#160;</td><td class="fielddoc"><p>Rouge.</p></td></tr>""",
    "sub/index.html": "<title>Lib: Same (1.0)</title><h1>C:\\new\0</h1><p>İki \\o/",
    "plain.html": "<title>Plain</title><h1>Plain</h1>",
    "sub/w%41?.html": '<title>Wide "quotes"</title><h1>"quotes"</h1>',
    'quote".html': "", "sharp#.html": "", "line\n.html": "", "back\\slash.html": "", b"bytes\xff.html": "",
    "docdata/old.html": "", "picture.png": "",
}
INDEX = {
    "pages": [["index.html", "Start"], ["Foo.html", "By “heading”"], ["Foo.html#x", "नमस्ते x_1"],
              ["a b.html", "a b.html"], ["latin.htm", "été"], ["members.html", "Gauge Class"],
              ["members.html#r", "read"], ["members.html#all", "Gauge Class"], ["members.html#t", "make"],
              ["members.html#f", "red"], ["plain.html", "Plain"], ["sub/index.html", "C:∖new␀"],
              ["sub/w%41?.html", 'Wide "quotes"']],
    "info": [["The first paragraph.", 0], ["By “heading”", 1], ["It.", 2], ["y() – ns", 1], ["мир", 3], ["été", 4],
             ["Gauge Class", 5], ["read (int n) – Reads.", 6], ["Gauge Class", 7], ["make ()", 8], ["Rouge.", 9],
             ["Plain", 10], ["C:\\new\0 – İki \\o/", 11], ['"quotes"', 12]],
    "common": dict.fromkeys(
        "a an and are as at be by for from has in is it its of on one or that the to with".split(), 1),
    "searchIndex": {"again": [3], "away": [0], "b": [4], "c": [0, 12], "café": [0], "class": [3, 6, 8], "first": [0],
                    "gauge": [6, 8], "gone": [0], "group": [0], "heading": [1], "html": [4], "int": [7], "i̇ki": [12],
                    "make": [9], "n": [7], "new": [0, 12], "no": [0], "ns": [3], "o": [12], "other": [0],
                    "paragraph": [0], "path": [0], "plain": [11], "quotes": [13], "read": [7], "reads": [7],
                    "red": [10], "rouge": [10], "start": [0], "wide": [13], "x_1": [2], "y": [3], "été": [5],
                    "мир": [4], "नमस्ते": [2]},
}


def node(link, title, *children):
    return {"link": link, "title": title, "children": list(children) or None}


FROM_LISTS = node("index.html", "All",
                  node("null", "ns", node("latin.htm", "Class")),
                  node("index.html", "lib",
                       node("null", "Group", node("a b.html#café", "Café"), node("Foo.html", "Path")),
                       node("sub/index.html", "C:∖new"), node("sub/index.html", "Again")))
FROM_DIRECTORIES = node("index.html", "Set", node(
    "index.html", "lib", node("Foo.html", "By “heading”"), node("a b.html", "a b.html"), node("latin.htm", "été"),
    node("members.html", "Gauge Class"), node("plain.html", "Plain"),
    node("sub/index.html", "C:∖new␀", node("sub/w%41?.html", 'Wide "quotes"'))))
# Of the files in the order in which they are read, then of titles and links.
WARNINGS = """'back\\\\slash.html': left out: the scripts can't hold its path
'bytes\\udcff.html': left out: the scripts can't hold its path
'line\\n.html': left out: the scripts can't hold its path
'quote".html': left out: the scripts can't hold its path
'sharp#.html': left out: the scripts can't hold its path
sub/index.html: what would break the scripts is replaced in the title "C:∖new␀"
index.html: what would break the scripts is replaced in the title "C:∖new"
index.html: links to 'gone.html', which is not a page of the set, are left out
Set: there is no page none.html""".split("\n")


class PagemeldDocdata(unittest.TestCase):
    def setUp(self):
        self.maxDiff = None
        parent = tempfile.TemporaryDirectory()
        self.addCleanup(parent.cleanup)
        self.directory = os.path.join(parent.name, "lib", "Set")
        for path, page in PAGES.items():
            path = os.path.join(os.fsencode(self.directory), os.fsencode(path))
            os.makedirs(os.path.dirname(path), exist_ok=True)
            with open(path, "wb") as file:
                file.write(page if isinstance(page, bytes) else page.encode())

    def make(self, *options):
        run = subprocess.run([sys.executable, PROGRAM, *options, self.directory], stderr=subprocess.PIPE, check=True,
                             env={**os.environ, "PYTHONIOENCODING": "utf-8", "PYTHONHASHSEED": "random"})
        texts = []
        for name in ("index.json", "toc.json"):
            with open(os.path.join(self.directory, "docdata", name), encoding="utf-8") as file:
                texts.append(file.read())
        return texts, run.stderr.decode().replace(self.directory + "/", "").replace(self.directory, "Set").splitlines()

    def test_writes_index_and_contents_and_says_what_it_left_out_or_replaced(self):
        (index, contents), said = self.make("--toc", "index.html", "--toc", "none.html", "--toc", "Foo.html",
                                            "--root-title", "All", "--share", "ns")
        self.assertEqual(INDEX, json.loads(index))
        self.assertEqual(list(INDEX["searchIndex"]), list(json.loads(index)["searchIndex"]))
        self.assertEqual(FROM_LISTS, json.loads(contents))
        self.assertEqual(["pagemeld-docdata: warning: " + warning for warning in WARNINGS], said[:-1])
        self.assertEqual("pagemeld-docdata: Set: 8 pages, 5 places, 14 texts, 36 terms", said[-1])

    def test_writes_nothing_without_pages(self):
        with tempfile.TemporaryDirectory() as empty:
            self.assertEqual(1, subprocess.run([sys.executable, PROGRAM, empty], stderr=subprocess.PIPE).returncode)
            self.assertEqual([], os.listdir(empty))

    def test_same_pages_give_same_bytes(self):
        self.assertEqual(self.make()[0], self.make()[0])

    def test_contents_from_directories_and_an_unknown_list(self):
        self.assertEqual(FROM_DIRECTORIES, json.loads(self.make()[0][1]))
        texts, said = self.make("--toc", "list.html")
        self.assertEqual(FROM_DIRECTORIES, json.loads(texts[1]))
        self.assertIn("Set: the contents are made from the directories", "\n".join(said))


if __name__ == "__main__":
    unittest.main()
