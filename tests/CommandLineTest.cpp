#include "tests/support/Files.h"
#include "tests/support/Placeholders.h"
#include "tests/support/RunProgram.h"

#include <gtest/gtest.h>

TEST(CommandLine, FirstArgumentAloneSelectsTheMode)
{
    const struct
    {
        std::vector<std::string> arguments;
        const char* report;
    } cases[] = {
        {{}, R"(executing Pagemeld
ERROR: #Main:173 Usage: PROGRAM <path1> <path2> ...
 or PROGRAM -autopaths <rootdir>
status 255
)"},
        {{"-autopaths"}, R"(executing Pagemeld
ERROR: #Main:212 Usage: PROGRAM <path1> <path2> ...
 or PROGRAM -autopaths <rootdir>
status 0
)"}, // the same text, but no failure, on purpose
        {{"-verify"}, R"(executing Pagemeld
ERROR: #Main:192 Usage: PROGRAM -verify <rootDocPath>
status 255
)"},
        {{"-autopaths", "@/none", "ignored"}, "executing Pagemeld\nstatus 0\n"},
        {{"@\\a", "-verify", "--help", ""}, R"(executing Pagemeld
WARNING: #RapidJsonIoUtil:47 Unable to read @\a/Manual/docdata/index.json
WARNING: #RapidJsonIoUtil:47 Unable to read -verify/Manual/docdata/index.json
WARNING: #RapidJsonIoUtil:47 Unable to read --help/Manual/docdata/index.json
WARNING: #RapidJsonIoUtil:47 Unable to read /Manual/docdata/index.json
WARNING: #RapidJsonIoUtil:47 Unable to read @\a/ScriptReference/docdata/index.json
WARNING: #RapidJsonIoUtil:47 Unable to read -verify/ScriptReference/docdata/index.json
WARNING: #RapidJsonIoUtil:47 Unable to read --help/ScriptReference/docdata/index.json
WARNING: #RapidJsonIoUtil:47 Unable to read /ScriptReference/docdata/index.json
status 0
)"},
    };
    const TemporaryDirectory directory;
    for (const auto& c : cases)
    {
        EXPECT_EQ(c.report, RunPagemeld(directory, c.arguments));
    }
    EXPECT_TRUE(ReadTree(directory.Path()).empty());
}

