#include "Tools/DocTools/VantorPagemeld/Read/JsonReader.h"
#include "tests/support/ExampleDocs.h"
#include "tests/support/Files.h"
#include "tests/support/HasMatch.h"
#include "tests/support/Repeated.h"
#include "tests/support/RunProgram.h"

#include <gtest/gtest.h>

#include <csignal>
#include <cstring>
#include <filesystem>

#include <unistd.h>

namespace
{

namespace fs = std::filesystem;

/// A command that runs another one with its streams redirected.
std::vector<std::string> WithStreams(const std::string& redirections)
{
    return {"sh", "-c", R"(exec "$0" "$@" )" + redirections};
}

} // namespace

TEST(Environment, OutputsNeverTakeTheDescriptorsOfMessages)
{
    const ExampleDocs docs;
    for (const char* redirections : {"2>&-", ">&-", "<&-", ">&- 2>&-", "<&- >&- 2>&-", "2>/dev/full"})
    {
        std::vector<std::string> command = {"strace",       "-E", "ASAN_OPTIONS=detect_leaks=0", "-o",
                                            docs / "trace", "-e", "trace=openat,close,rename"};
        const std::vector<std::string> shell = WithStreams(redirections);
        command.insert(command.end(), shell.begin(), shell.end());
        EXPECT_EQ(0, docs.Run(command).status) << redirections;
        EXPECT_EQ("NNNN NNNN", docs.Describe()) << redirections;
        const std::string trace = ReadFile(docs / "trace");
        EXPECT_TRUE(HasMatch(trace, "global_toc.js.tmp.* = [0-9]+$")) << trace;
        EXPECT_FALSE(HasMatch(trace, "openat.*global_.* = [012]$")) << redirections << trace;
        EXPECT_FALSE(HasMatch(trace, "openat.*\nrename")) << "renamed while open: " << trace;
        docs.Restore();
    }
}

TEST(Environment, UnreadStandardErrorLosesNoOutput)
{
    const ExampleDocs docs;
    int ends[2] = {};
    ASSERT_EQ(0, ::pipe(ends));
    ::close(ends[0]);
    ASSERT_EQ(9, ::dup2(ends[1], 9));
    EXPECT_EQ(0, docs.Run(WithStreams("2>&9")).status);
    EXPECT_EQ("NNNN NNNN", docs.Describe());
    ::close(9);
    ::close(ends[1]);
}

TEST(Environment, RunningOutOfMemoryEndsTheRunBeforeItsFirstOutput)
{
#ifdef __SANITIZE_ADDRESS__
    GTEST_SKIP() << "the sanitizer reserves more than any limit";
#endif
    const ExampleDocs docs;
    const std::string input = docs / "b/Manual/docdata/index.json";
    const std::string largeInput =
        ReadFile(input).insert(1, "\"ignored\":[0" + Repeated(",0", 500'000) + "],");

    int ended = 0;
    for (int megabytes = 6;; ++megabytes)
    {
        ASSERT_LT(megabytes, 100);
        WriteFile(input, largeInput);
        const ProgramResult result = docs.Run({"prlimit", "--as=" + std::to_string(megabytes << 20)});
        if (result.standardError.find("RapidJsonIoUtil:60 Unable to read entire file") != std::string::npos)
        {
            docs.Restore(); // no room for the text of a file: its module is skipped
            continue;
        }
        const int status = result.status;
        if (status == 0)
        {
            break;
        }
        EXPECT_TRUE(status == -SIGABRT || status == 127) << status; // 127 is the loader's
        EXPECT_EQ("OOOO OOOO", docs.Describe()) << megabytes;
        ended += status == -SIGABRT ? 1 : 0;
    }
    EXPECT_GT(ended, 5);
    EXPECT_EQ("NNNN NNNN", docs.Describe());
}

TEST(Environment, DeepInputNeedsNoMoreThanASmallStack)
{
#ifdef __SANITIZE_ADDRESS__
    GTEST_SKIP() << "the frames of this build are larger";
#endif
    const ExampleDocs docs;
    const std::string input = docs / "b/Manual/docdata/index.json";
    const std::string deep = Repeated("[", kMaxNestingDepth - 1) + Repeated("]", kMaxNestingDepth - 1);
    WriteFile(input, ReadFile(input).insert(1, "\"ignored\":" + deep + ","));
    std::vector<std::string> limits = {"--stack=2097152"};
    for (std::size_t megabytes = 3; megabytes <= 12; ++megabytes) // just above what the heap would reserve
    {
        limits.push_back("--as=" + std::to_string((std::size_t{1} << 30) + (megabytes << 20)));
    }
    for (const std::string& limit : limits)
    {
        EXPECT_EQ(0, docs.Run({"prlimit", limit}).status) << limit;
        EXPECT_EQ("NNNN NNNN", docs.Describe()) << limit;
    }
}

TEST(Environment, SymbolicLinksAreFollowedExceptForOutputs)
{
    const struct
    {
        const char* link;
        const char* elsewhere; ///< what a linked output holds afterwards
    } cases[] = {
        {"a", nullptr},
        {"a/Manual", nullptr},
        {"a/Manual/docdata", nullptr},
        {"a/Manual/docdata/index.json", nullptr},
        {"a/Manual/docdata/global_index.json", "the earlier output"},
        {"a/Manual/docdata/global_toc.js", "the earlier output"},
        // What is at a temporary name is opened as it is.
        {"a/Manual/docdata/global_toc.js.tmp", "var p0"},
    };
    for (const auto& c : cases)
    {
        const ExampleDocs docs;
        WriteFile(docs / "a/Manual/docdata/global_toc.js.tmp", "stale");
        fs::rename(docs / c.link, docs / "elsewhere");
        fs::create_symlink(docs / "elsewhere", docs / c.link);
        EXPECT_EQ(0, docs.Run().status) << c.link;
        EXPECT_EQ("NNNN NNNN", docs.Describe()) << c.link;
        if (c.elsewhere != nullptr)
        {
            const std::string bytes = ReadFile(docs / "elsewhere");
            EXPECT_EQ(c.elsewhere, bytes.substr(0, std::strlen(c.elsewhere))) << c.link;
        }
    }
}

TEST(Environment, AnyNameIsUsedAsItIs)
{
    for (const std::string name :
         {"two words", "\"quoted\"", "new\nline", "back\\slash", "\xff\xfe", "$(x);'"})
    {
        const ExampleDocs docs;
        fs::rename(docs / "b", docs / name);
        EXPECT_EQ(0, RunProgram(PAGEMELD_PROGRAM, {docs / "a", docs / name}).status) << name;
        const std::string prefixes = "var p0 = \"\";\nvar p1 = \"../../" + name + "/Manual/\";\ntoc = {\n";
        EXPECT_EQ(prefixes, ReadFile(docs / "a/Manual/docdata/global_toc.js").substr(0, prefixes.size()));
        EXPECT_EQ(0U, ReadFile(docs / name + "/Manual/docdata/global_toc.js").find("var p0"));
    }
}
