#include "tests/support/CheckCase.h"

#include <gtest/gtest.h>

TEST(PagemeldCheck, ReadsInputs)
{
    ExpectReports({
        {"truncate -s 5G c/Manual/docdata/index.json; CHECK @/a @/b @/c # Inputs that can't be read say why",
         {{"a/Manual/docdata/toc.json", kDirectory},
          {"b/Manual/docdata/index.json", kGone},
          {"c/Manual/docdata/index.json", Index(R"(["p.html","P"])")},
          {"c/Manual/docdata/toc.json", kLink + "nowhere"}},
         R"(@/a/Manual/docdata/toc.json: error: is a directory, not a file; "a" will be missing from the contents of Manual [unreadable]
@/b/Manual/docdata/index.json: error: is missing beside toc.json; "b" will be missing from the search of Manual [unreadable]
@/c/Manual/docdata/index.json: error: can't be read: it is larger than 4 GiB; "c" will be missing from the search of Manual [unreadable]
@/c/Manual/docdata/toc.json: error: is a link to what does not exist; "c" will be missing from the contents of Manual [unreadable]
3 modules, 4 errors, 0 warnings; missing from the search of Manual: b, c; from its contents: a, c, status 1)"},
        {"CHECK @/a @/b # One input does without the other, and not without any",
         {{"a/Manual/docdata/toc.json", kGone}, {"b/Manual/docdata/toc.json", "[]"}},
         R"(@/a/Manual/docdata/toc.json: error: is missing beside index.json; "a" will be missing from the contents of Manual [unreadable]
@/b/Manual/docdata/toc.json:1:1: error: node is an array of 0, not an object; "b" will be missing from the contents of Manual [structure]
Manual: error: no module has a sound toc.json: nothing will be written [nothing-to-combine]
2 modules, 3 errors, 0 warnings; missing from the contents of Manual: a, b, status 1)"},
        {"CHECK @/a @/b @/c # What is not JSON says what to do",
         {{"a/Manual/docdata/index.json", "{\"pages\":[],\n\"info\":[1,]}"},
          {"a/Manual/docdata/toc.json", "\357\273\277{}"},
          {"b/Manual/docdata/index.json", "{'pages':[]}"},
          {"b/Manual/docdata/toc.json", R"({"link":"a\q"})"},
          {"c/Manual/docdata/index.json", Index(R"(["p.html","P"])")},
          {"c/Manual/docdata/toc.json", ""}},
         R"(@/a/Manual/docdata/index.json:2:11: error: not JSON: there is a comma before the closing bracket; refused at byte 23, at "]}"; "a" will be missing from the search of Manual [not-json]
@/a/Manual/docdata/toc.json:1:1: error: not JSON: the file begins with a byte order mark: save it without; refused at byte 0, at "\uFEFF{}"; "a" will be missing from the contents of Manual [not-json]
@/b/Manual/docdata/index.json:1:2: error: not JSON: strings need double quotes; refused at byte 1, at "'pages':[]}"; "b" will be missing from the search of Manual [not-json]
@/b/Manual/docdata/toc.json:1:11: error: not JSON: every backslash that is meant as one must be doubled; in a title or path, use another character; refused at byte 10, at "\\q\"}"; "b" will be missing from the contents of Manual [not-json]
@/c/Manual/docdata/toc.json:1:1: error: not JSON: the file is empty; refused at byte 0, at the end of the text; "c" will be missing from the contents of Manual [not-json]
Manual: error: no module has a sound toc.json: nothing will be written [nothing-to-combine]
3 modules, 6 errors, 0 warnings; missing from the search of Manual: a, b; from its contents: a, b, c, status 1)"},
        {"CHECK @/a @/b # Each broken rule of the formats is shown, ten of a kind",
         {{"b/Manual/docdata/index.json",
           Index(
               R"(["a","A"],[],["b",7],["c","C",1.0])",
               R"("info":[["i",0],["i",4],["i",-1],["i","x"],[1,2]],"common":{"a":1,"b":2},"searchIndex":{"a/b":{},"t":[0,5,"1"]})")},
          {"b/Manual/docdata/toc.json",
           "{\"link\":7,\n\"children\":[{\"link\":\"l\",\"title\":\"t\",\"children\":{}},7]}"}},
         R"(@/b/Manual/docdata/index.json:1:21: error: page entry is an array of 0, not [path, title]; "b" will be missing from the search of Manual [structure] /pages/1
@/b/Manual/docdata/index.json:1:24: error: page path or title is 7, not a string; "b" will be missing from the search of Manual [structure] /pages/2
@/b/Manual/docdata/index.json:1:32: error: page entry is an array of 3, not [path, title]; "b" will be missing from the search of Manual [structure] /pages/3
@/b/Manual/docdata/index.json:1:63: error: page number 4, but there are 4 pages, numbered from 0; "b" will be missing from the search of Manual [structure] /info/1
@/b/Manual/docdata/index.json:1:71: error: page number -1, but there are 4 pages, numbered from 0; "b" will be missing from the search of Manual [structure] /info/2
@/b/Manual/docdata/index.json:1:80: error: page number is "x", not a 32-bit integer; "b" will be missing from the search of Manual [structure] /info/3
@/b/Manual/docdata/index.json:1:90: error: text is 1, not a string; "b" will be missing from the search of Manual [structure] /info/4
@/b/Manual/docdata/index.json:1:117: error: common word has the value 2, not 1; "b" will be missing from the search of Manual [structure] /common/b
@/b/Manual/docdata/index.json:1:141: error: term has an object of 0, not an array of info numbers; "b" will be missing from the search of Manual [structure] /searchIndex/a~1b
@/b/Manual/docdata/index.json:1:151: error: info number 5, but there are 5 infos, numbered from 0; "b" will be missing from the search of Manual [structure] /searchIndex/t/1
@/b/Manual/docdata/index.json: error: 1 more of this rule; --limit=0 shows all [structure]
@/b/Manual/docdata/toc.json:1:1: error: "title" is missing; it must be a string; "b" will be missing from the contents of Manual [structure]
@/b/Manual/docdata/toc.json:1:9: error: "link" is 7, not a string; "b" will be missing from the contents of Manual [structure] /link
@/b/Manual/docdata/toc.json:2:48: error: "children" is an object of 0, not an array or null; "b" will be missing from the contents of Manual [structure] /children/0/children
@/b/Manual/docdata/toc.json:2:52: error: node is 7, not an object; "b" will be missing from the contents of Manual [structure] /children/1
2 modules, 15 errors, 0 warnings; missing from the search of Manual: b; from its contents: b, status 1)"},
    });
}

