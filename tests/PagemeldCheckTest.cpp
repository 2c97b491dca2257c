#include "Tools/DocTools/PagemeldCheck/Report/TextReport.h"
#include "tests/support/Files.h"
#include "tests/support/Placeholders.h"
#include "tests/support/Repeated.h"
#include "tests/support/RunProgram.h"

#include <gtest/gtest.h>

#include <atomic>
#include <cctype>
#include <chrono>
#include <filesystem>
#include <regex>
#include <string>
#include <thread>
#include <utility>
#include <vector>

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

// All that the checker prints. Each row of the table has, for some rules, what breaks them, mostly in module
// b, and what comes close and is not reported, mostly in module a.

namespace
{

namespace fs = std::filesystem;

// What is at a path instead of a file.
const std::string kGone = "(gone)";
const std::string kDirectory = "(directory)";
const std::string kPipe = "(pipe)";
const std::string kDevice = "(link to /dev/null)";
const std::string kLink = "(link to) ";
const std::string kOld = "(as it is, but old)";
const std::string kFuture = "(as it is, but of the year 2100)";
const std::string kCombined = "(outputs in both modules)";

struct Change
{
    std::string path;
    std::string content;
};

std::string Index(const std::string& pages,
                  const std::string& rest = R"("info":[],"common":{},"searchIndex":{})")
{
    return R"({"pages":[)" + pages + "]," + rest + "}";
}

std::string Toc(const std::string& children, const std::string& root = R"("link":"toc","title":"toc")")
{
    return "{" + root + R"(,"children":[)" + children + "]}";
}

void Apply(const TemporaryDirectory& directory, const Change& change)
{
    const std::string path = directory / change.path;
    if (change.content == kCombined)
    {
        (void)RunPagemeld(directory, {"@/a", "@/b"});
        return;
    }
    if (change.content == kOld)
    {
        fs::last_write_time(path, fs::file_time_type::clock::now() - std::chrono::hours(1));
        return;
    }
    if (change.content == kFuture)
    {
        constexpr timespec kTimes[] = {{0, UTIME_OMIT}, {4102444800, 0}};
        EXPECT_EQ(0, ::utimensat(AT_FDCWD, path.c_str(), kTimes, 0));
        return;
    }
    fs::create_directories(fs::path(path).parent_path());
    fs::remove(path);
    if (change.content == kDirectory)
    {
        fs::create_directory(path);
    }
    else if (change.content == kDevice)
    {
        fs::create_symlink("/dev/null", path);
    }
    else if (change.content == kPipe)
    {
        EXPECT_EQ(0, ::mkfifo(path.c_str(), 0666));
    }
    else if (change.content.compare(0, kLink.size(), kLink) == 0)
    {
        fs::create_symlink(directory / change.content.substr(kLink.size()), path);
    }
    else if (change.content != kGone)
    {
        WriteFile(path, change.content);
    }
}

/// Two sound modules, a and b.
void WriteSoundModules(const TemporaryDirectory& directory)
{
    for (const char* docdata : {"a/Manual/docdata/", "b/Manual/docdata/"})
    {
        WriteFile(directory / docdata + "index.json", Index(""));
        WriteFile(directory / docdata + "toc.json", Toc(""));
    }
}

/// A run over the sound modules after some changes, and all that it prints.
struct CheckCase
{
    std::vector<std::string> arguments;
    std::vector<Change> changes;
    const char* output;
};

void ExpectReport(const CheckCase& c)
{
    const TemporaryDirectory directory;
    WriteSoundModules(directory);
    for (const Change& change : c.changes)
    {
        Apply(directory, change);
    }
    EXPECT_EQ(c.output, RunPagemeldCheck(directory, c.arguments)) << c.arguments.back();
}

} // namespace

