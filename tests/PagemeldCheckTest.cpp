#include "Tools/DocTools/PagemeldCheck/Report/JsonReport.h"
#include "Tools/DocTools/PagemeldCheck/Report/TextReport.h"
#include "tests/support/AnswersOfNode.h"
#include "tests/support/CheckCase.h"
#include "tests/support/Placeholders.h"
#include "tests/support/Repeated.h"

#include <gtest/gtest.h>

#include <atomic>
#include <cctype>
#include <chrono>
#include <filesystem>
#include <string>
#include <thread>
#include <tuple>
#include <utility>
#include <vector>

TEST(PagemeldCheck, ShowsFindingsInTheFormAskedFor)
{
    ExpectReports({
        {"CHECK -n 1 -f json @/a @/b # A limit is said in JSON",
         {{"b/Manual/docdata/index.json", Index("1,2,3")}},
         R"({"level":"error","rule":"structure","file":"@/b/Manual/docdata/index.json","line":1,"column":11,"offset":10,"pointer":"/pages/0","module":"@/b","set":"Manual","message":"page entry is 1, not [path, title]; \"b\" will be missing from the search of Manual"}
{"level":"error","rule":"structure","file":"@/b/Manual/docdata/index.json","module":"@/b","set":"Manual","more":2,"message":"2 more of this rule; --limit=0 shows all"}
{"summary":{"modules":2,"errors":3,"warnings":0,"notes":0,"missing":{"Manual":{"search":["@/b"],"contents":[]},"ScriptReference":{"search":[],"contents":[]}}}}, status 1)"},
        {"CHECK --quiet @/a @/b # Only errors are shown",
         {{"b/Manual/docdata/index.json",
           Index("", R"("info":[],"common":{},"searchIndex":{"__proto__":[]})")},
          {"b/Manual/docdata/toc.json", kGone}},
         R"(@/b/Manual/docdata/toc.json: error: is missing beside index.json; "b" will be missing from the contents of Manual [unreadable], status 1)"},
        {"CHECK -qW @/a @/b # Warnings can count as errors",
         {{"b/Manual/docdata/index.json",
           Index("", R"("info":[],"common":{},"searchIndex":{"__proto__":[]})")}},
         R"(@/b/Manual/docdata/index.json:1:62: warning: term "__proto__" sets a prototype in the scripts: readers do not find it [special-term] /searchIndex/__proto__, status 1)"},
        {"CHECK @/a @/b; CHECK -f json @/a @/b | grep -o 'xxx*' # Long texts are cut for people only",
         {{"b/Manual/docdata/index.json", Index("[\"p.html\","
                                                "\"\351\\n\\\"xxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxx"
                                                "xxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxx\\\\\"]")}},
         R"(@/b/Manual/docdata/index.json:1:21: error: title "\xE9\n\"xxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxx"... of page "p.html" breaks global_index.js in every module [script-broken] /pages/0/1
@/b/Manual/docdata/index.json:1:22: warning: byte \xE9 is not UTF-8: readers see a replacement character [invalid-utf8]
2 modules, 1 error, 1 warning
xxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxx, status 0)"},
        {"CHECK -f json @/a @/b @/a # JSON has all that applies",
         {{"a/Manual/docdata/index.json", Index("", R"("info":[],"common":{"a":1},"searchIndex":{})")},
          {"b/Manual/docdata/index.json",
           Index(R"(["p",7])", R"("info":[],"common":{"b":1},"searchIndex":{})")},
          {"b/Manual/docdata/toc.json", "[]"},
          {"b/ScriptReference/docdata", kDirectory}},
         R"({"level":"error","rule":"structure","file":"@/b/Manual/docdata/index.json","line":1,"column":11,"offset":10,"pointer":"/pages/0","module":"@/b","set":"Manual","message":"page path or title is 7, not a string; \"b\" will be missing from the search of Manual"}
{"level":"error","rule":"structure","file":"@/b/Manual/docdata/toc.json","line":1,"column":1,"offset":0,"pointer":"","module":"@/b","set":"Manual","message":"node is an array of 0, not an object; \"b\" will be missing from the contents of Manual"}
{"level":"note","rule":"set-empty","file":"@/b/ScriptReference/docdata","module":"@/b","set":"ScriptReference","message":"has neither index.json nor toc.json: the module adds nothing to ScriptReference"}
{"level":"error","rule":"duplicate-root","file":"@/a","module":"@/a","message":"is the same directory as @/a: its pages will be in the search twice"}
{"summary":{"modules":3,"errors":3,"warnings":0,"notes":1,"missing":{"Manual":{"search":["@/b"],"contents":["@/b"]},"ScriptReference":{"search":[],"contents":[]}}}}, status 1)"},
    });
}

