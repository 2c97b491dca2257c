#include "tests/support/CheckCase.h"

#include "tests/support/Files.h"
#include "tests/support/Placeholders.h"
#include "tests/support/RunProgram.h"

#include <gtest/gtest.h>

#include <filesystem>

#include <unistd.h>

namespace
{

namespace fs = std::filesystem;

void Put(const TemporaryDirectory& directory, const std::string& path, const std::string& content)
{
    if (content == kCombined)
    {
        (void)RunPagemeld(directory, {"@/a", "@/b"});
        return;
    }
    fs::create_directories(fs::path(path).parent_path());
    fs::remove(path);
    if (content == kDirectory)
    {
        fs::create_directory(path);
    }
    else if (content == kModule)
    {
        WriteSoundModule(path);
    }
    else if (content.compare(0, kLink.size(), kLink) == 0)
    {
        fs::create_symlink(directory / content.substr(kLink.size()), path);
    }
    else if (content != kGone)
    {
        WriteFile(path, content);
    }
}

/// Runs the command of a case.
std::string Run(const TemporaryDirectory& directory, const std::string& command)
{
    std::string script = "trap 'chmod -R u+rwX @' EXIT; cd @; " + command;
    script = ReplaceAll(script, "AS_USER",
                        ::geteuid() == 0 ? "setpriv --bounding-set=-dac_override,-dac_read_search" : "");
    script = ReplaceAll(ReplaceAll(script, "@", directory.Path()), "CHECK", PAGEMELD_CHECK_PROGRAM);
    const ProgramResult result = RunProgram("sh", {"-c", script});
    const std::string report = result.standardError + result.standardOutput;
    return WithPlaceholders(report.substr(0, report.rfind('\n')), directory) + ", status " +
           std::to_string(result.status);
}

} // namespace

void ExpectReports(const std::vector<CheckCase>& cases)
{
    for (const CheckCase& c : cases)
    {
        const TemporaryDirectory directory;
        WriteSoundModule(directory / "a");
        WriteSoundModule(directory / "b");
        for (const auto& [path, content] : c.changes)
        {
            Put(directory, directory / path, content);
        }
        EXPECT_EQ(c.output, Run(directory, c.command)) << c.command;
    }
}

void WriteSoundModule(const std::string& root)
{
    WriteFile(root + "/Manual/docdata/index.json", Index(""));
    WriteFile(root + "/Manual/docdata/toc.json", Toc(""));
}

std::string Index(const std::string& pages, const std::string& rest)
{
    return R"({"pages":[)" + pages + "]," + rest + "}";
}

std::string Toc(const std::string& children, const std::string& root)
{
    return "{" + root + R"(,"children":[)" + children + "]}";
}