TEST(CommandLine, SelfTestModeRunsTheTestsThatTheFilterNames)
{
    const char* const all =
        R"([IndexCombiner]  TryGetJsonDocFromString_ValidString_ReturnsTrue             PASS(Nms)
[IndexCombiner]  AppendJsonDocument_OneValueJson_ProducesThatJson            PASS(Nms)
[IndexCombiner]  AppendJsonDocument_TwoValidJsons_ProducesCombinedJson       PASS(Nms)
[TocCombiner]    TryGetJsonDocFromString_ValidString_ReturnsTrue             PASS(Nms)
[TocCombiner]    AppendJsonDocument_OneValueJson_ProducesThatJson            PASS(Nms)
[TocCombiner]    AppendJsonDocument_TrivialAndSimpleJson_ProducesSimpleJson  PASS(Nms)
Ran 6 tests with 0 failures in N seconds
status 0
)";
    const struct
    {
        std::vector<std::string> arguments;
        const char* report;
    } cases[] = {
        {{}, all},
        {{""}, all},
        {{"."}, all},
        {{"TOCCOMBINER", "extra"},
         R"([TocCombiner]  TryGetJsonDocFromString_ValidString_ReturnsTrue             PASS(Nms)
[TocCombiner]  AppendJsonDocument_OneValueJson_ProducesThatJson            PASS(Nms)
[TocCombiner]  AppendJsonDocument_TrivialAndSimpleJson_ProducesSimpleJson  PASS(Nms)
Ran 3 tests with 0 failures in N seconds
status 0
)"},
        {{".", "--Automated"},
         R"text(##qzm:{"type":"TestStatus","version":2,"phase":"Begin","time":N,"processId":N,"name":"IndexCombiner.TryGetJsonDocFromString_ValidString_ReturnsTrue","state":0}
##qzm:{"type":"TestStatus","version":2,"phase":"End","time":N,"processId":N,"name":"IndexCombiner.TryGetJsonDocFromString_ValidString_ReturnsTrue","state":4,"message":"","fileName":"#IndexCombinerTests","lineNumber":30,"durationMicroseconds":N,"duration":N}
##qzm:{"type":"TestStatus","version":2,"phase":"Begin","time":N,"processId":N,"name":"IndexCombiner.AppendJsonDocument_OneValueJson_ProducesThatJson","state":0}
##qzm:{"type":"TestStatus","version":2,"phase":"End","time":N,"processId":N,"name":"IndexCombiner.AppendJsonDocument_OneValueJson_ProducesThatJson","state":4,"message":"","fileName":"#IndexCombinerTests","lineNumber":39,"durationMicroseconds":N,"duration":N}
##qzm:{"type":"TestStatus","version":2,"phase":"Begin","time":N,"processId":N,"name":"IndexCombiner.AppendJsonDocument_TwoValidJsons_ProducesCombinedJson","state":0}
##qzm:{"type":"TestStatus","version":2,"phase":"End","time":N,"processId":N,"name":"IndexCombiner.AppendJsonDocument_TwoValidJsons_ProducesCombinedJson","state":4,"message":"","fileName":"#IndexCombinerTests","lineNumber":62,"durationMicroseconds":N,"duration":N}
##qzm:{"type":"TestStatus","version":2,"phase":"Begin","time":N,"processId":N,"name":"TocCombiner.TryGetJsonDocFromString_ValidString_ReturnsTrue","state":0}
##qzm:{"type":"TestStatus","version":2,"phase":"End","time":N,"processId":N,"name":"TocCombiner.TryGetJsonDocFromString_ValidString_ReturnsTrue","state":4,"message":"","fileName":"#TocCombinerTests","lineNumber":27,"durationMicroseconds":N,"duration":N}
##qzm:{"type":"TestStatus","version":2,"phase":"Begin","time":N,"processId":N,"name":"TocCombiner.AppendJsonDocument_OneValueJson_ProducesThatJson","state":0}
##qzm:{"type":"TestStatus","version":2,"phase":"End","time":N,"processId":N,"name":"TocCombiner.AppendJsonDocument_OneValueJson_ProducesThatJson","state":4,"message":"","fileName":"#TocCombinerTests","lineNumber":36,"durationMicroseconds":N,"duration":N}
##qzm:{"type":"TestStatus","version":2,"phase":"Begin","time":N,"processId":N,"name":"TocCombiner.AppendJsonDocument_TrivialAndSimpleJson_ProducesSimpleJson","state":0}
##qzm:{"type":"TestStatus","version":2,"phase":"End","time":N,"processId":N,"name":"TocCombiner.AppendJsonDocument_TrivialAndSimpleJson_ProducesSimpleJson","state":4,"message":"","fileName":"#TocCombinerTests","lineNumber":57,"durationMicroseconds":N,"duration":N}
status 0
)text"},
        {{"no such test"}, "Ran 0 tests with 0 failures in N seconds\nstatus 0\n"},
        {{"-automated"}, "status 0\n"}, // in the filter's place, the switch is the filter as well
    };
    for (const auto& c : cases)
    {
        std::vector<std::string> arguments = {"-runNativeTests"};
        arguments.insert(arguments.end(), c.arguments.begin(), c.arguments.end());
        EXPECT_EQ(c.report, WithoutNumbers(RunPagemeld(TemporaryDirectory(), arguments)));
    }
}

TEST(CommandLine, VerificationStopsAtTheFirstFileThatFails)
{
    const struct
    {
        const char* contents[4]; ///< of the four files in their order; null for one that is missing
        const char* report;      ///< from the first of them on
    } cases[] = {
        {{"[]", "7", " null\n", "\"any JSON will do\""}, R"(Verifying @/en/Manual/docdata/toc.json
Verifying @/en/Manual/docdata/index.json
Verifying @/en/ScriptReference/docdata/toc.json
Verifying @/en/ScriptReference/docdata/index.json
VerifyTocAndIndex succeeded
status 0
)"},
        {{"{\"a\":}", "{}", "{}", "{}"}, R"(Verifying @/en/Manual/docdata/toc.json
ERROR: #RapidJsonIoUtil:71 Failed to parse JSON file @/en/Manual/docdata/toc.json, error at offset: 5
ERROR: #Main:200 VerifyTocAndIndex failed
status 255
)"},
        {{nullptr, nullptr, "{}", "{\"a\":1"}, R"(Skipping @/en/Manual/docdata/toc.json
Skipping @/en/Manual/docdata/index.json
Verifying @/en/ScriptReference/docdata/toc.json
Verifying @/en/ScriptReference/docdata/index.json
ERROR: #RapidJsonIoUtil:71 Failed to parse JSON file @/en/ScriptReference/docdata/index.json, error at offset: 6
ERROR: #Main:200 VerifyTocAndIndex failed
status 255
)"},
    };
    const char* const names[] = {"Manual/docdata/toc.json", "Manual/docdata/index.json",
                                 "ScriptReference/docdata/toc.json", "ScriptReference/docdata/index.json"};
    for (const auto& c : cases)
    {
        const TemporaryDirectory directory;
        for (int i = 0; i < 4; ++i)
        {
            if (c.contents[i] != nullptr)
            {
                WriteFile(directory / (std::string("en/") + names[i]), c.contents[i]);
            }
        }
        EXPECT_EQ(std::string("executing Pagemeld\nrootDocPath = @\n") + c.report,
                  RunPagemeld(directory, {"-verify", "@", "ignored"}));
    }
}
