#include "tests/support/ExampleDocs.h"
#include "tests/support/Files.h"

#include <gtest/gtest.h>

#include <filesystem>

#include <sys/stat.h>
#include <unistd.h>

// What a run leaves on the disk when writing fails, or when it is killed. A script is whole and new, or whole
// and earlier; a JSON file may be cut short, on purpose. See docs/ROBUSTNESS.md.

namespace
{

namespace fs = std::filesystem;

/// Runs pagemeld without root's right to ignore permissions.
ProgramResult RunAsOrdinaryUser(const ExampleDocs& docs)
{
    return ::geteuid() == 0 ? docs.Run({"setpriv", "--bounding-set=-dac_override"}) : docs.Run();
}

std::string CutAt(std::size_t limit, const std::vector<ExampleDocs::Output>& outputs)
{
    std::string description;
    for (const ExampleDocs::Output& output : outputs)
    {
        const char cut = limit == 0 ? 'E' : 'C';
        const char failed = output.isScript ? 'O' : cut;
        description += output.newBytes.size() <= limit ? 'N' : failed;
    }
    return description.insert(4, " ");
}

} // namespace

TEST(WriteFault, FileSizeLimitAtAnyByteLeavesWholeScripts)
{
    const ExampleDocs docs;
    const std::size_t longest = docs.Outputs()[3].newBytes.size();
    ASSERT_GT(longest, docs.Outputs()[1].newBytes.size());
    for (std::size_t limit = 0; limit <= longest; ++limit)
    {
        docs.Restore();
        const std::string option = "--fsize=" + std::to_string(limit);
        EXPECT_EQ(0, docs.Run({"env", "--ignore-signal=XFSZ", "prlimit", option}).status);
        EXPECT_EQ(CutAt(limit, docs.Outputs()), docs.Describe()) << "at a limit of " << limit << " bytes";
    }
}

TEST(WriteFault, ObstaclesHaveTheirDocumentedOutcome)
{
    using Prepare = void (*)(const std::string& path);
    const Prepare putDirectory = [](const std::string& path)
    {
        fs::remove(path);
        fs::create_directory(path);
    };
    const Prepare putPipe = [](const std::string& path) { EXPECT_EQ(0, ::mkfifo(path.c_str(), 0666)); };
    const Prepare putStaleFile = [](const std::string& path) { WriteFile(path, std::string(10'000, 'x')); };
    const Prepare forbidWriting = [](const std::string& path)
    { fs::permissions(path, fs::perms::owner_read | fs::perms::owner_exec); };
    const struct
    {
        Prepare prepare;
        const char* name;
        int status;
        const char* outputs;
    } cases[] = {
        {putStaleFile, "a/Manual/docdata/global_index.json.tmp", 0, "NNNN NNNN"},
        {putStaleFile, "b/Manual/docdata/global_toc.js.tmp", 0, "NNNN NNNN"},
        {forbidWriting, "a/Manual/docdata", 255, "OOOO OOOO"},
        {forbidWriting, "b/Manual/docdata", 255, "NNNN OOOO"},
        {putDirectory, "a/Manual/docdata/global_index.json.tmp", 0, "O[D]NNN NNNN"},
        {putDirectory, "a/Manual/docdata/global_index.js.tmp", 255, "NO[D]OO OOOO"},
        {putDirectory, "a/Manual/docdata/global_toc.json.tmp", 0, "NNO[D]N NNNN"},
        {putDirectory, "a/Manual/docdata/global_toc.js.tmp", 0, "NNNO[D] NNNN"},
        {putPipe, "a/Manual/docdata/global_index.json.tmp", 0, "O[-]NNN NNNN"},
        {putPipe, "a/Manual/docdata/global_index.js.tmp", 255, "NO[-]OO OOOO"},
        {putPipe, "a/Manual/docdata/global_toc.js.tmp", 0, "NNNO[-] NNNN"},
        // A rename onto a directory fails, and is not reported.
        {putDirectory, "a/Manual/docdata/global_index.json", 0, "D[N]NNN NNNN"},
        {putDirectory, "a/Manual/docdata/global_toc.js", 0, "NNND[N] NNNN"},
    };
    const ExampleDocs docs;
    for (const auto& c : cases)
    {
        c.prepare(docs / c.name);
        EXPECT_EQ(c.status, RunAsOrdinaryUser(docs).status) << c.name;
        EXPECT_EQ(c.outputs, docs.Describe()) << c.name;
        docs.Restore();
    }
}

TEST(WriteFault, KilledRunLeavesWholeOutputsAndTheNextOneReplacesThem)
{
    const ExampleDocs docs;
    int runs = 0;
    for (const char* operation : {"openat", "write", "close", "rename"})
    {
        for (int count = 1;; ++count, ++runs)
        {
            docs.Restore();
            const std::string kill =
                std::string("inject=") + operation + ":signal=KILL:when=" + std::to_string(count);
            const int status =
                docs.Run({"strace", "-qq", "-E", "ASAN_OPTIONS=detect_leaks=0", "-e", kill}).status;
            if (status == 0)
            {
                break; // the run has no more of these operations
            }
            ASSERT_EQ(-9, status);
            for (const ExampleDocs::Output& output : docs.Outputs())
            {
                const std::string bytes = ReadFile(docs / output.path);
                EXPECT_TRUE(bytes == output.newBytes || bytes == "the earlier output")
                    << output.path << ", killed at " << operation << ' ' << count;
            }
            (void)docs.Run();
            EXPECT_EQ("NNNN NNNN", docs.Describe()) << "after a run killed at " << operation << ' ' << count;
        }
    }
    EXPECT_GT(runs, 30);
}
