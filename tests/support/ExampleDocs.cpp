#include "tests/support/ExampleDocs.h"

#include "tests/support/Files.h"

#include <filesystem>

namespace
{

namespace fs = std::filesystem;

constexpr const char* kEarlierBytes = "the earlier output";

char Letter(const std::string& path, const std::string& newBytes)
{
    if (!fs::is_regular_file(path))
    {
        return fs::is_directory(path) ? 'D' : '-';
    }
    const std::string bytes = ReadFile(path);
    if (bytes == newBytes || bytes.empty())
    {
        return bytes.empty() ? 'E' : 'N';
    }
    if (newBytes.compare(0, bytes.size(), bytes) == 0)
    {
        return 'C';
    }
    return bytes == kEarlierBytes ? 'O' : '?';
}

} // namespace

ExampleDocs::ExampleDocs()
{
    for (const char* module : {"a", "b"})
    {
        const std::string stem = module + std::string("/Manual/docdata/global_");
        m_outputs.push_back({stem + "index.json", false, ""});
        m_outputs.push_back({stem + "index.js", true, ""});
        m_outputs.push_back({stem + "toc.json", false, ""});
        m_outputs.push_back({stem + "toc.js", true, ""});
    }
    Restore();
    (void)Run();
    for (Output& output : m_outputs)
    {
        output.newBytes = ReadFile(*this / output.path);
    }
    Restore();
}

ProgramResult ExampleDocs::Run(const std::vector<std::string>& through) const
{
    std::vector<std::string> words = through;
    words.insert(words.end(), {PAGEMELD_PROGRAM, *this / "a", *this / "b"});
    return RunProgram(words.front(), {words.begin() + 1, words.end()});
}

void ExampleDocs::Restore() const
{
    for (const std::string module : {"a", "b"})
    {
        const std::string docdata = *this / module + "/Manual/docdata";
        std::error_code missing;
        fs::permissions(docdata, fs::perms::owner_all, missing); // a test may have taken them away
        fs::remove_all(docdata);
        WriteFile(docdata + "/index.json",
                  R"({"pages":[["p.html","P"]],"info":[["t",0]],"common":{},"searchIndex":{")" + module +
                      R"(":[0]}})");
        WriteFile(docdata + "/toc.json", R"({"link":"toc","title":"toc","children":[{"link":")" + module +
                                             R"(","title":"","children":null}]})");
    }
    for (const Output& output : m_outputs)
    {
        WriteFile(*this / output.path, kEarlierBytes);
    }
}

std::string ExampleDocs::Describe() const
{
    std::string description;
    for (const Output& output : m_outputs)
    {
        const std::string path = *this / output.path;
        description += &output == &m_outputs[4] ? " " : "";
        description += Letter(path, output.newBytes);
        if (fs::exists(fs::symlink_status(path + ".tmp")))
        {
            description += std::string("[") + Letter(path + ".tmp", output.newBytes) + "]";
        }
    }
    return description;
}
