#include "tests/support/RunProgram.h"
#include "tests/support/WholeFile.h"

#include <gtest/gtest.h>

// Texts say @ for the temporary folder and PROGRAM for the program's path.

namespace
{

/// What a run over module roots reports that hold nothing.
std::string NothingToRead(const std::vector<std::string>& roots)
{
    std::string error = "executing Pagemeld\n";
    for (const char* set : {"Manual", "ScriptReference"})
    {
        for (const std::string& root : roots)
        {
            error += "WARNING: ./Tools/DocTools/VantorPagemeld/RapidJsonIoUtil:47 Unable to read " + root +
                     "/" + set + "/docdata/index.json\n";
        }
    }
    return error + "status 0\n";
}

} // namespace

TEST(CommandLine, FirstArgumentAloneSelectsTheMode)
{
    const struct
    {
        std::vector<std::string> arguments;
        std::string report;
    } cases[] = {
        {{},
         "executing Pagemeld\nERROR: ./Tools/DocTools/VantorPagemeld/Main:173 Usage: PROGRAM <path1> <path2> "
         "...\n or PROGRAM -autopaths <rootdir>\nstatus 255\n"},
        {{"-autopaths"}, // the same text, but no failure: wanted
         "executing Pagemeld\nERROR: ./Tools/DocTools/VantorPagemeld/Main:212 Usage: PROGRAM <path1> <path2> "
         "...\n or PROGRAM -autopaths <rootdir>\nstatus 0\n"},
        {{"-verify"},
         "executing Pagemeld\nERROR: ./Tools/DocTools/VantorPagemeld/Main:192 Usage: PROGRAM -verify "
         "<rootDocPath>\nstatus 255\n"},
        {{"-autopaths", "@/none", "ignored"}, "executing Pagemeld\nstatus 0\n"},
        {{"@/a", "-verify", "@/b/"}, NothingToRead({"@/a", "-verify", "@/b/"})},
        {{"--help"}, NothingToRead({"--help"})},
        {{"-Verify"}, NothingToRead({"-Verify"})},
        {{""}, NothingToRead({""})},
        {{"@\\a"}, NothingToRead({"@\\a"})}, // not converted in this form
    };
    const TemporaryFolder folder;
    for (const auto& c : cases)
    {
        EXPECT_EQ(c.report, ReportOfRun(folder, c.arguments));
    }
    EXPECT_TRUE(ReadTree(folder.Path()).empty());
}

TEST(CommandLine, SelfTestModeWritesNothingToStandardError)
{
    const ProgramResult result =
        RunProgram(PAGEMELD_PROGRAM, {"-runNativeTests", "no test has this name", "ignored"});
    EXPECT_EQ(0, result.status);
    EXPECT_EQ("", result.standardError);
}

TEST(CommandLine, VerificationStopsAtTheFirstFileThatFails)
{
    const std::string start = "executing Pagemeld\nrootDocPath = @\n";
    const std::string manualToc = "@/en/Manual/docdata/toc.json\n";
    const std::string manualIndex = "@/en/Manual/docdata/index.json\n";
    const std::string scriptToc = "@/en/ScriptReference/docdata/toc.json\n";
    const std::string scriptIndex = "@/en/ScriptReference/docdata/index.json\n";
    const std::string passed = "VerifyTocAndIndex succeeded\n";
    const std::string failed = "ERROR: ./Tools/DocTools/VantorPagemeld/Main:200 VerifyTocAndIndex failed\n";
    const std::string noJson =
        "ERROR: ./Tools/DocTools/VantorPagemeld/RapidJsonIoUtil:71 Failed to parse JSON file ";
    const struct
    {
        const char* contents[4]; ///< of the four files in their order; null for one that is missing
        std::string report;
    } cases[] = {
        {{"[]", "7", " null\n", "\"x\""}, // any JSON will do
         "Verifying " + manualToc + "Verifying " + manualIndex + "Verifying " + scriptToc + "Verifying " +
             scriptIndex + passed + "status 0\n"},
        {{nullptr, nullptr, nullptr, nullptr},
         "Skipping " + manualToc + "Skipping " + manualIndex + "Skipping " + scriptToc + "Skipping " +
             scriptIndex + passed + "status 0\n"},
        {{"{\"a\":}", "{}", "{}", "{}"},
         "Verifying " + manualToc + noJson + "@/en/Manual/docdata/toc.json, error at offset: 5\n" + failed +
             "status 255\n"},
        {{nullptr, nullptr, "{}", "{\"a\":1"},
         "Skipping " + manualToc + "Skipping " + manualIndex + "Verifying " + scriptToc + "Verifying " +
             scriptIndex + noJson + "@/en/ScriptReference/docdata/index.json, error at offset: 6\n" + failed +
             "status 255\n"},
    };
    const char* names[] = {"/en/Manual/docdata/toc.json", "/en/Manual/docdata/index.json",
                           "/en/ScriptReference/docdata/toc.json", "/en/ScriptReference/docdata/index.json"};
    for (const auto& c : cases)
    {
        const TemporaryFolder folder;
        for (int i = 0; i < 4; ++i)
        {
            if (c.contents[i] != nullptr)
            {
                WriteWholeFile(folder.Path() + names[i], c.contents[i]);
            }
        }
        EXPECT_EQ(start + c.report, ReportOfRun(folder, {"-verify", "@", "ignored"}));
    }
}
