"""Tests pagemeld-docdata by what it writes and says: pagemeldDocdataTest.py PROGRAM"""
import json
import os
import subprocess
import sys
import tempfile
import unittest
from pathlib import Path

PROGRAM = os.path.abspath(sys.argv.pop(1))
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
    'quote".html': "", "sharp#.html": "", "line\n.html": "", "back\\slash.html": "", "bytes\udcff.html": "",
    "docdata/old.html": "", "picture.png": "",
    "moved.html": "<title>Redirecting</title><meta content='0;\nURL=plain.html' http-equiv=Refresh><h1>Moved</h1>",
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
FROM_DIRECTORIES = node("index.html", "Manual", node(
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
Manual: there is no page none.html
index.html: what would break the scripts is replaced in the title "C:∖new"
index.html: links to 'gone.html', which is not a page of the set, are left out
plain.html: its lists lead to no page of the set""".split("\n")


# A row is what a page has, its places and its texts.
PLACES = [
    ("heading, its container, an anchor before it, no anchor",
     "<h1>P</h1><h2 id=a>Alpha</h2><section id=b><h2>Two</h2></section><a name='c'></a><h3>Three</h3>"
     "<div id=d>x</div><h2>Four</h2><p>y", ["#a Alpha", "#b Two", "#c Three"], ["P", "Alpha", "Two", "x", "Four – y"]),
    ("what follows a list of members belongs to the section around it",
     "<h2 id=s>S</h2><p>lead<dl><dt id=m class=sig><span class=descclassname><span>Q.</span></span>"
     "<span class=descname>get</span>(x)<dd><p>Gets.</dl>after",
     ["#s S", "#m Q.get"], ["P", "lead", "Q.get(x) – Gets."]),
    ("members of other generators",
     "<a id='f()'><!-- --></a><ul><li><h4>f</h4><div class=block>Old javadoc.</div></ul>"
     "<div class=refsect2><a name=g></a><h3>g ()</h3><p>gtk-doc.</div>"
     "<section id=method.h><a class=src href=s>source</a><h4>pub fn <a class=fn>h</a>() -&gt; T</h4></section>"
     "<dl><dt id=i><span>Function: </span><strong class=def-name>i</strong> (n)<dd><p>texinfo.</dl>",
     ["#f() f", "#g g ()", "#method.h h", "#i i"],
     ["P", "Old javadoc.", "gtk-doc.", "pub fn h() -> T", "Function: i (n) – texinfo."]),
    ("a term without an anchor is text", "<h2 id=t>T</h2><dl><dt>Returns:<dd>zero</dl>", ["#t T"], ["P", "Returns:"]),
    ("no text: scripts, comments, navigation; broken marks",
     "<script>if (a < b) '</p>'</script><!-- <p>no --><nav><h2 id=n>N</h2></nav><p title='a>b' x=\"it's\">1 < 2 &amp; "
     "&#x33;<svg><title>no</title></svg></p><!-- <p>never closed", [], ["1 < 2 & 3"]),
    ("of a listing the first line", "<h2 id=l>L</h2><pre>\n <b>one</b>\n two</pre><h2 id=m>M</h2>"
     "<div class=fragment><div>three</div>\nfour</div>", ["#l L", "#m M"], ["P", "one", "three"]),
    ("a text is cut between words", f"<p>{'wörter ' * 60}", [], ["wörter " * 42 + "…"]),
    ("an anchor that the scripts can't hold", "<h2 id='a\\b'>Q</h2><p>text", [], ["P", "Q – text"]),
    ("a heading that is the title is the page's", "<h3 id=p>1.2 P</h3><p>text", [], ["1.2 P – text"]),
]
# A row is a word, what stands around it in a page, and whether it is found. A hundred other pages have the word often.
WORDS = [("b" * 41, "<p>{}", False), ("c" * 40, "<p>{}", True), ("d" * 41, "<h2>{}</h2><p>x", True),
         ("12345", "<p>{}", False), ("1234", "<p>{}", True), ("later", "<p>x<ul><li>{}</ul>", True),
         ("often", "<p>x<ul><li>{}</ul>", False), ("often", "<p>{}", True), ("second", "<pre>x\n{}</pre>", False)]
# A row is the titles and main headings of some pages, and what they are called.
TITLES = [
    ("a tail, although the first heading is the theme's",
     [("A \u2014 Lib 1.2 docs", "Lib"), ("B-c \u2014 Lib 1.2 docs", "Lib"), ("D", "Lib")], ["A", "B-c", "D"]),
    ("a tail in brackets", [("A (X (1.0))", ""), ("f(x) (X (1.0))", "")], ["A", "f(x)"]),
    ("a head", [("Lib: A", ""), ("Lib: B: C", ""), ("Lib: D", "")], ["A", "B: C", "D"]),
    ("nothing in common", [("A - B", ""), ("C - D", "")], ["A - B", "C - D"]),
    ("the same title twice, none, and only the frame",
     [("A - L", "x"), ("A - L", "y"), ("", "z"), ("B - L", ""), ("", "")], ["x", "y", "z", "B", "4.html"]),
]
# A row is the start page's title and heading, more options, and the name of the entry of module "lib".
MODULE_NAMES = [("Main Page", "Overview", [], "lib"), ("3.11.2 Documentation", "", [], "lib"),
                ("Overview", "The Lib", [], "The Lib"), ("Lib", "", [], "Lib"), ("Lib", "", ["--title", "L"], "L")]
REPEATS = ('<li><a href="index.html">Home</a><li><a href="c.html">index.html</a>'
           '<li><a href="search.html">Search Page</a>')
LIST = f'<ul>{REPEATS}<li><a href="b.html">B</a></li><li><a href="#">Menu</a></li></ul>'
# A row is what makes a generator known, the page with its list, and the list.
GENERATORS = [
    ("index.html", '<meta name="generator" content="Doxygen 1.9">', "annotated.html",
     '<tr id="row_0_"><td><a href="b.html">B</a>'),
    ("index.html", "<META content='DocBook XSL' name='generator'>", "index.html",
     "<ul><li>" * 1999 + "</ul>" * 1999 + '<dl class="toc"><dt><a href="b.html">B</a></dt></dl>'),
    ("element-list", "", "overview-tree.html", LIST), ("objects.inv", "", "contents.html", LIST),
    ("book.js", "", "index.html", '<nav><ol><li><a href="b.html">B</a><li><ol><li><a href="c.html">C</a></ol></ol>'
                                  '</nav><a rel="next" href="c.html">Next</a>'),
]
TAG = '<script src="docdata/pagemeld.js" defer="defer"></script>'
WIDE_TAG = TAG.replace(" defer", ' charset="utf-8" defer').encode("utf-16-le").decode()
WIDE = ("\ufeff<p>\u010d".encode("utf-16-le"), "</body>".encode("utf-16-le") + b"!", WIDE_TAG)
OLD_TAG = '<script src="docdata/pagemeld.js" defer data-docdata="../docdata"></script>'
SLOW = b"<script " + b"src=docdata/pagemeld.js " * 20000 + b">x</script><meta " + b"name=generator " * 20000 + (
    b"><meta http-equiv=refresh content='" + b" " * 200000 + b"'>")
# A row is a page's name, what it has before and after the place of the tag, and the tag that it gets.
SCRIPT = [
    ("plain.html", b"<body>x", b"</BODY ></html>", TAG), ("bytes.html", b"\xff\r\n", b"</body>", TAG),
    ("end.html", b"<p>x", b"", TAG), ("bodyless.html", b"<p>x", b"</html>", TAG), ("a.html", SLOW, b"</body>", TAG),
    ("hidden.html", b"<script>'</body>'</script>x", b"</body><!-- </body> -->", TAG),
    ("said.html", f"<!-- {TAG} -->".encode(), b"</body>", TAG),
    ("wide.html", *WIDE), ("based.html", b"<base target=x>", b"<base href=y></body>", TAG),
    ("deep/er/page.html", b"", b"</body>", TAG.replace('"doc', '"../../doc')),
    ("frames.html", b"<frameset></frameset><noframes><body>", b"</body></noframes>", ""),
    ("strict.xhtml", b'<?xml version="1.0"?><html><body/>', b"</html>", ""),
]
# A row is arguments, what the error says, and the status.
MISTAKES = [
    (["lib"], "lib is a module, not a set directory; the call is pagemeld-docdata lib/Manual", 2),
    (["."], ". is a directory of modules, not a set directory; the call is pagemeld-docdata ./*/Manual", 2),
    (["lib/Manual/sub"], "sub is not a set directory: that must be called Manual or ScriptReference", 2),
    (["lib/Manual/index.html"], "index.html is not a directory", 2),
    (["--title", "T", "lib/Manual", "other/Manual"], "--title names one module, but the sets belong to several", 2),
    (["--page-script", "--remove", "lib/Manual"], "--page-script and --remove exclude each other", 2),
    (["other/Manual"], "other/Manual has no pages", 1),
    (["outputs/Manual"], "outputs/Manual: no pages, docdata for outputs only", 0),
]


class PagemeldDocdata(unittest.TestCase):
    def setUp(self):
        self.maxDiff = None
        self.parent = self.enterContext(tempfile.TemporaryDirectory())
        self.directory = os.path.join(self.parent, "lib", "Manual")

    def write(self, pages):
        for path, page in pages.items():
            file = Path(self.directory, path)
            file.parent.mkdir(parents=True, exist_ok=True)
            file.write_bytes(page if isinstance(page, bytes) else page.encode())

    def read(self, path):
        return Path(self.directory, path).read_bytes()

    def run_program(self, *arguments, status=0):
        """Returns the lines that the program says, with paths relative to the set."""
        run = subprocess.run([sys.executable, PROGRAM, *arguments], stderr=subprocess.PIPE, cwd=self.parent,
                             env={**os.environ, "PYTHONIOENCODING": "utf-8", "PYTHONHASHSEED": "random"}, check=False)
        said = run.stderr.decode().replace(self.directory + "/", "").replace(self.directory, "Manual")
        self.assertEqual(status, run.returncode, said)
        return said.splitlines()

    def make(self, *options):
        """Returns index, contents and what was said."""
        said = self.run_program(*options, self.directory)
        return json.loads(self.read("docdata/index.json")), json.loads(self.read("docdata/toc.json")), said

    def test_writes_index_and_contents_and_says_what_it_left_out_or_replaced(self):
        self.write(PAGES)
        lists = [option for page in ("index", "none", "Foo", "plain") for option in ("--toc", f"{page}.html")]
        index, contents, said = self.make(*lists, "--root-title", "All", "--share", "ns")
        self.assertEqual(INDEX, index)
        self.assertEqual(list(INDEX["searchIndex"]), list(index["searchIndex"]))
        self.assertEqual(FROM_LISTS, contents)
        self.assertEqual(WARNINGS, [line.removeprefix("pagemeld-docdata: warning: ") for line in said[:-1]])
        self.assertIn("Manual: 8 pages, 5 places, 14 texts, 36 terms; 1 redirects left out", said[-1])

    def test_many_pages_give_the_same_in_several_processes_and_what_most_of_them_have_is_no_place(self):
        page = "<h1>P</h1><h2 id=e>Examples</h2><p>x<h3 id=o>Own {}</h3>"
        self.write({f"{number}.html": page.format(number) for number in range(100)})
        self.assertEqual(["0.html", "0.html#o"], [path for path, _ in self.make("--jobs", "1")[0]["pages"][:2]])
        once = self.read("docdata/index.json")
        self.make("--jobs", "5")
        self.assertEqual(once, self.read("docdata/index.json"))

    def test_makes_the_sets_that_other_modules_have_for_outputs(self):
        self.write({"index.html": "x", "../../other/ScriptReference/index.html": "x"})
        self.run_program("lib/Manual", "other/ScriptReference")
        for made in ("lib/ScriptReference", "other/Manual"):
            self.assertEqual(["docdata"], os.listdir(Path(self.parent, made)))

    def test_contents_from_directories_have_no_generated_and_no_excluded_pages(self):
        self.write({**PAGES, "genindex.html": "<h1>Index</h1><h2 id=a>A</h2><p>gauge", "draft/x.html": ""})
        index, contents, said = self.make("--toc", "list.html", "--exclude", "draft/*")
        self.assertEqual(FROM_DIRECTORIES, contents)
        self.assertIn(["Index", 4], index["info"])
        self.assertNotIn("genindex.html#a", [path for path, _ in index["pages"]])
        self.assertIn("Manual: the contents are made from the directories", "\n".join(said))

    def test_places(self):
        for name, page, places, texts in PLACES:
            with self.subTest(name):
                self.write({"p.html": f"<title>P</title>{page}"})
                index = self.make()[0]
                self.assertEqual(["p.html P"] + [f"p.html{place}" for place in places],
                                 [" ".join(entry) for entry in index["pages"]])
                self.assertEqual(sorted(texts), sorted(text for text, _ in index["info"]))

    def test_words(self):
        self.write({f"{number}.html": "<p>y<ul><li>often" for number in range(100)})
        for word, page, is_found in WORDS:
            with self.subTest(word, page=page):
                self.write({"a.html": page.format(word)})
                index = self.make()[0]
                entries = [index["info"][number][1] for number in index["searchIndex"].get(word, [])]
                self.assertEqual(is_found, "a.html" in [index["pages"][entry][0] for entry in entries])

    def test_titles_of_pages_and_modules(self):
        for name, pages, expected in TITLES:
            with self.subTest(name), tempfile.TemporaryDirectory() as parent:
                self.directory = os.path.join(parent, "Manual")
                self.write({f"{number}.html": f"<title>{title}</title><h1>{heading}</h1>"
                            for number, (title, heading) in enumerate(pages)})
                self.assertEqual(expected, [title for _, title in self.make()[0]["pages"]])
        self.directory = os.path.join(self.parent, "lib", "Manual")
        for title, heading, options, expected in MODULE_NAMES:
            with self.subTest(title):
                self.write({"index.html": f"<title>{title}</title><h1>{heading}</h1>", "b.html": ""})
                self.assertEqual(expected, self.make(*options)[1]["children"][0]["title"])

    def test_usual_lists_of_generators(self):
        for known_by, content, page, contents in GENERATORS:
            with self.subTest(known_by, page=page), tempfile.TemporaryDirectory() as parent:
                self.directory = os.path.join(parent, "Manual")
                pages = {"index.html": "", "b.html": "<title>B</title>", "c.html": "C",
                         "search.html": "<title>Search</title>", known_by: content}
                self.write({**pages, page: pages.get(page, "") + contents})
                below = [node("c.html", "C")] if "C</a>" in contents else []
                self.assertEqual([node("b.html", "B", *below)], self.make()[1]["children"][0]["children"])

    def test_page_script(self):
        before = {name: start + end for name, start, end, _ in SCRIPT}
        after = {name: start + tag.encode() + end for name, start, end, tag in SCRIPT}
        self.write({**before, "old.html": OLD_TAG + "</body>"})
        for _ in range(2):
            self.make("--page-script")
            self.assertEqual(after, {name: self.read(name) for name in before})
            self.assertEqual(f"{OLD_TAG}</body>".encode(), self.read("old.html"))
        self.assertIn(b"function", self.read("docdata/pagemeld.js"))
        self.run_program("--remove", self.directory)
        self.assertEqual({**before, "old.html": b"</body>"}, {name: self.read(name) for name in [*before, "old.html"]})
        self.assertEqual(["index.json", "toc.json"], sorted(os.listdir(os.path.join(self.directory, "docdata"))))

    def test_mistakes(self):
        self.write({"index.html": "x", "sub/index.html": "x", "../../other/Manual/picture.png": "",
                    "../../outputs/Manual/docdata/global_toc.js": ""})
        for arguments, message, status in MISTAKES:
            with self.subTest(arguments):
                self.assertIn(message, self.run_program(*arguments, status=status)[-1])
                self.assertEqual(["index.html", "sub"], sorted(os.listdir(self.directory)))


if __name__ == "__main__":
    unittest.main()