TEST(PagemeldCheck, EscapesHostileNames)
{
    const std::string name = "c\n\x1B[1m\xE9\xC2\x9B\x7F";
    ExpectReports({
        {"CHECK '@/" + name + "' # Hostile names are escaped",
         {{name + "/Manual/docdata/toc.json", "7"}},
         R"(@/c\n\x1B[1m\xE9\u009B\x7F/Manual/docdata/index.json: error: is missing beside toc.json; "c\n\x1B[1m\xE9\u009B\x7F" will be missing from the search of Manual [unreadable]
@/c\n\x1B[1m\xE9\u009B\x7F/Manual/docdata/toc.json:1:1: error: node is 7, not an object; "c\n\x1B[1m\xE9\u009B\x7F" will be missing from the contents of Manual [structure]
Manual: error: no module has a sound index.json, and none a sound toc.json: nothing will be written [nothing-to-combine]
1 module, 3 errors, 0 warnings; missing from the search of Manual: c\n\x1B[1m\xE9\u009B\x7F; from its contents: c\n\x1B[1m\xE9\u009B\x7F, status 1)"},
        {"CHECK -f json '@/" + name + "' # Hostile names are escaped in JSON",
         {{name + "/Manual/docdata/toc.json", "7"}},
         R"({"level":"error","rule":"unreadable","file":"@/c\n\u001B[1m\\xE9\u009B\u007F/Manual/docdata/index.json","module":"@/c\n\u001B[1m\\xE9\u009B\u007F","set":"Manual","message":"is missing beside toc.json; \"c\\n\\x1B[1m\\xE9\\u009B\\x7F\" will be missing from the search of Manual"}
{"level":"error","rule":"structure","file":"@/c\n\u001B[1m\\xE9\u009B\u007F/Manual/docdata/toc.json","line":1,"column":1,"offset":0,"pointer":"","module":"@/c\n\u001B[1m\\xE9\u009B\u007F","set":"Manual","message":"node is 7, not an object; \"c\\n\\x1B[1m\\xE9\\u009B\\x7F\" will be missing from the contents of Manual"}
{"level":"error","rule":"nothing-to-combine","set":"Manual","message":"no module has a sound index.json, and none a sound toc.json: nothing will be written"}
{"summary":{"modules":1,"errors":3,"warnings":0,"notes":0,"missing":{"Manual":{"search":["@/c\n\u001B[1m\\xE9\u009B\u007F"],"contents":["@/c\n\u001B[1m\\xE9\u009B\u007F"]},"ScriptReference":{"search":[],"contents":[]}}}}, status 1)"},
    });
}

TEST(PagemeldCheck, FilesMayVanishWhileItRuns)
{
    const TemporaryDirectory directory;
    WriteSoundModule(directory / "a");
    WriteSoundModule(directory / "b");
    std::atomic<bool> ends = false;
    std::thread builder(
        [&]
        {
            while (!ends)
            {
                std::filesystem::rename(directory / "b/Manual", directory / "b/other");
                std::filesystem::rename(directory / "b/other", directory / "b/Manual");
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
    WriteSoundModule(directory / "a");
    WriteSoundModule(directory / "b");
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
    WriteSoundModule(directory / "a");
    WriteSoundModule(directory / "b");
    const std::string deep = Repeated(R"({"link":"null","title":"t","children":[)", 4'998) +
                             R"({"link":"l","title":"l","children":null})" + Repeated("]}", 4'998);
    WriteFile(directory / "a/Manual/docdata/toc.json", Toc(deep));
    WriteFile(directory / "b/Manual/docdata/toc.json", Toc(deep));
    const ProgramResult result = RunProgram(
        "prlimit", {"--stack=2097152", PAGEMELD_CHECK_PROGRAM, "-W", directory / "a", directory / "b"});
    EXPECT_EQ(1, result.status); // for the entry at the bottom, which both have
    EXPECT_NE(std::string::npos, result.standardOutput.find("\n2 modules, 0 errors, 1 warning\n"));
}

TEST(PagemeldCheck, FindingsOfEveryRuleAreTakenByTheRecipesOfTheGuide)
{
    const std::string guide = ReadFile(CHECKING_PAGE);
    const auto recipe = [&](const std::string& start, const std::string& end)
    {
        const std::size_t first = guide.find(start) + start.size();
        return guide.substr(first, guide.find(end, first) - first);
    };
    const std::string script = "const regular = [String.raw`^" + recipe("\n    ^", "\n") +
                               "`], vim = String.raw`" + recipe("errorformat=", "\n") + R"(`
            .replaceAll('\\ ', ' ').split(',').map((format) => format.replace(']', ']+').replaceAll(/%(.)/g,
                (_, item) => ({f: '(.+?)', l: '([0-9]+)', c: '([0-9]+)', t: '(.)', '*': '', m: '(.*)'})[item]));
        function groups(patterns, line) {
            return patterns.map((one) => RegExp(`^${one}$`).exec(line)).find((match) => match) ?? [];
        }
        function answer(line) {
            return Buffer.from([regular, vim].map((one) => groups(one, line).slice(1).join('|')).join('\n'));
        })";
    Finding located = Finding::OfFile(Rule::Count, {0, DocSet::Manual, "a: b/c:7"}, "is [x]: [y]");
    located.place = ValuePlace{5, 2, 3};
    located.pointer = "/a: error: [x]";
    std::tuple<Finding, std::string, std::string> cases[] = {
        {located,
         "a: b/c:7|2|3|LEVEL|is [x]: [y]|RULE\na: b/c:7|2|3|INITIAL|is [x]: [y] [RULE] /a: error: [x]",
         R"("a%3A%20b/c%3A7",2])"},
        {Finding::OfRun(Rule::Count, "a", "is [x]: [y]"),
         "a|||LEVEL|is [x]: [y]|RULE\na|INITIAL|is [x]: [y] [RULE]", R"("a",1])"},
        {Finding::OfSet(Rule::Count, DocSet::Manual, "is [x]: [y]"),
         "Manual|||LEVEL|is [x]: [y]|RULE\nManual|INITIAL|is [x]: [y] [RULE]", "null,null]"},
    };
    std::vector<std::string> lines = {TextSummary({3, {1, 0, 0}, {{{"b"}, {"a", "c"}}, {}}})};
    std::vector<std::string> answers = {"\n"};
    std::string json;
    std::string sarif;
    for (const RuleRow& rule : AllRules())
    {
        const std::string level = NameOf(rule.level);
        for (auto& [finding, answer, place] : cases)
        {
            finding.rule = rule.id;
            lines.push_back(TextLine(finding, false));
            answers.push_back(ReplaceAll(ReplaceAll(ReplaceAll(answer, "RULE", rule.name), "LEVEL", level),
                                         "INITIAL", level.substr(0, 1)));
            json += JsonLine(finding, {"a"}) + "\n";
            sarif += "[\"" + std::string(rule.name) + "\",\"" + level + "\",\"is [x]: [y]\"," + place + "\n";
        }
    }
    EXPECT_EQ(answers, AnswersOfNode(script, lines));
    if (RunProgram("sh", {"-c", "command -v jq"}).status != 0)
    {
        GTEST_SKIP() << "the recipe for SARIF is not tested: jq is not installed";
    }
    const TemporaryDirectory directory;
    WriteFile(directory / "findings.jsonl", json + JsonSummary({}));
    const std::string shown = R"( | jq -c '.runs[0].results[] | [.ruleId, .level, .message.text,
        (.locations[0].physicalLocation | .artifactLocation.uri, .region.startLine)]')";
    const std::string convert = "jq" + recipe("    jq", " > findings.sarif");
    EXPECT_EQ(sarif,
              RunProgram("sh", {"-c", "cd " + directory.Path() + "; " + convert + shown}).standardOutput);
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
