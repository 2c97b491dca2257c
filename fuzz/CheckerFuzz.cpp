#include "Tools/DocTools/PagemeldCheck/SetCheck.h"
#include "Tools/DocTools/VantorPagemeld/Check/IndexStructure.h"
#include "Tools/DocTools/VantorPagemeld/Check/TocStructure.h"
#include "fuzz/MergeProperty.h"
#include "tests/support/Files.h"
#include "tests/support/TemporaryDirectory.h"

// The checker takes any bytes as the input files of two modules, reports a module as missing exactly if the
// tool's own reader and structure checks refuse its file or its root differs, and can print what it finds.
//
// A byte 0xFF ends a file, so that one can hold a NUL byte.

namespace
{

using rapidjson::Value;

constexpr std::size_t kFiles = 4;
constexpr const char* kNames[kFiles] = {"a/Manual/docdata/index.json", "b/Manual/docdata/index.json",
                                        "a/Manual/docdata/toc.json", "b/Manual/docdata/toc.json"};

std::vector<std::string> SplitFiles(const std::uint8_t* data, std::size_t size)
{
    std::vector<std::string> files(1);
    for (const char c : std::string_view(reinterpret_cast<const char*>(data), size))
    {
        if (c == '\xFF' && files.size() < kFiles)
        {
            files.emplace_back();
        }
        else
        {
            files.back() += c;
        }
    }
    files.resize(kFiles);
    return files;
}

template <class Check>
bool IsTaken(const std::string& text, Check check, rapidjson::Document& document)
{
    return !ParseJson(text.c_str(), document).IsError() && IsSound(check, document);
}

std::string RootOf(const Value& toc)
{
    return std::string(toc["link"].GetString()) + '\0' + toc["title"].GetString();
}

/// Returns the roots whose texts the tool refuses, or whose contents it drops because their root differs.
MissingModules Refused(const std::vector<std::string>& files, const std::vector<std::string>& roots)
{
    MissingModules refused;
    std::optional<std::string> firstRoot;
    for (std::size_t i = 0; i < roots.size(); ++i)
    {
        rapidjson::Document document;
        if (!IsTaken(files[i], CheckIndexStructure, document))
        {
            refused.search.push_back(roots[i]);
        }
        if (!IsTaken(files[i + 2], CheckTocStructure, document))
        {
            refused.contents.push_back(roots[i]);
            continue;
        }
        const std::string root = RootOf(document);
        if (firstRoot.value_or(root) != root)
        {
            refused.contents.push_back(roots[i]);
        }
        firstRoot = firstRoot.value_or(root);
    }
    return refused;
}

void RequirePrintable(Report& report, bool isJson, const std::vector<std::string>& roots)
{
    char* bytes = nullptr;
    std::size_t size = 0;
    std::FILE* const stream = ::open_memstream(&bytes, &size);
    report.Print(stream, {isJson, false, false, false}, roots);
    (void)std::fclose(stream);
    for (const char c : std::string_view(bytes, size))
    {
        Require(c == '\n' || (static_cast<unsigned char>(c) >= ' ' && c != '\x7F'), "no control character");
    }
    std::free(bytes);
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    static const TemporaryDirectory directory;
    static const std::vector<std::string> roots = {directory / "a", directory / "b"};
    const std::vector<std::string> files = SplitFiles(data, size);
    for (std::size_t i = 0; i < kFiles; ++i)
    {
        WriteFile(directory / kNames[i], files[i]);
    }
    const MissingModules refused = Refused(files, roots);
    for (const bool isJson : {false, true})
    {
        Report report;
        (void)CheckSet(DocSet::Manual, roots, {true, true, 10, isJson ? SIZE_MAX : 80}, false, report);
        Require(report.MissingOf(DocSet::Manual).search == refused.search,
                "what is missing from the search is refused");
        Require(report.MissingOf(DocSet::Manual).contents == refused.contents,
                "what is missing from the contents is dropped");
        RequirePrintable(report, isJson, roots);
    }
    return 0;
}