TEST(PagemeldCheck, ReportsWhatBreaksARuleAndNotWhatComesClose)
{
    const CheckCase cases[] = {
        {{"--discover=@"},
         {},
         R"(2 modules, 0 errors, 0 warnings
status 0
)"},
        {{"--discover=@/a"},
         {},
         R"(@/a: error: is a module itself: give it as a root: nothing will be combined [no-modules]
0 modules, 1 error, 0 warnings
status 1
)"},
        {{"-d", "@/nowhere"}, {}, R"(@/nowhere: error: is missing: nothing will be combined [no-modules]
0 modules, 1 error, 0 warnings
status 1
)"},
        {{"-d", "@/a/Manual/docdata/toc.json"}, {}, R"(@/a/Manual/docdata/toc.json: error: is not a directory: nothing will be combined [no-modules]
0 modules, 1 error, 0 warnings
status 1
)"},
        {{"@/a/Manual"},
         {},
         R"(@/a/Manual: error: neither Manual/docdata nor ScriptReference/docdata is found in it: nothing will be combined [no-modules]
1 module, 1 error, 0 warnings
status 1
)"},
        {{"@/a", "@/c"},
         {{"c", kDirectory}, {"c/Manual", kLink + "a/Manual"}, {"c/ScriptReference", kLink + "a/Manual"}},
         R"(@/a/ScriptReference/docdata: error: is missing: the run ends here with status 255, and leaves 1 later module unwritten [output-blocked]
@/c: error: Manual/docdata is the same directory as @/a/Manual/docdata: the outputs of one replace those of the other [duplicate-root]
@/c: error: ScriptReference/docdata is the same directory as @/a/Manual/docdata: the outputs of one replace those of the other [duplicate-root]
2 modules, 3 errors, 0 warnings
status 1
)"},
        {{"@/a", "@/b", "@/b"},
         {},
         R"(@/b: error: is the same directory as @/b: its pages will be in the search twice [duplicate-root]
3 modules, 1 error, 0 warnings
status 1
)"},
        {{"-d", "@"},
         {{"c/.h/ScriptReference/docdata", kDirectory},
          {"c/.i/Manual", kDirectory},
          {"c/l", kLink + "a"}, // which is found under its own name
          {"c/m", kLink + "a/Manual"},
          {"c/n", kLink + "c/.o"},
          {"c/.o/p/Manual/docdata", kDirectory},
          {"c/r/ScriptReference/docdata", kDirectory},
          {"c/s/ScriptReference", kDirectory},
          {"c/t/manual/docdata/index.json", ""},
          {"c/u/Manual/page.html", ""},
          {"c/v/docdata/toc.json", ""},
          {"c/w/Manual/docdata", kDirectory},
          {"c/w/x/y/Manual/docdata", kDirectory},
          {"c/w/x/y/z/Manual/docdata", kDirectory}},
         R"(@/c/w/Manual/docdata: note: has neither index.json nor toc.json: the module adds nothing to Manual [set-empty]
@/c/.h: warning: a hidden module is not taken: its pages will be missing [passed-over]
@/c/n: warning: a link to a directory of modules is not followed: their pages will be missing [passed-over]
@/c/r: warning: has ScriptReference/docdata but no Manual/docdata, so it is not taken: its pages will be missing [passed-over]
@/c/t/manual: warning: is not spelled Manual, so it is not taken: its pages will be missing [passed-over]
@/c/u/Manual: warning: has pages but no docdata, so it is not taken: its pages will be missing [passed-over]
@/c/v: warning: has docdata itself, which belongs one level deeper, into a directory Manual: its pages will be missing [passed-over]
@/c/w/x/y: warning: a module inside @/c/w is not looked for: its pages will be missing [passed-over]
3 modules, 0 errors, 7 warnings
status 0
)"},
        {{"@/a", "@/b", "@/c"},
         {{"b/Manual/docdata/global_toc.js", kDirectory},
          {"b/Manual/docdata/global_toc.json.tmp", kPipe},
          {"b/Manual/docdata/global_index.js.tmp", kDirectory},
          {"a/Manual/docdata/global_index.js.tmp", "x"},
          {"a/Manual/docdata/global_toc.js.tmp", kLink + "a/new"}, // which can be made
          {"b/Manual/docdata/global_index.json.tmp", kLink + "nowhere/new"},
          {"c/Manual/docdata/global_index.js.tmp", kLink + "c/Manual/docdata/global_index.js.tmp"},
          {"c/Manual/docdata/global_toc.js.tmp", kDevice},
          {"a/Manual/docdata/global_toc.js", kLink + "b"}, // the rename replaces it
          {"a/ScriptReference/docdata/index.json", Index(R"(["p.html","P"])")},
          {"a/ScriptReference/docdata/toc.json", Toc("")},
          {"b/ScriptReference/docdata", "a file"}},
         R"(@/b/Manual/docdata/global_index.js.tmp: error: a directory is in the place of the temporary file: the run ends here with status 255, and leaves 1 later module and ScriptReference unwritten [output-blocked]
@/b/Manual/docdata/global_index.json.tmp: error: a link to where no file can be made is in the place of the temporary file: the run keeps the old output [output-blocked]
@/b/Manual/docdata/global_toc.js: error: a directory is in the place of the output: the new one stays as .tmp [output-blocked]
@/b/Manual/docdata/global_toc.json.tmp: error: a pipe is in the place of the temporary file: the run keeps the old output [output-blocked]
@/b/ScriptReference/docdata: error: is not a directory: a run that came so far would end here with status 255 [output-blocked]
@/c/Manual/docdata: note: has neither index.json nor toc.json: the module adds nothing to Manual [set-empty]
@/c/Manual/docdata/global_index.js.tmp: error: a link that leads back to itself is in the place of the temporary file: a run that came so far would end here with status 255 [output-blocked]
@/c/Manual/docdata/global_toc.js.tmp: error: a device is in the place of the temporary file: the run writes into it, and it becomes the output: readers get nothing [output-blocked]
@/c/ScriptReference/docdata: error: is missing: a run that came so far would end here with status 255 [output-blocked]
3 modules, 8 errors, 0 warnings
status 1
)"},
        {{"@/n/m1", "@/n/m12", "@/n/m2/", R"(@/n/a\d)", R"(@/n/x"y)", "@/n/\xE9"},
         {{"n/m1/Manual/docdata/index.json", Index("")},
          {"n/m1/Manual/docdata/toc.json", Toc("")},
          {"n/m12/Manual/docdata", kDirectory},
          {"n/m2/Manual/docdata", kDirectory},
          {R"(n/a\d/Manual/docdata)", kDirectory},
          {"n/x\"y/Manual/docdata", kDirectory},
          {"n/\xE9/Manual/docdata", kDirectory}},
         R"(@/n/m1: error: links to @/n/a\d and 1 more will lead to @/n/ad/Manual: rename the directory [wrong-link-path]
@/n/m12: error: links to @/n/m1 and 2 more will lead to @/n/m12/Manual: one name begins with the other: rename one [wrong-link-path]
@/n/m12/Manual/docdata: note: has neither index.json nor toc.json: the module adds nothing to Manual [set-empty]
@/n/m2/: error: links to @/n/m1 and 3 more will lead to @/m1/Manual: give the roots without a slash at the end [wrong-link-path]
@/n/m2//Manual/docdata: note: has neither index.json nor toc.json: the module adds nothing to Manual [set-empty]
@/n/a\d: error: links to @/n/\xE9 will lead elsewhere: rename the directory [wrong-link-path]
@/n/a\d/Manual/docdata: note: has neither index.json nor toc.json: the module adds nothing to Manual [set-empty]
@/n/x"y: error: a quote, backslash or line break in the path breaks both scripts of @/n/m1: rename the directory [wrong-link-path]
@/n/x"y/Manual/docdata: note: has neither index.json nor toc.json: the module adds nothing to Manual [set-empty]
@/n/\xE9: error: links to @/n/a\d will lead to @/n/ad/Manual: rename the directory [wrong-link-path]
@/n/\xE9/Manual/docdata: note: has neither index.json nor toc.json: the module adds nothing to Manual [set-empty]
6 modules, 6 errors, 0 warnings
status 1
)"},
        {{"@/a", "@/b%41", "@/c#"},
         {{"b%41/Manual/docdata", kDirectory}, {"c#/Manual/docdata", kDirectory}},
         R"(@/a: error: links to @/b%41 and 1 more will lead to @/bA/Manual without the page script: rename the directory [wrong-link-path]
@/b%41: error: links to @/c# will lead to @/c without the page script: rename the directory [wrong-link-path]
@/b%41/Manual/docdata: note: has neither index.json nor toc.json: the module adds nothing to Manual [set-empty]
@/c#: error: links to @/b%41 will lead to @/bA/Manual without the page script: rename the directory [wrong-link-path]
@/c#/Manual/docdata: note: has neither index.json nor toc.json: the module adds nothing to Manual [set-empty]
3 modules, 3 errors, 0 warnings
status 1
)"},
        {{"@/n/./a", "@/n/b"},
         {{"n/a/Manual/docdata", kDirectory}, {"n/b/Manual/docdata", kDirectory}},
         R"(@/n/./a: error: links to @/n/b will lead to @/b/Manual: give the roots without "/./", "/../" and "//" [wrong-link-path]
@/n/./a/Manual/docdata: note: has neither index.json nor toc.json: the module adds nothing to Manual [set-empty]
@/n/b/Manual/docdata: note: has neither index.json nor toc.json: the module adds nothing to Manual [set-empty]
2 modules, 1 error, 0 warnings
status 1
)"},
        {{"@/a", "@/a/ScriptReference-1"}, // one name begins with the other, in one of the sets
         {{"a/ScriptReference/docdata", kDirectory},
          {"a/ScriptReference-1/Manual/docdata", kDirectory},
          {"a/ScriptReference-1/ScriptReference/docdata", kDirectory}},
         R"(@/a/ScriptReference/docdata: note: has neither index.json nor toc.json: the module adds nothing to ScriptReference [set-empty]
@/a/ScriptReference-1: error: links to @/a will lead to @/a/ScriptReference-1: one name begins with the other: rename one [wrong-link-path]
@/a/ScriptReference-1/Manual/docdata: note: has neither index.json nor toc.json: the module adds nothing to Manual [set-empty]
@/a/ScriptReference-1/ScriptReference/docdata: note: has neither index.json nor toc.json: the module adds nothing to ScriptReference [set-empty]
2 modules, 1 error, 0 warnings
status 1
)"},
        {{"@/m1", "@/m2", "@/a"},
         {},
         R"(@/m1: error: does not exist: a run ends with status 255 where it comes to its outputs, and later modules stay unwritten [missing-root]
@/m2: error: does not exist: a run ends with status 255 where it comes to its outputs, and later modules stay unwritten [missing-root]
3 modules, 2 errors, 0 warnings
status 1
)"},
        {{"@/a", "@/b", "@/c"},
         {{"a/Manual/docdata/toc.json", kDirectory},
          {"b/Manual/docdata/index.json", kGone},
          {"c/Manual/docdata/index.json", Index(R"(["p.html","P"])")},
          {"c/Manual/docdata/toc.json", kLink + "nowhere"}},
         R"(@/a/Manual/docdata/toc.json: error: is a directory, not a file; "a" will be missing from the contents of Manual [unreadable]
@/b/Manual/docdata/index.json: error: is missing beside toc.json; "b" will be missing from the search of Manual [unreadable]
@/c/Manual/docdata/toc.json: error: is a link to what does not exist; "c" will be missing from the contents of Manual [unreadable]
3 modules, 3 errors, 0 warnings; missing from the search of Manual: b; from its contents: a, c
status 1
)"},
        {{"@/a", "@/b"},
         {{"b/Manual/docdata/index.json", kGone},
          {"b/Manual/docdata/toc.json", kGone},
          {"b/ScriptReference/docdata", kDirectory}},
         R"(@/b/Manual/docdata: note: has neither index.json nor toc.json: the module adds nothing to Manual [set-empty]
@/b/ScriptReference/docdata: note: has neither index.json nor toc.json: the module adds nothing to ScriptReference [set-empty]
2 modules, 0 errors, 0 warnings
status 0
)"},
        {{"@/a", "@/b"},
         {{"a/Manual/docdata/toc.json", kGone}, {"b/Manual/docdata/toc.json", "[]"}},
         R"(@/a/Manual/docdata/toc.json: error: is missing beside index.json; "a" will be missing from the contents of Manual [unreadable]
@/b/Manual/docdata/toc.json:1:1: error: node is an array of 0, not an object; "b" will be missing from the contents of Manual [structure]
Manual: error: no module has a sound toc.json: nothing will be written, and earlier outputs stay [nothing-to-combine]
2 modules, 3 errors, 0 warnings; missing from the contents of Manual: a, b
status 1
)"},
        {{"@/a", "@/b", "@/c"},
         {{"a/Manual/docdata/index.json", "{\"pages\":[],\n\"info\":[1,]}"},
          {"a/Manual/docdata/toc.json", "\357\273\277{}"},
          {"b/Manual/docdata/index.json", "{'pages':[]}"},
          {"b/Manual/docdata/toc.json", R"({"link":"a\q"})"},
          {"c/Manual/docdata/index.json", Index(R"(["p.html","P"])")},
          {"c/Manual/docdata/toc.json", ""}},
         R"(@/a/Manual/docdata/index.json:2:11: error: not JSON: there is a comma before the closing bracket; refused at byte 23, at "]}"; "a" will be missing from the search of Manual [not-json]
@/a/Manual/docdata/toc.json:1:1: error: not JSON: the file begins with a byte order mark: save it without; refused at byte 0, at "\uFEFF{}"; "a" will be missing from the contents of Manual [not-json]
@/b/Manual/docdata/index.json:1:2: error: not JSON: strings need double quotes; refused at byte 1, at "'pages':[]}"; "b" will be missing from the search of Manual [not-json]
@/b/Manual/docdata/toc.json:1:11: error: not JSON: a backslash in a string must be doubled; refused at byte 10, at "\\q\"}"; "b" will be missing from the contents of Manual [not-json]
@/c/Manual/docdata/toc.json:1:1: error: not JSON: the file is empty; refused at byte 0, at the end of the text; "c" will be missing from the contents of Manual [not-json]
Manual: error: no module has a sound toc.json: nothing will be written, and earlier outputs stay [nothing-to-combine]
3 modules, 6 errors, 0 warnings; missing from the search of Manual: a, b; from its contents: a, b, c
status 1
)"},
        {{"@/a"},
         {{"a/Manual/docdata/index.json", std::string("{\000\"\000", 4)}},
         R"(@/a/Manual/docdata/index.json:1:2: warning: a NUL byte ends the text; bytes after it that are not seen: 2 [text-after-nul]
@/a/Manual/docdata/index.json:1:2: error: not JSON: the file is in UTF-16: save it as UTF-8; refused at byte 1, at the end of the text; "a" will be missing from the search of Manual [not-json]
Manual: error: no module has a sound index.json: nothing will be written, and earlier outputs stay [nothing-to-combine]
1 module, 2 errors, 1 warning; missing from the search of Manual: a
status 1
)"},
        {{"@/a", "@/b"},
         {{"b/Manual/docdata/index.json",
           Index(
               R"(["a","A"],[],["b",7],["c","C",1.0])",
               R"("info":[["i",0],["i",4],["i",-1],["i","x"],[1,2]],"common":{"a":1,"b":2},"searchIndex":{"a/b":{},"t":[0,5,"1"]})")},
          {"b/Manual/docdata/toc.json",
           "{\"link\":7,\n\"children\":[{\"link\":\"l\",\"title\":\"t\",\"children\":{}},7]}"}},
         R"(@/b/Manual/docdata/index.json:1:21: error: page entry is an array of 0, not [path, title]; "b" will be missing from the search of Manual [structure] /pages/1
@/b/Manual/docdata/index.json:1:24: error: page path or title is 7, not a string; "b" will be missing from the search of Manual [structure] /pages/2
@/b/Manual/docdata/index.json:1:32: error: page entry is an array of 3, not [path, title]; "b" will be missing from the search of Manual [structure] /pages/3
@/b/Manual/docdata/index.json:1:63: error: page number 4, but there are 4 pages; "b" will be missing from the search of Manual [structure] /info/1
@/b/Manual/docdata/index.json:1:71: error: page number -1, but there are 4 pages; "b" will be missing from the search of Manual [structure] /info/2
@/b/Manual/docdata/index.json:1:80: error: page number is "x", not a 32-bit integer; "b" will be missing from the search of Manual [structure] /info/3
@/b/Manual/docdata/index.json:1:90: error: text is 1, not a string; "b" will be missing from the search of Manual [structure] /info/4
@/b/Manual/docdata/index.json:1:117: error: common word has the value 2, not 1; "b" will be missing from the search of Manual [structure] /common/b
@/b/Manual/docdata/index.json:1:141: error: term has an object of 0, not an array of info numbers; "b" will be missing from the search of Manual [structure] /searchIndex/a~1b
@/b/Manual/docdata/index.json:1:151: error: info number 5, but there are 5 infos; "b" will be missing from the search of Manual [structure] /searchIndex/t/1
@/b/Manual/docdata/index.json: error: 1 more of this rule; --limit=0 shows all [structure]
@/b/Manual/docdata/toc.json:1:1: error: "title" is missing; it must be a string; "b" will be missing from the contents of Manual [structure]
@/b/Manual/docdata/toc.json:1:9: error: "link" is 7, not a string; "b" will be missing from the contents of Manual [structure] /link
@/b/Manual/docdata/toc.json:2:48: error: "children" is an object of 0, not an array or null; "b" will be missing from the contents of Manual [structure] /children/0/children
@/b/Manual/docdata/toc.json:2:52: error: node is 7, not an object; "b" will be missing from the contents of Manual [structure] /children/1
2 modules, 15 errors, 0 warnings; missing from the search of Manual: b; from its contents: b
status 1
)"},
        {{"@/a", "@/b"},
         {{"b/Manual/docdata/index.json", R"({"pages":{},"info":[["i",9]],"common":{}})"},
          {"b/Manual/docdata/toc.json", "7"}},
         R"(@/b/Manual/docdata/index.json:1:1: error: "searchIndex" is missing; it must be an object; "b" will be missing from the search of Manual [structure]
@/b/Manual/docdata/index.json:1:10: error: "pages" is an object of 0, not an array; "b" will be missing from the search of Manual [structure] /pages
@/b/Manual/docdata/toc.json:1:1: error: node is 7, not an object; "b" will be missing from the contents of Manual [structure]
2 modules, 3 errors, 0 warnings; missing from the search of Manual: b; from its contents: b
status 1
)"},
        {{"@/a", "@/b"},
         {{"a/Manual/docdata/index.json", Index(R"(["module","0"])")},
          {"a/Manual/docdata/toc.json", Toc(R"({"link":"module","title":"A","modules":1,"children":null})")},
          {"b/Manual/docdata/index.json", Index(R"(["p","P"],["p","P",0],["q","Q",1])")},
          {"b/Manual/docdata/toc.json",
           Toc(R"({"link":"b","title":"B","children":[{"link":"d","title":"D","module":1,"children":null}]},{"link":"c","title":"C","module":2,"children":null})")}},
         R"(@/b/Manual/docdata/index.json:1:21: error: this is an output: the page entry names its module, 0; "b" will be missing from the search of Manual [merged-input] /pages/1
@/b/Manual/docdata/toc.json:1:77: error: this is an output: the node names its module, 1; its links will lead to that module [merged-input] /children/0/children/0
2 modules, 2 errors, 0 warnings; missing from the search of Manual: b
status 1
)"},
        {{"@/a", "@/b", "@/c"},
         {{"b/Manual/docdata/toc.json", Toc("", R"("link":"toc","title":"x")")},
          {"c/Manual/docdata/index.json", Index(R"(["p.html","P"])")},
          {"c/Manual/docdata/toc.json", Toc("", R"("link":"toc","title":"toc\u0000x")")}},
         R"(@/b/Manual/docdata/toc.json:1:23: error: root title "x" differs from "toc" of @/a; "b" will be missing from the contents of Manual [root-differs] /title
@/c/Manual/docdata/toc.json:1:23: warning: title "toc\x00x" is "toc" in global_toc.js: readers see that [script-altered] /title
3 modules, 1 error, 1 warning; missing from the contents of Manual: b
status 1
)"},
        {{"@/a", "@/b", "@/c"},
         {{"a/Manual/docdata/toc.json", Toc("", R"("link":"x","title":"x")")},
          {"c/Manual/docdata/index.json", Index(R"(["p.html","P"])")},
          {"c/Manual/docdata/toc.json", Toc("")}},
         R"(@/a/Manual/docdata/toc.json:1:9: error: root link "x" differs from "toc" of 2 other modules; it comes first, so they are dropped from the contents of Manual: "b", "c" [root-differs] /link
3 modules, 1 error, 0 warnings; missing from the contents of Manual: b, c
status 1
)"},
        {{"@/a", "@/b"},
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
2 modules, 4 errors, 0 warnings
status 1
)"},
        {{"@/a", "@/b"},
         {{"a/Manual/docdata/index.json", Index(R"(["a.html","C:/new"])")},
          {"b/Manual/docdata/index.json", Index(R"(["a.html","C:\\new"])")},
          {"b/Manual/docdata/toc.json", Toc(R"({"link":"a\u0000.html","title":"A","children":null})")}},
         R"(@/b/Manual/docdata/index.json:1:21: warning: title "C:\\new" of page "a.html" is "C:\new" in global_index.js: readers see that [script-altered] /pages/0/1
@/b/Manual/docdata/toc.json:1:49: warning: link "a\x00.html" is "a" in global_toc.js: readers are led there [script-altered] /children/0/link
2 modules, 0 errors, 2 warnings
status 0
)"},
        {{"@/a", "@/b"},
         {{"a/Manual/docdata/index.json", Index(R"(["std::list.html","A"])")},
          {"a/Manual/docdata/toc.json", Toc(R"({"link":"x/a:b.html","title":"A","children":null})")},
          {"b/Manual/docdata/index.json", Index(R"(["https://h/a","A"])")},
          {"b/Manual/docdata/toc.json",
           Toc(R"({"link":"mailto:a","title":"A","children":null},{"link":"File:a","title":"B","children":null})")}},
         R"(@/b/Manual/docdata/index.json:1:12: warning: page path "https://h/a" gets the module's prefix, and is dead without the page script [prefixed-url] /pages/0/0
@/b/Manual/docdata/toc.json:1:49: warning: link "mailto:a" gets the module's prefix, and is dead without the page script [prefixed-url] /children/0/link
@/b/Manual/docdata/toc.json:1:97: warning: link "File:a" gets the module's prefix, and is dead unless a file has that name, which --targets checks [prefixed-url] /children/1/link
2 modules, 0 errors, 3 warnings
status 0
)"},
        {{"@/a", "@/b"},
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
@/b/Manual/docdata/index.json:1:98: warning: terms that readers can't find by the whole word, since words are looked up as letters, digits and _ in lower case: 4, first "a b" [unfound-term] /searchIndex/a b
@/b/Manual/docdata/index.json:1:133: warning: "pages" is there twice: this one is ignored [doubled-member] /pages
@/b/Manual/docdata/toc.json:1:36: warning: "link" is there twice: this one is ignored [doubled-member] /link
Manual: note: the common words of "a" count for all modules; those that differ are ignored, of "b" [common-ignored]
2 modules, 0 errors, 6 warnings
status 0
)"},
        {{"@/b", "@/a"},
         {{"b/Manual/docdata/index.json",
           Index("", R"("info":[],"common":{"__proto__":1,"__proto__":1},"searchIndex":{})")}},
         R"(@/b/Manual/docdata/index.json:1:45: warning: common word "__proto__" sets a prototype in the scripts: readers do not find it [special-term] /common/__proto__
@/b/Manual/docdata/index.json:1:59: error: common word "__proto__" twice breaks global_index.js in every module [script-broken] /common/__proto__
2 modules, 1 error, 1 warning
status 1
)"},
        {{"@/a", "@/b"},
         {{"a/Manual/docdata/index.json", Index("[\"p.html\",\"\303\251\"]")},
          {"a/Manual/docdata/toc.json",
           std::string("{\"link\":\"toc\",\"title\":\"toc\",\"children\":[]}\000", 43)},
          {"b/Manual/docdata/index.json", Index("[\"p.html\",\"\351\351\"]")},
          {"b/Manual/docdata/toc.json",
           std::string("{\"link\":\"toc\",\"title\":\"toc\",\"children\":[]}\000\351", 44)}},
         R"(@/b/Manual/docdata/index.json:1:22: warning: byte \xE9 is not UTF-8: readers see a replacement character [invalid-utf8]
@/b/Manual/docdata/toc.json:1:43: warning: a NUL byte ends the text; bytes after it that are not seen: 1 [text-after-nul]
2 modules, 0 errors, 2 warnings
status 0
)"},
        {{"@/a", "@/b", "@/c"},
         {{"a/Manual/docdata/index.json", Index("", R"("info":[],"common":{"a":1,"b":1},"searchIndex":{})")},
          {"b/Manual/docdata/index.json", Index("", R"("info":[],"common":{"b":1,"a":1},"searchIndex":{})")},
          {"c/Manual/docdata/index.json", Index("", R"("info":[],"common":{"a":1},"searchIndex":{})")},
          {"c/Manual/docdata/toc.json", Toc("")}},
         R"(Manual: note: the common words of "a" count for all modules; those that differ are ignored, of "c" [common-ignored]
3 modules, 0 errors, 0 warnings
status 0
)"},
        {{"--targets", "@/a", "@/b"},
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
2 modules, 0 errors, 10 warnings
status 0
)"},
        {{"@/a", "@/b", "@/c"},
         {{"a/Manual/docdata/toc.json",
           Toc(R"({"link":"o","title":"O","children":[{"link":"p","title":"P","children":null}]},{"link":"null","title":"G","children":[{"link":"q","title":"Q","children":null}]},{"link":"null","title":"G","children":[{"link":"r","title":"R","children":null}]})")},
          {"b/Manual/docdata/toc.json",
           Toc(R"({"link":"o","title":"O","children":[{"link":"p","title":"P","children":null}]},{"link":"o","title":"P","children":null},{"link":"null","title":"G","children":[{"link":"r","title":"R","children":null},{"link":"q\u0000","title":"Q","children":null},{"link":"s","title":"S","children":null},{"link":"s","title":"S","children":null}]})")},
          {"c/Manual/docdata/index.json", Index("")},
          {"c/Manual/docdata/toc.json",
           Toc(R"({"link":"null","title":"G","children":[{"link":"s","title":"S","children":null}]})")}},
         R"(@/b/Manual/docdata/toc.json:1:41: warning: "a" has the same entry, "O" with the link "o": in the contents it leads to the page of "a", and not to this module's [shadowed-entry] /children/0
@/b/Manual/docdata/toc.json:1:241: warning: "a" has the same entry, "Q" with the link "q\x00": in the contents it leads to the page of "a", and not to this module's [shadowed-entry] /children/2/children/1
@/b/Manual/docdata/toc.json:1:249: warning: link "q\x00" is "q" in global_toc.js: readers are led there [script-altered] /children/2/children/1/link
@/c/Manual/docdata/toc.json:1:80: warning: "b" has the same entry, "S" with the link "s": in the contents it leads to the page of "b", and not to this module's [shadowed-entry] /children/0/children/0
3 modules, 0 errors, 4 warnings
status 0
)"},
        {{"--outputs", "@/a", "@/b"},
         {{"", kCombined},
          {"a/Manual/docdata/index.json", kGone},
          {"a/Manual/docdata/toc.json", kGone},
          {"b/Manual/docdata/index.json", kGone},
          {"b/Manual/docdata/toc.json", kGone}},
         R"(@/a/Manual/docdata: note: has neither index.json nor toc.json: the module adds nothing to Manual [set-empty]
@/b/Manual/docdata: note: has neither index.json nor toc.json: the module adds nothing to Manual [set-empty]
Manual: error: no module has an index.json or a toc.json, but outputs of an earlier run are there: they stay, and readers see them [nothing-to-combine]
2 modules, 1 error, 0 warnings
status 1
)"},
        {{"--outputs", "@/a", "@/b"}, {{"", kCombined}, {"a/Manual/docdata/toc.json", kFuture}}, R"(@/a/Manual/docdata/global_index.js: error: is older than @/a/Manual/docdata/toc.json, which is dated in the future, 2100-01-01 00:00:00 UTC: correct that date, or every output will be older [output-stale]
@/a/Manual/docdata/global_index.json: error: is older than @/a/Manual/docdata/toc.json, which is dated in the future, 2100-01-01 00:00:00 UTC: correct that date, or every output will be older [output-stale]
@/a/Manual/docdata/global_toc.js: error: is older than @/a/Manual/docdata/toc.json, which is dated in the future, 2100-01-01 00:00:00 UTC: correct that date, or every output will be older [output-stale]
@/a/Manual/docdata/global_toc.json: error: is older than @/a/Manual/docdata/toc.json, which is dated in the future, 2100-01-01 00:00:00 UTC: correct that date, or every output will be older [output-stale]
@/b/Manual/docdata/global_index.js: error: is older than @/a/Manual/docdata/toc.json, which is dated in the future, 2100-01-01 00:00:00 UTC: correct that date, or every output will be older [output-stale]
@/b/Manual/docdata/global_index.json: error: is older than @/a/Manual/docdata/toc.json, which is dated in the future, 2100-01-01 00:00:00 UTC: correct that date, or every output will be older [output-stale]
@/b/Manual/docdata/global_toc.js: error: is older than @/a/Manual/docdata/toc.json, which is dated in the future, 2100-01-01 00:00:00 UTC: correct that date, or every output will be older [output-stale]
@/b/Manual/docdata/global_toc.json: error: is older than @/a/Manual/docdata/toc.json, which is dated in the future, 2100-01-01 00:00:00 UTC: correct that date, or every output will be older [output-stale]
2 modules, 8 errors, 0 warnings
status 1
)"},
        {{"--outputs", "@/a", "@/b"},
         {{"", kCombined}},
         R"(2 modules, 0 errors, 0 warnings
status 0
)"},
        {{"--outputs", "@/a", "@/b"},
         {{"", kCombined},
          {"a/Manual/docdata/global_index.js", "pages = [\n];\ninfo = []\ncommon = {};\n"},
          {"a/Manual/docdata/global_index.json", "{"},
          {"a/Manual/docdata/global_toc.js", kGone},
          {"b/Manual/docdata/global_toc.js", "toc = {\n\""},
          {"b/Manual/docdata/global_toc.json", "{}"},
          {"b/Manual/docdata/global_toc.js.tmp", ""},
          {"b/Manual/docdata/global_index.js", kOld}},
         R"(@/a/Manual/docdata/global_index.js: error: is cut short or broken: readers of the module can't use it [output-broken]
@/a/Manual/docdata/global_index.json: error: is cut short or broken: readers of the module can't use it [output-broken]
@/a/Manual/docdata/global_toc.js: error: is missing: readers of the module can't use it [output-missing]
@/b/Manual/docdata/global_index.js: error: is older than @/b/Manual/docdata/toc.json: readers see an earlier build [output-stale]
@/b/Manual/docdata/global_toc.js: error: is cut short or broken: readers of the module can't use it [output-broken]
@/b/Manual/docdata/global_toc.js.tmp: error: a temporary file is left over: a run was ended, and the output beside it may be old [leftover]
@/b/Manual/docdata/global_toc.json: error: has other content than in @/a: a run ended early, and readers find different things [output-differs]
2 modules, 7 errors, 0 warnings
status 1
)"},
        {{"-n", "1", "@/a", "@/b"},
         {{"b/Manual/docdata/index.json", Index("1,2,\"\351\"")}},
         R"(@/b/Manual/docdata/index.json:1:11: error: page entry is 1, not [path, title]; "b" will be missing from the search of Manual [structure] /pages/0
@/b/Manual/docdata/index.json:1:16: warning: byte \xE9 is not UTF-8: readers see a replacement character [invalid-utf8]
@/b/Manual/docdata/index.json: error: 2 more of this rule; --limit=0 shows all [structure]
2 modules, 3 errors, 1 warning; missing from the search of Manual: b
status 1
)"},
        {{"-n", "1", "-f", "json", "@/a", "@/b"},
         {{"b/Manual/docdata/index.json", Index("1,2,3")}},
         R"({"level":"error","rule":"structure","file":"@/b/Manual/docdata/index.json","line":1,"column":11,"offset":10,"pointer":"/pages/0","module":"@/b","set":"Manual","message":"page entry is 1, not [path, title]; \"b\" will be missing from the search of Manual"}
{"level":"error","rule":"structure","file":"@/b/Manual/docdata/index.json","module":"@/b","set":"Manual","more":2,"message":"2 more of this rule; --limit=0 shows all"}
{"summary":{"modules":2,"errors":3,"warnings":0,"notes":0,"missing":{"Manual":{"search":["@/b"],"contents":[]},"ScriptReference":{"search":[],"contents":[]}}}}
status 1
)"},
        {{"--quiet", "@/a", "@/b"},
         {{"b/Manual/docdata/index.json",
           Index("", R"("info":[],"common":{},"searchIndex":{"__proto__":[]})")},
          {"b/Manual/docdata/toc.json", kGone}},
         R"(@/b/Manual/docdata/toc.json: error: is missing beside index.json; "b" will be missing from the contents of Manual [unreadable]
status 1
)"},
        {{"-qW", "@/a", "@/b"},
         {{"b/Manual/docdata/index.json",
           Index("", R"("info":[],"common":{},"searchIndex":{"__proto__":[]})")}},
         R"(@/b/Manual/docdata/index.json:1:62: warning: term "__proto__" sets a prototype in the scripts: readers do not find it [special-term] /searchIndex/__proto__
status 1
)"},
        {{"-f", "json", "@/a", "@/b", "@/a"},
         {{"a/Manual/docdata/index.json", Index("", R"("info":[],"common":{"a":1},"searchIndex":{})")},
          {"b/Manual/docdata/index.json",
           Index(R"(["p",7])", R"("info":[],"common":{"b":1},"searchIndex":{})")},
          {"b/Manual/docdata/toc.json", "[]"},
          {"b/ScriptReference/docdata", kDirectory}},
         R"({"level":"error","rule":"structure","file":"@/b/Manual/docdata/index.json","line":1,"column":11,"offset":10,"pointer":"/pages/0","module":"@/b","set":"Manual","message":"page path or title is 7, not a string; \"b\" will be missing from the search of Manual"}
{"level":"error","rule":"structure","file":"@/b/Manual/docdata/toc.json","line":1,"column":1,"offset":0,"pointer":"","module":"@/b","set":"Manual","message":"node is an array of 0, not an object; \"b\" will be missing from the contents of Manual"}
{"level":"note","rule":"set-empty","file":"@/b/ScriptReference/docdata","module":"@/b","set":"ScriptReference","message":"has neither index.json nor toc.json: the module adds nothing to ScriptReference"}
{"level":"error","rule":"duplicate-root","file":"@/a","module":"@/a","message":"is the same directory as @/a: its pages will be in the search twice"}
{"summary":{"modules":3,"errors":3,"warnings":0,"notes":1,"missing":{"Manual":{"search":["@/b"],"contents":["@/b"]},"ScriptReference":{"search":[],"contents":[]}}}}
status 1
)"},
        {{"-f", "json", "@/a", "@/b"},
         {{"b/Manual/docdata/index.json", Index("[\"p.html\","
                                                "\"\351\\n\\\"xxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxx"
                                                "xxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxx\\\\\"]")}},
         R"({"level":"error","rule":"script-broken","file":"@/b/Manual/docdata/index.json","line":1,"column":21,"offset":20,"pointer":"/pages/0/1","module":"@/b","set":"Manual","message":"title \"\\xE9\\n\\\"xxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxx\\\\\" of page \"p.html\" breaks global_index.js in every module"}
{"level":"warning","rule":"invalid-utf8","file":"@/b/Manual/docdata/index.json","line":1,"column":22,"offset":21,"module":"@/b","set":"Manual","message":"byte \\xE9 is not UTF-8: readers see a replacement character"}
{"summary":{"modules":2,"errors":1,"warnings":1,"notes":0,"missing":{"Manual":{"search":[],"contents":[]},"ScriptReference":{"search":[],"contents":[]}}}}
status 1
)"},
        {{"@/a", "@/b"},
         {{"b/Manual/docdata/index.json", Index("[\"p.html\","
                                                "\"\351\\n\\\"xxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxx"
                                                "xxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxx\\\\\"]")}},
         R"(@/b/Manual/docdata/index.json:1:21: error: title "\xE9\n\"xxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxx"... of page "p.html" breaks global_index.js in every module [script-broken] /pages/0/1
@/b/Manual/docdata/index.json:1:22: warning: byte \xE9 is not UTF-8: readers see a replacement character [invalid-utf8]
2 modules, 1 error, 1 warning
status 1
)"},
    };
    for (const CheckCase& c : cases)
    {
        ExpectReport(c);
    }
}

