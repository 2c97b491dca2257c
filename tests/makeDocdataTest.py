"""Tests examples/make-docdata.py by whole outputs: makeDocdataTest.py SCRIPT"""
import json
import os
import subprocess
import sys
import tempfile
import unittest

SCRIPT = sys.argv.pop(1)
PAGES = {
    "index.html": """<title>Start</title><h1>Site</h1><main><nav><h2>Here</h2></nav><h1>Start</h1>
        <p>The <b>first</b><br>paragraph.<p>No other.
        <ul><li>Group<ul><li><a href="a%20b.html#caf%C3%A9">Café</a><li><a href="./Foo%3ABar.html">Path</a></ul>
        <li><a href="sub/#&quot;">C:\\new</a><li><a href="ftp://x/">Away</a>
        <li><a href="gone.html">Gone</a><li><a href="gone.html#x">Gone</a></ul>
        <tr id="row_0_"><td><span class="arrow">v</span>ns</td><tr id="row_0_0_"><td><a href="latin.htm">Class</a>""",
    "Foo:Bar.html": "<title>Same</title><h1>By “heading”</h1><h2>__proto__</h2><dl><dt id=x>नमस्ते x_1</dt><dd><p>It.",
    "a b.html": b"<meta charset=koi8-r><p>\xcd\xc9\xd2",
    "latin.htm": b"<title>\xe9t\xe9</title><![odd]><p>not read",
    "sub/index.html": "<title>Same</title><h1>C:\\new\0</h1><p>İki \\o/",
    "sub/w%41?.html": '\ufeff<title>Wide "quotes"</title>'.encode("utf-16-le"),
    'quote".html': "", "sharp#.html": "", "line\n.html": "", "back\\slash.html": "", b"bytes\xff.html": "",
    "docdata/old.html": "", "picture.png": "",
}
INDEX = {
    "pages": [["index.html", "Start"], ["./Foo:Bar.html", "By “heading”"], ["a b.html", "a b.html"],
              ["latin.htm", "été"], ["sub/index.html", "C:∖new␀"], ["sub/w%41?.html", 'Wide "quotes"']],
    "info": [["The first paragraph.", 0], ["__proto__", 1], ["नमस्ते x_1 – It.", 1], ["мир", 2], ["été", 3],
             ["C:\\new\0 – İki \\o/", 4], ['Wide "quotes"', 5]],
    "common": dict.fromkeys(
        "a an and are as at be by for from has in is it its of on one or that the to with".split(), 1),
    "searchIndex": {"b": [3], "c": [5], "first": [0], "heading": [1], "html": [3], "i̇ki": [5], "new": [5], "o": [5],
                    "paragraph": [0], "quotes": [6], "start": [0], "wide": [6], "x_1": [2], "été": [4], "мир": [3],
                    "नमस्ते": [2]},
}


def node(link, title, *children):
    return {"link": link, "title": title, "children": list(children) or None}


FROM_LIST = node("index.html", "All",
                 node("null", "Group", node("a b.html#café", "Café"), node("./Foo:Bar.html", "Path")),
                 node("null", "ns", node("latin.htm", "Class")),
                 node("index.html", "Start", node("sub/index.html", "C:∖new")))
FROM_DIRECTORIES = node("index.html", "Set", node(
    "index.html", "Start", node("./Foo:Bar.html", "By “heading”"), node("a b.html", "a b.html"),
    node("latin.htm", "été"), node("sub/index.html", "C:∖new␀", node("sub/w%41?.html", 'Wide "quotes"'))))
# Of the files in the order in which they are read, then of titles and links.
WARNINGS = """'back\\\\slash.html': left out: the scripts can't hold its path
'bytes\\udcff.html': left out: the scripts can't hold its path
latin.htm: is not UTF-8 and declares no encoding: read as windows-1252
latin.htm: read in part: unknown status keyword 'odd' in marked section
'line\\n.html': left out: the scripts can't hold its path
'quote".html': left out: the scripts can't hold its path
'sharp#.html': left out: the scripts can't hold its path
sub/index.html: what would break the scripts is replaced in the title "C:∖new␀"
index.html: what would break the scripts is replaced in the title "C:∖new"
index.html: links to 'gone.html', which does not exist, are left out""".split("\n")


class MakeDocdata(unittest.TestCase):
    def setUp(self):
        self.maxDiff = None
        parent = tempfile.TemporaryDirectory()
        self.addCleanup(parent.cleanup)
        self.directory = os.path.join(parent.name, "Set")
        for path, page in PAGES.items():
            path = os.path.join(os.fsencode(self.directory), os.fsencode(path))
            os.makedirs(os.path.dirname(path), exist_ok=True)
            with open(path, "wb") as file:
                file.write(page if isinstance(page, bytes) else page.encode())

    def make(self, *options):
        run = subprocess.run([sys.executable, SCRIPT, *options, self.directory], stderr=subprocess.PIPE, check=True,
                             env={**os.environ, "PYTHONIOENCODING": "utf-8", "PYTHONHASHSEED": "random"})
        texts = []
        for name in ("index.json", "toc.json"):
            with open(os.path.join(self.directory, "docdata", name), encoding="utf-8") as file:
                texts.append(file.read())
        return texts, run.stderr.decode().replace(self.directory + "/", "").splitlines()

    def test_writes_index_and_contents_and_says_what_it_left_out_or_replaced(self):
        (index, contents), said = self.make("--toc", "index.html", "--root-title", "All")
        self.assertEqual(INDEX, json.loads(index))
        self.assertEqual(list(INDEX["searchIndex"]), list(json.loads(index)["searchIndex"]))
        self.assertEqual(FROM_LIST, json.loads(contents))
        self.assertEqual(["make-docdata.py: warning: " + warning for warning in WARNINGS], said[:-1])
        self.assertEqual(f"make-docdata.py: {self.directory}: 6 pages, 7 texts, 16 terms", said[-1])

    def test_same_pages_give_same_bytes(self):
        self.assertEqual(self.make()[0], self.make()[0])

    def test_contents_from_directories_and_an_unknown_list(self):
        self.assertEqual(FROM_DIRECTORIES, json.loads(self.make()[0][1]))
        texts, said = self.make("--toc", "list.html")
        self.assertEqual(FROM_DIRECTORIES, json.loads(texts[1]))
        self.assertIn("there is no page list.html: the contents are made from the directories", "\n".join(said))


if __name__ == "__main__":
    unittest.main()
