#include "tests/support/ReplaceAll.h"
#include "tests/support/RunProgram.h"
#include "tests/support/TemporaryFolder.h"
#include "tests/support/WholeFile.h"

#include <gtest/gtest.h>

// Texts say @ for the temporary folder and PROGRAM for the program's path.

namespace
{

void ExpectRun(const TemporaryFolder& folder, const std::vector<std::string>& arguments, int status,
               const std::string& standardError)
{
    std::vector<std::string> fullArguments;
    std::string shown;
    for (const std::string& argument : arguments)
    {
        fullArguments.push_back(ReplaceAll(argument, "@", folder.Path()));
        shown += " " + argument;
    }
    const ProgramResult result = RunPagemeld(fullArguments);
    EXPECT_EQ(status, result.status) << "arguments:" << shown;
    EXPECT_EQ("", result.standardOutput) << "arguments:" << shown;
    EXPECT_EQ(standardError,
              ReplaceAll(ReplaceAll(result.standardError, folder.Path(), "@"), PAGEMELD_PROGRAM, "PROGRAM"))
        << "arguments:" << shown;
}

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
    return error;
}

} // namespace

TEST(CommandLine, FirstArgumentAloneSelectsTheMode)
{
    const struct
    {
        std::vector<std::string> arguments;
        int status;
        std::string error;
    } cases[] = {
        {{},
         255,
         "executing Pagemeld\nERROR: ./Tools/DocTools/VantorPagemeld/Main:173 Usage: PROGRAM <path1> <path2> "
         "...\n or PROGRAM -autopaths <rootdir>\n"},
        {{"-autopaths"}, // the same text, but no failure: wanted
         0,
         "executing Pagemeld\nERROR: ./Tools/DocTools/VantorPagemeld/Main:212 Usage: PROGRAM <path1> <path2> "
         "...\n or PROGRAM -autopaths <rootdir>\n"},
        {{"-verify"},
         255,
         "executing Pagemeld\nERROR: ./Tools/DocTools/VantorPagemeld/Main:192 Usage: PROGRAM -verify "
         "<rootDocPath>\n"},
        {{"-autopaths", "@/none", "ignored"}, 0, "executing Pagemeld\n"},
        {{"@/a", "-verify", "@/b/"}, 0, NothingToRead({"@/a", "-verify", "@/b/"})},
        {{"--help"}, 0, NothingToRead({"--help"})},
        {{"-Verify"}, 0, NothingToRead({"-Verify"})},
        {{""}, 0, NothingToRead({""})},
        {{"@\\a"}, 0, NothingToRead({"@\\a"})}, // only the root of -autopaths has its backslashes converted
    };
    const TemporaryFolder folder;
    for (const auto& c : cases)
    {
        ExpectRun(folder, c.arguments, c.status, c.error);
    }
    EXPECT_TRUE(ReadTree(folder.Path()).empty());
}

TEST(CommandLine, SelfTestModeWritesNothingToStandardError)
{
    const ProgramResult result = RunPagemeld({"-runNativeTests", "no test has this name", "ignored"});
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
        int status;
        std::string error;
    } cases[] = {
        {{"[]", "7", " null\n", "\"x\""}, // any JSON will do
         0,
         "Verifying " + manualToc + "Verifying " + manualIndex + "Verifying " + scriptToc + "Verifying " +
             scriptIndex + passed},
        {{nullptr, nullptr, nullptr, nullptr},
         0,
         "Skipping " + manualToc + "Skipping " + manualIndex + "Skipping " + scriptToc + "Skipping " +
             scriptIndex + passed},
        {{"{\"a\":}", "{}", "{}", "{}"},
         255,
         "Verifying " + manualToc + noJson + "@/en/Manual/docdata/toc.json, error at offset: 5\n" + failed},
        {{nullptr, nullptr, "{}", "{\"a\":1"},
         255,
         "Skipping " + manualToc + "Skipping " + manualIndex + "Verifying " + scriptToc + "Verifying " +
             scriptIndex + noJson + "@/en/ScriptReference/docdata/index.json, error at offset: 6\n" + failed},
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
        ExpectRun(folder, {"-verify", "@", "ignored"}, c.status, start + c.error);
    }
}
