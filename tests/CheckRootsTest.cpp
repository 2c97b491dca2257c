#include "tests/support/CheckCase.h"

#include <gtest/gtest.h>

TEST(PagemeldCheck, FindsModulesAsARunDoes)
{
    ExpectReports({
        {"CHECK --discover=@ # Sound modules have no findings",
         {},
         R"(2 modules, 0 errors, 0 warnings, status 0)"},
        {"CHECK --discover=@/a # A module itself can't be searched for modules",
         {},
         R"(@/a: error: is a module itself: give it as a root: nothing will be combined [no-modules]
0 modules, 1 error, 0 warnings, status 1)"},
        {"CHECK -d @/nowhere # A directory to search exists",
         {},
         R"(@/nowhere: error: is missing: nothing will be combined [no-modules]
0 modules, 1 error, 0 warnings, status 1)"},
        {"CHECK -d @/a/Manual/docdata/toc.json # A directory to search is no file",
         {},
         R"(@/a/Manual/docdata/toc.json: error: is not a directory: nothing will be combined [no-modules]
0 modules, 1 error, 0 warnings, status 1)"},
        {"CHECK -d @/c # Links in circles end, and hold no modules",
         {{"c/d/Manual", kLink + "c"}, {"c/d/e", kLink + "c/d"}, {"c/f", kLink + "c/f"}},
         R"(@/c: error: no directory below it has Manual/docdata: nothing will be combined [no-modules]
0 modules, 1 error, 0 warnings, status 1)"},
        {"CHECK -d @ # What looks like a module and is not taken is named",
         {{"ScriptReference/docdata", kDirectory},
          {"c/.h/ScriptReference/docdata", kDirectory},
          {"c/.i/Manual", kDirectory},
          {"c/k", kLink + "c/.h"},
          {"c/l", kLink + "a"}, // which is found under its own name
          {"c/m", kLink + "a/Manual"},
          {"c/n", kLink + "c/.o"},
          {"c/.o/p/Manual/docdata", kDirectory},
          {"c/r/ScriptReference/docdata", kDirectory},
          {"c/s/ScriptReference/picture.png", ""},
          {"c/t/manual/docdata/index.json", ""},
          {"c/u/Manual/page.html", ""},
          {"c/v/docdata/toc.json", ""},
          {"c/w/Manual/docdata", kDirectory},
          {"c/w/x/y/Manual/docdata", kDirectory},
          {"c/w/x/y/z/Manual/docdata", kDirectory}},
         R"(@/c/w/Manual/docdata: note: has neither index.json nor toc.json: the module adds nothing to Manual [set-empty]
@: warning: is a module itself, which is not looked for: its pages will be missing [passed-over]
@/c/.h: warning: a hidden module is not taken: its pages will be missing [passed-over]
@/c/k: warning: a link to a module is not followed: its pages will be missing [passed-over]
@/c/n: warning: a link to a directory of modules is not followed: their pages will be missing [passed-over]
@/c/r: warning: has ScriptReference/docdata but no Manual/docdata, so it is not taken: its pages will be missing [passed-over]
@/c/t/manual: warning: is not spelled Manual, so it is not taken: its pages will be missing [passed-over]
@/c/u/Manual: warning: has pages but no docdata, so it is not taken: its pages will be missing [passed-over]
@/c/v: warning: has docdata itself, which belongs one level deeper, into a directory Manual: its pages will be missing [passed-over]
@/c/w/x/y: warning: a module inside @/c/w is not looked for: its pages will be missing [passed-over]
3 modules, 0 errors, 9 warnings, status 0)"},
        {"chmod 0 c; AS_USER CHECK -d @ # What may hold modules can be listed",
         {{"c/d", kModule}},
         R"(@/c: warning: can't be listed, so the modules below it are not found [passed-over]
2 modules, 0 errors, 1 warning, status 0)"},
    });
}

