#include "tests/support/CheckCase.h"

#include <gtest/gtest.h>

#include <unistd.h>

TEST(PagemeldCheck, SaysWhatKeepsARunFromWriting)
{
    ExpectReports({
        {"mkfifo b/Manual/docdata/global_toc.json.tmp; cd a/ScriptReference/docdata; "
         "echo >global_toc.json; ln -s global_toc.json global_index.json.tmp; ln global_toc.json "
         "global_index.js.tmp; ln toc.json global_toc.js.tmp; cd @; ln -s /dev/null "
         "c/Manual/docdata/global_toc.js.tmp; "
         "python3 -c 'import socket; "
         "socket.socket(socket.AF_UNIX).bind(\"c/Manual/docdata/global_toc.json.tmp\")'; "
         "CHECK @/a @/b @/c # Nothing keeps outputs from being written",
         {{"b/Manual/docdata/global_toc.js", kDirectory},
          {"b/Manual/docdata/global_index.js.tmp", kDirectory},
          {"a/Manual/docdata/global_index.js.tmp", "x"},
          {"a/Manual/docdata/global_toc.js.tmp", kLink + "a/new"}, // which can be made
          {"b/Manual/docdata/global_index.json.tmp", kLink + "nowhere/new"},
          {"c/Manual/docdata/global_index.js.tmp", kLink + "c/Manual/docdata/global_index.js.tmp"},
          {"a/Manual/docdata/global_toc.js", kLink + "b"}, // the rename replaces it
          {"a/ScriptReference/docdata/index.json", Index(R"(["p.html","P"])")},
          {"a/ScriptReference/docdata/toc.json", Toc("")},
          {"b/ScriptReference/docdata", "a file"}},
         R"(@/a/ScriptReference/docdata/global_index.json.tmp: error: is a link to global_toc.json, which the run overwrites [output-blocked]
@/a/ScriptReference/docdata/global_toc.js.tmp: error: is a link to toc.json, which the run overwrites [output-blocked]
@/b/Manual/docdata/global_index.js.tmp: error: a directory is in the place of the temporary file: the run ends here with status 255, and leaves 1 later module and ScriptReference unwritten [output-blocked]
@/b/Manual/docdata/global_index.json.tmp: error: a link to where no file can be made is in the place of the temporary file: the run keeps the old output [output-blocked]
@/b/Manual/docdata/global_toc.js: error: a directory is in the place of the output: the new one stays as .tmp [output-blocked]
@/b/Manual/docdata/global_toc.json.tmp: error: a pipe is in the place of the temporary file: the run keeps the old output [output-blocked]
@/b/ScriptReference/docdata: error: is not a directory: a run that came so far would end here with status 255 [output-blocked]
@/c/Manual/docdata: note: has neither index.json nor toc.json: the module adds nothing to Manual [set-empty]
@/c/Manual/docdata/global_index.js.tmp: error: a link that leads back to itself is in the place of the temporary file: a run that came so far would end here with status 255 [output-blocked]
@/c/Manual/docdata/global_toc.js.tmp: error: a device is in the place of the temporary file: the run writes into it, and it becomes the output: readers get nothing [output-blocked]
@/c/Manual/docdata/global_toc.json.tmp: error: a socket is in the place of the temporary file: the run keeps the old output [output-blocked]
@/c/ScriptReference/docdata: error: is missing: a run that came so far would end here with status 255 [output-blocked]
3 modules, 11 errors, 0 warnings, status 1)"},
        {"cd a/Manual/docdata; chmod 0 index.json; chmod 500 .; cd @; chmod 400 b/Manual/docdata/*.tmp; "
         "chmod 0 c/Manual/docdata; AS_USER CHECK @/a @/b @/c # What a user may not read or write",
         {{"a/Manual/docdata/global_index.js.tmp", kLink + "new"},
          {"b/Manual/docdata/global_index.js.tmp", ""},
          {"c/Manual/docdata", kDirectory}},
         R"(@/a/Manual/docdata: error: can't be written to: permission denied: the run keeps the old outputs [output-blocked]
@/a/Manual/docdata/index.json: error: can't be read: permission denied; "a" will be missing from the search of Manual [unreadable]
@/b/Manual/docdata/global_index.js.tmp: error: a file that can't be read and written is in the place of the temporary file: the run ends here with status 255, and leaves 1 later module unwritten [output-blocked]
@/c/Manual/docdata: error: can't be written to: permission denied: a run that came so far would end here with status 255 [output-blocked]
@/c/Manual/docdata/index.json: error: can't be reached: permission denied; "c" will be missing from the search of Manual [unreadable]
@/c/Manual/docdata/toc.json: error: can't be reached: permission denied; "c" will be missing from the contents of Manual [unreadable]
3 modules, 6 errors, 0 warnings; missing from the search of Manual: a, c; from its contents: c, status 1)"},
    });
}

TEST(PagemeldCheck, SaysWhatAnotherUserReservesInAStickyDirectory)
{
    if (::geteuid() != 0)
    {
        GTEST_SKIP() << "only root can make files of two users";
    }
    ExpectReports({
        {"chmod 755 @; chmod 1777 */Manual/docdata; chmod 666 */Manual/docdata/*; chown 1 a/Manual/docdata "
         "*/Manual/docdata/global*; chown 2 b/Manual/docdata; setpriv --reuid=2 --clear-groups "
         "CHECK @/a @/b # Its owner may replace all that is in it",
         {{"a/Manual/docdata/global_index.js", ""},
          {"a/Manual/docdata/global_toc.js.tmp", ""},
          {"b/Manual/docdata/global_toc.js", ""}},
         R"(@/a/Manual/docdata/global_index.js: error: the output of another user in a sticky directory can't be replaced: the new one stays as .tmp [output-blocked]
@/a/Manual/docdata/global_toc.js.tmp: error: the temporary file of another user in a sticky directory can't be renamed: the run keeps the old output [output-blocked]
2 modules, 2 errors, 0 warnings, status 1)"},
    });
}