TEST(PagemeldCheck, LooksAtTextsAsTheScriptsHoldThem)
{
    ExpectReports({
        {"CHECK @/a @/b # Titles, paths and links are string literals",
         {{"a/Manual/docdata/index.json", Index(R"(["a'b.html","\"Operator\""])")},
          {"a/Manual/docdata/toc.json",
           Toc(R"({"link":"a.html","title":"\u2028","children":null},{"link":"null","title":"\"","children":null})")},
          {"b/Manual/docdata/index.json", Index(R"(["a\"b.html","\"\\\" Operator"])")},
          {"b/Manual/docdata/toc.json",
           Toc(R"({"link":"a.html","title":"at the end\\","children":null},{"link":"b\nc.html","title":"B","children":null})")}},
         R"(@/b/Manual/docdata/index.json:1:12: error: page path "a\"b.html" breaks global_index.js in every module [script-broken] /pages/0/0
@/b/Manual/docdata/index.json:1:24: error: title "\"\\\" Operator" of page "a\"b.html" breaks global_index.js in every module [script-broken] /pages/0/1
@/b/Manual/docdata/toc.json:1:66: error: title "at the end\\" breaks global_toc.js in every module [script-broken] /children/0/title
@/b/Manual/docdata/toc.json:1:106: error: link "b\nc.html" breaks global_toc.js in every module [script-broken] /children/1/link
2 modules, 4 errors, 0 warnings, status 1)"},
        {"CHECK @/a @/b # Titles, paths and links are what the scripts hold",
         {{"a/Manual/docdata/index.json", Index(R"(["a.html","C:/new"])")},
          {"b/Manual/docdata/index.json", Index(R"(["a.html","C:\\new"])")},
          {"b/Manual/docdata/toc.json", Toc(R"({"link":"a\u0000.html","title":"A","children":null})")}},
         R"(@/b/Manual/docdata/index.json:1:21: warning: title "C:\\new" of page "a.html" is "C:\new" in global_index.js: readers see that [script-altered] /pages/0/1
@/b/Manual/docdata/toc.json:1:49: warning: link "a\x00.html" is "a" in global_toc.js: readers are led there [script-altered] /children/0/link
2 modules, 0 errors, 2 warnings, status 0)"},
        {"CHECK @/a @/b # Links lead to files, and addresses are no files",
         {{"a/Manual/docdata/index.json", Index(R"(["std::list.html","A"],["x/a:b.html","A"])")},
          {"a/Manual/docdata/toc.json", Toc(R"({"link":"mailto:a","title":"A","children":null})")},
          {"b/Manual/docdata/index.json", Index(R"(["https://h/a","A"])")},
          {"b/Manual/docdata/toc.json",
           Toc(R"({"link":"mailto:a","title":"A","children":null},{"link":"File:a","title":"B","children":null})")}},
         R"(@/a/Manual/docdata/toc.json:1:49: warning: link "mailto:a" gets the module's prefix, and is dead without the page script [prefixed-url] /children/0/link
@/b/Manual/docdata/index.json:1:12: warning: page path "https://h/a" gets the module's prefix, and is dead without the page script [prefixed-url] /pages/0/0
@/b/Manual/docdata/toc.json:1:49: warning: link "mailto:a" gets the module's prefix, and is dead without the page script [prefixed-url] /children/0/link
@/b/Manual/docdata/toc.json:1:97: warning: link "File:a" gets the module's prefix, and is dead unless a file has that name, which --targets checks [prefixed-url] /children/1/link
2 modules, 0 errors, 4 warnings, status 0)"},
        {"CHECK @/a @/b # Files are UTF-8 to the end",
         {{"a/Manual/docdata/index.json",
           Index("[\"p.html\",\"\303\251\"]",
                 R"("info":[["\ud83d\uDE00\\udc00",0]],"common":{},"searchIndex":{})")},
          {"a/Manual/docdata/toc.json",
           std::string("{\"link\":\"toc\",\"title\":\"toc\",\"children\":[]}\000", 43)},
          {"b/Manual/docdata/index.json",
           Index("[\"p.html\",\"\351\351\"]", R"("info":[["\\\uDC00",0]],"common":{},"searchIndex":{})")},
          {"b/Manual/docdata/toc.json",
           std::string("{\"link\":\"toc\",\"title\":\"toc\",\"children\":[]}\000\351", 44)}},
         R"(@/b/Manual/docdata/index.json:1:22: warning: byte \xE9 is not UTF-8: readers see a replacement character [invalid-utf8]
@/b/Manual/docdata/index.json:1:40: warning: half of a surrogate pair: readers see replacement characters, and other programs may refuse the JSON outputs; write both halves or neither [invalid-utf8]
@/b/Manual/docdata/toc.json:1:43: warning: a NUL byte ends the text; bytes after it that are not seen: 1 [text-after-nul]
2 modules, 0 errors, 3 warnings, status 0)"},
    });
}

TEST(PagemeldCheck, LooksUpTermsAsReadersDo)
{
    ExpectReports({
        {"CHECK @/a @/b # Terms and members can be found",
         {{"a/Manual/docdata/index.json",
           Index("", R"("info":[],"common":{"__proto":1},"searchIndex":{"prototype":[],"a_1\u00E9":[]})")},
          {"a/Manual/docdata/toc.json", Toc("", R"("link":"toc","title":"toc","x":1,"x":1)")},
          {"b/Manual/docdata/index.json",
           Index(
               "",
               R"("info":[],"common":{"__proto__":1,"__proto__":1},"searchIndex":{"__proto__":[],"a b":[],"":[],"C++":[],"Az":[]},"pages":[1])")},
          {"b/Manual/docdata/toc.json", Toc("", R"("link":"toc","title":"toc","link":"x")")}},
         R"(@/b/Manual/docdata/index.json:1:45: warning: common word "__proto__" sets a prototype in the scripts: readers do not find it [special-term] /common/__proto__
@/b/Manual/docdata/index.json:1:59: warning: common word "__proto__" sets a prototype in the scripts: readers do not find it [special-term] /common/__proto__
@/b/Manual/docdata/index.json:1:89: warning: term "__proto__" sets a prototype in the scripts: readers do not find it [special-term] /searchIndex/__proto__
@/b/Manual/docdata/index.json:1:98: warning: terms that readers can't find by the whole word, since words are looked up as letters, digits and _ in lower case (the page script ignores case): 4, first "a b" [unfound-term] /searchIndex/a b
@/b/Manual/docdata/index.json:1:133: warning: "pages" is there twice: this one is ignored [doubled-member] /pages
@/b/Manual/docdata/toc.json:1:36: warning: "link" is there twice: this one is ignored [doubled-member] /link
Manual: note: the common words of "a" count for all modules; those that differ are ignored, of "b" [common-ignored]
2 modules, 0 errors, 6 warnings, status 0)"},
        {"CHECK @/b @/a # Common words that count set the prototype once at most",
         {{"b/Manual/docdata/index.json",
           Index("", R"("info":[],"common":{"__proto__":1,"__proto__":1},"searchIndex":{})")}},
         R"(@/b/Manual/docdata/index.json:1:45: warning: common word "__proto__" sets a prototype in the scripts: readers do not find it [special-term] /common/__proto__
@/b/Manual/docdata/index.json:1:59: error: common word "__proto__" twice breaks global_index.js in every module [script-broken] /common/__proto__
2 modules, 1 error, 1 warning, status 1)"},
        {"CHECK @/a @/b @/c # Common words are the same in any order",
         {{"a/Manual/docdata/index.json", Index("", R"("info":[],"common":{"a":1,"b":1},"searchIndex":{})")},
          {"b/Manual/docdata/index.json", Index("", R"("info":[],"common":{"b":1,"a":1},"searchIndex":{})")},
          {"c/Manual/docdata/index.json", Index("", R"("info":[],"common":{"a":1},"searchIndex":{})")},
          {"c/Manual/docdata/toc.json", Toc("")}},
         R"(Manual: note: the common words of "a" count for all modules; those that differ are ignored, of "c" [common-ignored]
3 modules, 0 errors, 0 warnings, status 0)"},
    });
}

TEST(PagemeldCheck, MergesContentsAsARunDoes)
{
    ExpectReports({
        {"CHECK @/a @/b # An output is no input",
         {{"a/Manual/docdata/index.json", Index(R"(["module","0"])")},
          {"a/Manual/docdata/toc.json", Toc(R"({"link":"module","title":"A","modules":1,"children":null})")},
          {"b/Manual/docdata/index.json", Index(R"(["p","P"],["p","P",0],["q","Q",1])")},
          {"b/Manual/docdata/toc.json",
           Toc(R"({"link":"b","title":"B","children":[{"link":"d","title":"D","module":1,"children":null}]},{"link":"c","title":"C","module":2,"children":null})")}},
         R"(@/b/Manual/docdata/index.json:1:21: error: this is an output: the page entry names its module, 0; "b" will be missing from the search of Manual [merged-input] /pages/1
@/b/Manual/docdata/toc.json:1:77: error: this is an output: the node names its module, 1; its links will lead to that module [merged-input] /children/0/children/0
2 modules, 2 errors, 0 warnings; missing from the search of Manual: b, status 1)"},
        {"CHECK @/a @/b @/c # Roots of contents agree with the first up to a NUL",
         {{"b/Manual/docdata/toc.json", Toc("", R"("link":"toc","title":"x")")},
          {"c/Manual/docdata/index.json", Index(R"(["p.html","P"])")},
          {"c/Manual/docdata/toc.json", Toc("", R"("link":"toc","title":"toc\u0000x")")}},
         R"(@/b/Manual/docdata/toc.json:1:23: error: root title "x" differs from "toc" of @/a; "b" will be missing from the contents of Manual [root-differs] /title
@/c/Manual/docdata/toc.json:1:23: warning: title "toc\x00x" is "toc" in global_toc.js: readers see that [script-altered] /title
3 modules, 1 error, 1 warning; missing from the contents of Manual: b, status 1)"},
        {"CHECK @/a @/b @/c # A first root that differs from all is the odd one",
         {{"a/Manual/docdata/toc.json", Toc("", R"("link":"x","title":"x")")},
          {"c/Manual/docdata/index.json", Index(R"(["p.html","P"])")},
          {"c/Manual/docdata/toc.json", Toc("")}},
         R"(@/a/Manual/docdata/toc.json:1:9: error: root link "x" differs from "toc" of 2 other modules; it comes first, so they are dropped from the contents of Manual: "b", "c" [root-differs] /link
3 modules, 1 error, 0 warnings; missing from the contents of Manual: b, c, status 1)"},
        {"CHECK @/a @/b @/c # Entries with pages are in one module only",
         {{"a/Manual/docdata/toc.json",
           Toc(R"({"link":"o","title":"O","children":[{"link":"p","title":"P","children":null}]},{"link":"null","title":"G","children":[{"link":"q","title":"Q","children":null}]},{"link":"null","title":"G","children":[{"link":"r","title":"R","children":null}]})")},
          {"b/Manual/docdata/toc.json",
           Toc(R"({"link":"o","title":"O","children":[{"link":"p","title":"P","children":null}]},{"link":"o","title":"P","children":null},{"link":"null","title":"G","children":[{"link":"r","title":"R","children":null},{"link":"q\u0000","title":"Q","children":null},{"link":"s","title":"S","children":null},{"link":"s","title":"S","children":null}]})")},
          {"c/Manual/docdata/index.json", Index("")},
          {"c/Manual/docdata/toc.json",
           Toc(R"({"link":"null","title":"G","children":[{"link":"s","title":"S","children":null}]})")}},
         R"(@/b/Manual/docdata/toc.json:1:41: warning: @/a has the same entry, "O" with the link "o": in the contents it leads to the page of that module, and not to this one's [shadowed-entry] /children/0
@/b/Manual/docdata/toc.json:1:241: warning: @/a has the same entry, "Q" with the link "q\x00": in the contents it leads to the page of that module, and not to this one's [shadowed-entry] /children/2/children/1
@/b/Manual/docdata/toc.json:1:249: warning: link "q\x00" is "q" in global_toc.js: readers are led there [script-altered] /children/2/children/1/link
@/c/Manual/docdata/toc.json:1:80: warning: @/b has the same entry, "S" with the link "s": in the contents it leads to the page of that module, and not to this one's [shadowed-entry] /children/0/children/0
3 modules, 0 errors, 4 warnings, status 0)"},
    });
}

TEST(PagemeldCheck, FollowsPathsToFiles)
{
    ExpectReports({
        {"CHECK --targets @/a @/b # With --targets, paths are names of files as they are",
         {{"a/Manual/docdata/index.json",
           Index(
               R"(["p q.html","P"],["p q.html#s","S"],["a%41","A"],["100%.html?","H"],["s\\/p.html","S"],["std::x.html","X"],["File:x.html","F"])")},
          {"a/Manual/a%41", ""},
          {"a/Manual/100%.html?", ""},
          {"a/Manual/std::x.html", ""},
          {"a/Manual/File:x.html", ""},
          {"a/Manual/s/p.html", ""},
          {"a/Manual/s/.p.html", ""},
          {"a/Manual/s/p.js", ""},
          {"a/Manual/p q.html", ""},
          {"a/Manual/docdata/toc.json",
           Toc(R"({"link":"null","title":"N","children":null})", R"("link":"null","title":"")")},
          {"b/Manual/docdata/index.json",
           Index(
               R"(["docdata","D"],["p%20q%4Az.html?x#p","P"],["File:y.html","Y"],["HTTPS://h","U"],["C#.html","C"])")},
          {"b/Manual/C#.html", ""},
          {"b/Manual/p qJz.html", ""},
          {"b/Manual/l.html", kLink + "b/Manual/p qJz.html"},
          {"b/Manual/s/t/u.htm", ""},
          {"b/Manual/docdata/toc.json",
           Toc(R"({"link":"#x","title":"X","children":null},{"link":"q.html#p","title":"Q","children":null})",
               R"("link":"null","title":"")")}},
         R"(@/a/Manual/docdata/index.json:1:48: warning: page path "a%41" leads to "aA" without the page script, which encodes names [missing-target] /pages/2/0
@/a/Manual/docdata/index.json:1:61: warning: page path "100%.html?" leads to "100%.html" without the page script, which encodes names [missing-target] /pages/3/0
@/a/Manual/docdata/index.json:1:80: warning: page path "s\\/p.html" is "s/p.html" in global_index.js: readers are led there [script-altered] /pages/4/0
@/b/Manual/docdata/index.json:1:12: warning: page path "docdata" leads to no file: the link is dead [missing-target] /pages/0/0
@/b/Manual/docdata/index.json:1:28: warning: page path "p%20q%4Az.html?x#p" leads to no file: the page script asks for "p%2520q%254Az.html%3Fx"; the file is "p qJz.html" [missing-target] /pages/1/0
@/b/Manual/docdata/index.json:1:55: warning: page path "File:y.html" leads to no file: the link is dead [missing-target] /pages/2/0
@/b/Manual/docdata/index.json:1:75: warning: page path "HTTPS://h" gets the module's prefix, and is dead without the page script [prefixed-url] /pages/3/0
@/b/Manual/docdata/index.json:1:93: warning: page path "C#.html" leads to no file: "#" ends its name; rename it [missing-target] /pages/4/0
@/b/Manual/docdata/index.json: note: pages of the set without an entry, which the search does not find: 4, first "C#.html" [unlisted-page]
@/b/Manual/docdata/toc.json:1:47: warning: link "#x" leads to no file: the link is dead [missing-target] /children/0/link
@/b/Manual/docdata/toc.json:1:89: warning: link "q.html#p" leads to no file: the link is dead [missing-target] /children/1/link
2 modules, 0 errors, 10 warnings, status 0)"},
    });
}