TEST(PagemeldCheck, LooksAtRoots)
{
    ExpectReports({
        {"CHECK @/a/Manual # A set is not given as a root",
         {},
         R"(@/a/Manual: error: neither Manual/docdata nor ScriptReference/docdata is found in it: nothing will be combined [no-modules]
1 module, 1 error, 0 warnings, status 1)"},
        {"CHECK @/m1 @/m2 @/a # A root that does not exist is named once, and no links to it",
         {},
         R"(@/m1: error: does not exist: a run ends with status 255 where it comes to its outputs, and later modules stay unwritten [missing-root]
@/m2: error: does not exist: a run ends with status 255 where it comes to its outputs, and later modules stay unwritten [missing-root]
3 modules, 2 errors, 0 warnings, status 1)"},
        {"CHECK @/a/Manual/docdata/toc.json @/nowhere '' # Roots are directories; the empty one is that of "
         "the system",
         {},
         R"(@/a/Manual/docdata/toc.json: error: neither Manual/docdata nor ScriptReference/docdata is found in it, nor in any other root: nothing will be combined [no-modules]
@/nowhere: error: does not exist: a run ends with status 255 where it comes to its outputs, and later modules stay unwritten [missing-root]
3 modules, 2 errors, 0 warnings, status 1)"},
        {"CHECK @/a @/b @/b # A root is given once",
         {},
         R"(@/b: error: is the same directory as @/b: its pages will be in the search twice [duplicate-root]
3 modules, 1 error, 0 warnings, status 1)"},
        {"CHECK @/a @/c # A directory of outputs has one name",
         {{"c", kDirectory}, {"c/Manual", kLink + "a/Manual"}, {"c/ScriptReference", kLink + "a/Manual"}},
         R"(@/a/ScriptReference/docdata: error: is missing: the run ends here with status 255, and leaves 1 later module unwritten [output-blocked]
@/c: error: Manual/docdata is the same directory as @/a/Manual/docdata: the outputs of one replace those of the other [duplicate-root]
@/c: error: ScriptReference/docdata is the same directory as @/a/Manual/docdata: the outputs of one replace those of the other [duplicate-root]
2 modules, 3 errors, 0 warnings, status 1)"},
    });
}

TEST(PagemeldCheck, FollowsLinksFromRootToRoot)
{
    ExpectReports({
        {"CHECK @/n/m1 @/n/m12 @/n/m2/ '@/n/a\\d' '@/n/x\"y' @/n/\xE9 # Links lead from each root to each "
         "other, "
         "whatever their names",
         {{"n/m1", kModule},
          {"n/m12", kModule},
          {"n/m2", kModule},
          {R"(n/a\d)", kModule},
          {"n/x\"y", kModule},
          {"n/\xE9", kModule}},
         R"(@/n/m1: error: links to @/n/a\d and 1 more will lead to @/n/ad/Manual: rename the directory [wrong-link-path]
@/n/m12: error: links to @/n/m1 and 2 more will lead to @/n/m12/Manual: rename m12, which begins with m1 [wrong-link-path]
@/n/m2/: error: links to @/n/m1 and 3 more will lead to @/m1/Manual: give the roots without "/./", "/../", "//" and a slash at the end [wrong-link-path]
@/n/a\d: error: links to @/n/\xE9 will lead elsewhere: rename the directory [wrong-link-path]
@/n/x"y: error: a quote, backslash or line break in the path breaks both scripts of @/n/m1: rename the directory [wrong-link-path]
@/n/\xE9: error: links to @/n/a\d will lead to @/n/ad/Manual: rename the directory [wrong-link-path]
6 modules, 6 errors, 0 warnings, status 1)"},
        {"CHECK @/a @/a# @/b%41 # The page script encodes what else leads elsewhere",
         {{"b%41", kModule}, {"a#", kModule}},
         R"(@/a: error: links to @/a# and 1 more will lead to @/a without the page script: rename the directory [wrong-link-path]
@/a#: error: links to @/a and 1 more will lead to @/a#/Manual: rename a#, which begins with a [wrong-link-path]
@/b%41: error: links to @/a# will lead to @/a without the page script: rename the directory [wrong-link-path]
3 modules, 3 errors, 0 warnings, status 1)"},
        {"CHECK n/./a n/b a # Steps that can be left out are left out, and roots share a directory",
         {{"n/a", kModule}, {"n/b", kModule}},
         R"(n/./a: error: links to n/b will lead to b/Manual: give the roots without "/./", "/../", "//" and a slash at the end [wrong-link-path]
n/b: error: links to a will lead to n/a/Manual: give absolute paths [wrong-link-path]
a: error: links to n/./a and 1 more will lead to a/n/a/Manual: give absolute paths [wrong-link-path]
3 modules, 3 errors, 0 warnings, status 1)"},
        {"CHECK -q @/a @/a/ScriptReference-1 @/ab # Links of both sets are followed, and told once",
         {{"a/ScriptReference/docdata", kDirectory},
          {"a/ScriptReference-1", kModule},
          {"a/ScriptReference-1/ScriptReference/docdata", kDirectory},
          {"ab", kModule},
          {"ab/ScriptReference/docdata", kDirectory}},
         R"(@/a/ScriptReference-1: error: links to @/a will lead to @/a/ScriptReference-1: rename ScriptReference-1, which begins with ScriptReference [wrong-link-path]
@/ab: error: links to @/a and 1 more will lead to @/ab/Manual: rename ab, which begins with a [wrong-link-path], status 1)"},
    });
}