TEST(PagemeldCheck, LooksAtOutputs)
{
    ExpectReports({
        {"CHECK --outputs @/a @/b # Outputs without any inputs stay",
         {{"", kCombined},
          {"a/Manual/docdata/index.json", kGone},
          {"a/Manual/docdata/toc.json", kGone},
          {"b/Manual/docdata/index.json", kGone},
          {"b/Manual/docdata/toc.json", kGone}},
         R"(@/a/Manual/docdata: note: has neither index.json nor toc.json: the module adds nothing to Manual [set-empty]
@/b/Manual/docdata: note: has neither index.json nor toc.json: the module adds nothing to Manual [set-empty]
Manual: error: no module has an index.json or a toc.json, but outputs of an earlier run are there: they stay, and readers see them [nothing-to-combine]
2 modules, 1 error, 0 warnings, status 1)"},
        {"touch -d 2038-01-01Z a/Manual/docdata/toc.json; CHECK -o @/a @/b | head -1 # A date in the future "
         "is "
         "told",
         {{"", kCombined}},
         R"(@/a/Manual/docdata/global_index.js: error: is older than @/a/Manual/docdata/toc.json, which is dated in the future, 2038-01-01 00:00:00 UTC: correct that date, or every output will be older [output-stale], status 0)"},
        {"CHECK --outputs @/b @/a # Scripts are for these modules in these places",
         {{"", kCombined}},
         R"(@/b/Manual/docdata/global_index.js: error: its links were made for other modules, or for other names or places of them: run pagemeld again [wrong-prefixes]
@/b/Manual/docdata/global_toc.js: error: its links were made for other modules, or for other names or places of them: run pagemeld again [wrong-prefixes]
@/a/Manual/docdata/global_index.js: error: its links were made for other modules, or for other names or places of them: run pagemeld again [wrong-prefixes]
@/a/Manual/docdata/global_toc.js: error: its links were made for other modules, or for other names or places of them: run pagemeld again [wrong-prefixes]
2 modules, 4 errors, 0 warnings, status 1)"},
        {"touch -d '1 hour ago' a/Manual/docdata/[it]*.json b/Manual/docdata/index.json "
         "b/Manual/docdata/global_index.js; "
         "CHECK --outputs @/a @/b # Each output is there, whole, equal and newer than the inputs",
         {{"", kCombined},
          {"a/Manual/docdata/global_index.js", "pages = [\n];\ninfo = []\ncommon = {};\n"},
          {"a/Manual/docdata/global_index.json", "{"},
          {"a/Manual/docdata/global_toc.js", kGone},
          {"b/Manual/docdata/global_toc.js", "toc = {\n\""},
          {"b/Manual/docdata/global_toc.json", "{}"},
          {"b/Manual/docdata/global_toc.js.tmp", ""}},
         R"(@/a/Manual/docdata/global_index.js: error: is cut short or broken: readers of the module can't use it [output-broken]
@/a/Manual/docdata/global_index.json: error: is cut short or broken: readers of the module can't use it [output-broken]
@/a/Manual/docdata/global_toc.js: error: is missing: readers of the module can't use it [output-missing]
@/b/Manual/docdata/global_index.js: error: is older than @/b/Manual/docdata/toc.json: readers see an earlier build [output-stale]
@/b/Manual/docdata/global_toc.js: error: is cut short or broken: readers of the module can't use it [output-broken]
@/b/Manual/docdata/global_toc.js.tmp: error: a temporary file is left over: a run was ended, and the output beside it may be old [leftover]
@/b/Manual/docdata/global_toc.json: error: has other content than in @/a: a run ended early, and readers find different things [output-differs]
2 modules, 7 errors, 0 warnings, status 1)"},
        {"mkfifo b/Manual/docdata/toc.json; CHECK -ot @/a @/b # Inputs and outputs are files",
         {{"a/Manual/docdata/index.json", kLink + "a/Manual/docdata/index.json"},
          {"b/Manual/docdata/toc.json", kGone},
          {"b/Manual/docdata/global_toc.js", kDirectory}},
         R"(@/a/Manual/docdata/global_index.js: error: is missing: readers of the module can't use it [output-missing]
@/a/Manual/docdata/global_index.json: error: is missing: readers of the module can't use it [output-missing]
@/a/Manual/docdata/global_toc.js: error: is missing: readers of the module can't use it [output-missing]
@/a/Manual/docdata/global_toc.json: error: is missing: readers of the module can't use it [output-missing]
@/a/Manual/docdata/index.json: error: is a link that leads back to itself; "a" will be missing from the search of Manual [unreadable]
@/a/Manual/docdata/toc.json:1:9: warning: link "toc" leads to no file: the link is dead [missing-target] /link
@/b/Manual/docdata/global_index.js: error: is missing: readers of the module can't use it [output-missing]
@/b/Manual/docdata/global_index.json: error: is missing: readers of the module can't use it [output-missing]
@/b/Manual/docdata/global_toc.js: error: a directory is in the place of the output: the new one stays as .tmp [output-blocked]
@/b/Manual/docdata/global_toc.js: error: is a directory, not a file: readers of the module can't use it [output-missing]
@/b/Manual/docdata/global_toc.json: error: is missing: readers of the module can't use it [output-missing]
@/b/Manual/docdata/toc.json: error: is a pipe, not a file; "b" will be missing from the contents of Manual [unreadable]
2 modules, 11 errors, 1 warning; missing from the search of Manual: a; from its contents: b, status 1)"},
    });
}