TEST(PagemeldCheck, ShowsHostileNamesEscapedAndSurvivesHostileTrees)
{
    const std::string name = "c\n\x1B[1m\xE9\xC2\x9B\x7F";
    const CheckCase cases[] = {
        {{"@/" + name},
         {{name + "/Manual/docdata/toc.json", "7"}},
         R"(@/c\n\x1B[1m\xE9\u009B\x7F/Manual/docdata/index.json: error: is missing beside toc.json; "c\n\x1B[1m\xE9\u009B\x7F" will be missing from the search of Manual [unreadable]
@/c\n\x1B[1m\xE9\u009B\x7F/Manual/docdata/toc.json:1:1: error: node is 7, not an object; "c\n\x1B[1m\xE9\u009B\x7F" will be missing from the contents of Manual [structure]
Manual: error: no module has a sound index.json, and none a sound toc.json: nothing will be written, and earlier outputs stay [nothing-to-combine]
1 module, 3 errors, 0 warnings; missing from the search of Manual: c\n\x1B[1m\xE9\u009B\x7F; from its contents: c\n\x1B[1m\xE9\u009B\x7F
status 1
)"},
        {{"-f", "json", "@/" + name},
         {{name + "/Manual/docdata/toc.json", "7"}},
         R"({"level":"error","rule":"unreadable","file":"@/c\n\u001B[1m\\xE9\u009B\u007F/Manual/docdata/index.json","module":"@/c\n\u001B[1m\\xE9\u009B\u007F","set":"Manual","message":"is missing beside toc.json; \"c\\n\\x1B[1m\\xE9\\u009B\\x7F\" will be missing from the search of Manual"}
{"level":"error","rule":"structure","file":"@/c\n\u001B[1m\\xE9\u009B\u007F/Manual/docdata/toc.json","line":1,"column":1,"offset":0,"pointer":"","module":"@/c\n\u001B[1m\\xE9\u009B\u007F","set":"Manual","message":"node is 7, not an object; \"c\\n\\x1B[1m\\xE9\\u009B\\x7F\" will be missing from the contents of Manual"}
{"level":"error","rule":"nothing-to-combine","set":"Manual","message":"no module has a sound index.json, and none a sound toc.json: nothing will be written, and earlier outputs stay"}
{"summary":{"modules":1,"errors":3,"warnings":0,"notes":0,"missing":{"Manual":{"search":["@/c\n\u001B[1m\\xE9\u009B\u007F"],"contents":["@/c\n\u001B[1m\\xE9\u009B\u007F"]},"ScriptReference":{"search":[],"contents":[]}}}}
status 1
)"},
        {{"@/a/Manual/docdata/toc.json", "@/nowhere", ""},
         {},
         R"(@/a/Manual/docdata/toc.json: error: neither Manual/docdata nor ScriptReference/docdata is found in it, nor in any other root: nothing will be combined [no-modules]
@/nowhere: error: does not exist: a run ends with status 255 where it comes to its outputs, and later modules stay unwritten [missing-root]
error: does not exist: a run ends with status 255 where it comes to its outputs, and later modules stay unwritten [missing-root]
3 modules, 3 errors, 0 warnings
status 1
)"},
        {{"-d", "@/c"},
         {{"c/d/Manual", kLink + "c"}, {"c/d/e", kLink + "c/d"}, {"c/f", kLink + "c/f"}},
         R"(@/c: error: no directory below it has Manual/docdata: nothing will be combined [no-modules]
0 modules, 1 error, 0 warnings
status 1
)"},
        {{"-ot", "@/a", "@/b"},
         {{"a/Manual/docdata/index.json", kLink + "a/Manual/docdata/index.json"},
          {"b/Manual/docdata/toc.json", kPipe},
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
2 modules, 11 errors, 1 warning; missing from the search of Manual: a; from its contents: b
status 1
)"},
    };
    for (const CheckCase& c : cases)
    {
        ExpectReport(c);
    }
}

TEST(PagemeldCheck, ReportsWhatAUserMayNotReadOrWrite)
{
    const TemporaryDirectory directory;
    WriteSoundModules(directory);
    fs::permissions(directory / "a/Manual/docdata/index.json", fs::perms::none);
    fs::permissions(directory / "a/Manual/docdata", fs::perms::owner_read | fs::perms::owner_exec);
    WriteFile(directory / "b/Manual/docdata/global_index.js.tmp", "");
    fs::permissions(directory / "b/Manual/docdata/global_index.js.tmp", fs::perms::owner_read);
    fs::create_directories(directory / "c/Manual/docdata");
    fs::permissions(directory / "c/Manual/docdata", fs::perms::none);
    std::vector<std::string> command = {PAGEMELD_CHECK_PROGRAM, directory / "a", directory / "b",
                                        directory / "c"};
    if (::geteuid() == 0)
    {
        command.insert(command.begin(), {"setpriv", "--bounding-set=-dac_override,-dac_read_search"});
    }
    const ProgramResult result = RunProgram(command.front(), {command.begin() + 1, command.end()});
    fs::permissions(directory / "c/Manual/docdata", fs::perms::owner_all);
    EXPECT_EQ(1, result.status);
    EXPECT_EQ(
        R"(@/a/Manual/docdata: error: can't be written to: permission denied: the run ends here with status 255, and leaves 2 later modules unwritten [output-blocked]
@/a/Manual/docdata/index.json: error: can't be read: permission denied; "a" will be missing from the search of Manual [unreadable]
@/b/Manual/docdata/global_index.js.tmp: error: a file that can't be read and written is in the place of the temporary file: a run that came so far would end here with status 255 [output-blocked]
@/c/Manual/docdata: error: can't be written to: permission denied: a run that came so far would end here with status 255 [output-blocked]
@/c/Manual/docdata/index.json: error: can't be reached: permission denied; "c" will be missing from the search of Manual [unreadable]
@/c/Manual/docdata/toc.json: error: can't be reached: permission denied; "c" will be missing from the contents of Manual [unreadable]
3 modules, 6 errors, 0 warnings; missing from the search of Manual: a, c; from its contents: c
)",
        WithPlaceholders(result.standardOutput, directory));
}

TEST(PagemeldCheck, FilesMayVanishWhileItRuns)
{
    const TemporaryDirectory directory;
    WriteSoundModules(directory);
    std::atomic<bool> ends = false;
    std::thread builder(
        [&]
        {
            while (!ends)
            {
                fs::rename(directory / "b/Manual", directory / "b/other");
                fs::rename(directory / "b/other", directory / "b/Manual");
            }
        });
    for (int run = 0; run < 50; ++run)
    {
        const std::string report = RunPagemeldCheck(directory, {"-t", "-o", "@/a", "@/b"});
        EXPECT_NE(std::string::npos, report.find("\n2 modules, ")) << report;
        EXPECT_NE(std::string::npos, report.find("\nstatus 1\n")) << report;
    }
    ends = true;
    builder.join();
}

TEST(PagemeldCheck, RefusesUnusableCommandLines)
{
    const std::string usage = "Usage: pagemeld-check [OPTION]... ROOT...\n"
                              "       pagemeld-check [OPTION]... --discover=DIR\n"
                              "Try 'pagemeld-check --help' for more.\nstatus 2\n";
    const std::pair<std::vector<std::string>, std::string> cases[] = {
        {{}, "no ROOT is given"},
        {{"-d", "a", "b"}, "give roots or --discover, not both"},
        {{"-autopaths", "a"}, "-autopaths is an option of pagemeld; here it is --discover=DIR"},
        {{"-f", "xml", "a"}, R"(the format is "text" or "json", not "xml")"},
        {{"-n", "", "a"}, R"(the limit is a number of at most 18 digits, not "")"},
        {{"-n", "-1", "a"}, R"(the limit is a number of at most 18 digits, not "-1")"},
        {{"-n", "9999999999999999999", "a"},
         R"(the limit is a number of at most 18 digits, not "9999999999999999999")"},
    };
    const TemporaryDirectory directory;
    for (const auto& [arguments, problem] : cases)
    {
        EXPECT_EQ("pagemeld-check: " + problem + "\n" + usage, RunPagemeldCheck(directory, arguments));
    }
    EXPECT_EQ(2, RunProgram(PAGEMELD_CHECK_PROGRAM, {"--colour", "a"}).status);
    const ProgramResult unknown = RunProgram(PAGEMELD_CHECK_PROGRAM, {"--explain=no-such"});
    EXPECT_EQ(2, unknown.status);
    EXPECT_EQ("", unknown.standardOutput);
    EXPECT_NE(std::string::npos, unknown.standardError.find("\n  no-modules"));
}

TEST(PagemeldCheck, SaysWhyItCouldNotPrint)
{
    const std::string unwritten = "pagemeld-check: standard output can't be written\nstatus 2\n";
    const std::pair<std::string, std::string> cases[] = {
        {"{ CHECK a; echo status $? >&2; } >/dev/full", unwritten},
        {"{ CHECK --help; echo status $? >&2; } >/dev/full", unwritten},
        {"{ sleep 0.1; CHECK a; echo status $? >&2; } | true", "status 1\n"}, // nobody reads any more
    };
    for (const auto& [command, expected] : cases)
    {
        const ProgramResult result =
            RunProgram("sh", {"-c", ReplaceAll(command, "CHECK", PAGEMELD_CHECK_PROGRAM)});
        EXPECT_EQ(expected, result.standardError) << command;
    }
}

TEST(PagemeldCheck, SaysThatMemoryRanOut)
{
#ifdef __SANITIZE_ADDRESS__
    GTEST_SKIP() << "the sanitizer reserves more than any limit";
#endif
    const TemporaryDirectory directory;
    WriteSoundModules(directory);
    WriteFile(directory / "b/Manual/docdata/toc.json", Toc("", R"("x":[0)" + Repeated(",0", 500'000) + "]"));
    int ended = 0;
    for (int megabytes = 6, status = 2; status != 1; ++megabytes)
    {
        ASSERT_LT(megabytes, 100);
        const ProgramResult result =
            RunProgram("prlimit", {"--as=" + std::to_string(megabytes << 20), PAGEMELD_CHECK_PROGRAM,
                                   directory / "a", directory / "b"});
        status = result.status;
        if (status != 127) // the loader's
        {
            EXPECT_EQ(status == 2 ? "pagemeld-check: out of memory\n" : "", result.standardError);
            ended += status == 2 ? 1 : 0;
        }
    }
    EXPECT_GT(ended, 5);
}

TEST(PagemeldCheck, TakesDeepContentsOnASmallStack)
{
#if defined(__SANITIZE_ADDRESS__) || !defined(__OPTIMIZE__)
    GTEST_SKIP() << "the frames of this build are larger";
#endif
    const TemporaryDirectory directory;
    WriteSoundModules(directory);
    const std::string deep = Repeated(R"({"link":"null","title":"t","children":[)", 4'998) +
                             R"({"link":"l","title":"l","children":null})" + Repeated("]}", 4'998);
    WriteFile(directory / "a/Manual/docdata/toc.json", Toc(deep));
    WriteFile(directory / "b/Manual/docdata/toc.json", Toc(deep));
    const ProgramResult result = RunProgram(
        "prlimit", {"--stack=2097152", PAGEMELD_CHECK_PROGRAM, "-W", directory / "a", directory / "b"});
    EXPECT_EQ(1, result.status); // for the entry at the bottom, which both have
    EXPECT_NE(std::string::npos, result.standardOutput.find("\n2 modules, 0 errors, 1 warning\n"));
}

TEST(PagemeldCheck, FindingsOfEveryRuleMatchTheExpressionOfTheGuide)
{
    const std::string guide = ReadFile(CHECKING_PAGE);
    const std::size_t start = guide.find("\n    ^") + 5;
    const std::regex expression(guide.substr(start, guide.find('\n', start) - start));
    for (const RuleRow& rule : AllRules())
    {
        Finding located = Finding::OfFile(rule.id, {0, DocSet::Manual, "a: b/c:7"}, "is [x]: [y]");
        located.place = ValuePlace{5, 2, 3};
        located.pointer = "/a: error: [x]";
        const std::pair<Finding, std::vector<std::string>> cases[] = {
            {located, {"a: b/c:7", "2", "3"}},
            {Finding::OfRun(rule.id, "a", "is [x]: [y]"), {"a", "", ""}},
            {Finding::OfSet(rule.id, DocSet::Manual, "is [x]: [y]"), {"Manual", "", ""}},
        };
        for (auto [finding, groups] : cases)
        {
            groups.insert(groups.end(), {NameOf(rule.level), "is [x]: [y]", rule.name});
            const std::string line = TextLine(finding, false);
            std::smatch match;
            ASSERT_TRUE(std::regex_search(line, match, expression)) << line;
            EXPECT_EQ(groups, std::vector<std::string>(match.begin() + 1, match.end())) << line;
        }
    }
    EXPECT_FALSE(std::regex_search(TextSummary({3, {1, 0, 0}, {{{"b"}, {"a", "c"}}, {}}}), expression));
}

TEST(PagemeldCheck, ExplainsEveryRuleInHelpAndOnItsPage)
{
    const std::string help = RunProgram(PAGEMELD_CHECK_PROGRAM, {"--help"}).standardOutput;
    EXPECT_EQ(0, RunProgram(PAGEMELD_CHECK_PROGRAM, {"--version"}).status);
    const std::string page = ReadFile(RULES_PAGE);
    std::string expected = page.substr(0, page.find("\n## ") + 1);
    for (const RuleRow& rule : AllRules())
    {
        const std::string level = NameOf(rule.level);
        EXPECT_NE(std::string::npos, help.find(level + ": " + rule.meaning + "\n")) << rule.name;
        const std::string text =
            level + ": " + rule.meaning + ".\n\n" + rule.consequence + "\n\n" + rule.remedy + "\n";
        expected += "## `" + std::string(rule.name) + "`\n\n" + static_cast<char>(std::toupper(level[0])) +
                    text.substr(1) + "\n";
        EXPECT_EQ(std::string(rule.name) + " (" + level + "): " + rule.meaning + "\n\n" + rule.consequence +
                      "\n\n" + rule.remedy + "\n",
                  RunProgram(PAGEMELD_CHECK_PROGRAM, {"-e", rule.name}).standardOutput);
    }
    expected.pop_back();
    EXPECT_EQ(ReplaceAll(expected, "\n", " "), ReplaceAll(page, "\n", " "));
}
