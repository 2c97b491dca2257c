#include "Tools/DocTools/PagemeldCheck/OutputCheck.h"

#include "Tools/DocTools/VantorPagemeld/Read/InputFile.h"
#include "Tools/DocTools/VantorPagemeld/Read/JsonReader.h"

#include <algorithm>
#include <functional>
#include <optional>
#include <string_view>
#include <tuple>

namespace
{

/// What shows that a script is whole. Its end alone does not: a line in the middle can end in the same way,
/// so a script that was cut there would pass. Only a whole one has the last part too.
struct ScriptMarks
{
    std::string_view bodyStart; ///< after the prefix lines
    std::string_view lastPart;  ///< where its last statement or line begins
    std::string_view bodyEnd;
};

constexpr ScriptMarks kIndexScript = {"pages = [\n", "\nsearchIndex = {", "};\n"};
constexpr ScriptMarks kTocScript = {"toc = {\n", "\n\"link\": ", "]};\n"};

std::optional<std::string_view> JsonBody(const char* text, std::string_view whole)
{
    rapidjson::Document document;
    return ParseJson(text, document).IsError() ? std::nullopt : std::optional(whole);
}

std::optional<std::string_view> ScriptBody(const ScriptMarks& marks, std::string_view whole)
{
    const bool hasPrefixes = whole.substr(0, marks.bodyStart.size()) != marks.bodyStart;
    const std::size_t lineEnd = hasPrefixes ? whole.find("\n" + std::string(marks.bodyStart)) : 0;
    if (lineEnd == std::string_view::npos)
    {
        return std::nullopt;
    }
    const std::string_view body = whole.substr(lineEnd + (hasPrefixes ? 1 : 0));
    const bool isWhole = body.find(marks.lastPart) != std::string_view::npos &&
                         body.substr(body.size() - marks.bodyEnd.size()) == marks.bodyEnd;
    return isWhole ? std::optional(body) : std::nullopt;
}

/// Returns what all modules' copies share, or nothing if the output is not whole.
std::optional<std::string_view> BodyOf(Output output, const InputText& text)
{
    const std::string_view whole(text.bytes.get(), text.bytesRead);
    switch (output)
    {
    case Output::IndexScript:
        return ScriptBody(kIndexScript, whole);
    case Output::TocScript:
        return ScriptBody(kTocScript, whole);
    case Output::IndexJson:
    case Output::TocJson:
    case Output::Count:
        break;
    }
    return JsonBody(text.bytes.get(), whole);
}

bool IsEarlier(const timespec& a, const timespec& b)
{
    return std::tie(a.tv_sec, a.tv_nsec) < std::tie(b.tv_sec, b.tv_nsec);
}

timespec NewestInput(const std::vector<SetModule>& modules)
{
    timespec newest = {};
    for (const SetModule& module : modules)
    {
        for (const auto& input : kInputs)
        {
            const FileStatus status = FileStatus::Of(module.path.PathOf(input.id));
            newest = std::max(newest, status.Details().st_mtim, IsEarlier);
        }
    }
    return newest;
}

/// Compares the copies of one output with the inputs, and with the first whole copy.
class CopyCheck
{
public:
    CopyCheck(Output output, const timespec& newestInput, Report& report)
        : m_output(RowOf(kOutputs, output)), m_newestInput(newestInput), m_report(report)
    {
    }

    void Check(const SetModule& module)
    {
        const ModuleFile file = module.File(m_output);
        const InputText text = ReadInputFile(file.path.c_str());
        if (text.outcome != InputText::Outcome::Read)
        {
            m_report.Add(
                Finding::OfFile(Rule::OutputMissing, file,
                                "is not there, or can't be read: readers of the module can't use it"));
            return;
        }
        if (IsStale(file.path))
        {
            m_report.Add(Finding::OfFile(Rule::OutputStale, file,
                                         "is older than an input of the set: readers see an earlier build"));
        }
        if (const std::optional<std::string_view> body = BodyOf(m_output.id, text))
        {
            CompareWithFirst(file, module.root, *body);
            return;
        }
        m_report.Add(Finding::OfFile(Rule::OutputBroken, file,
                                     "is cut short or broken: readers of the module can't use it"));
    }

private:
    [[nodiscard]] bool IsStale(const std::string& path) const
    {
        const FileStatus status = FileStatus::Of(path);
        return status.Exists() && IsEarlier(status.Details().st_mtim, m_newestInput);
    }

    void CompareWithFirst(const ModuleFile& file, const std::string& root, std::string_view body)
    {
        const std::size_t hash = std::hash<std::string_view>()(body);
        if (m_firstRoot.empty())
        {
            m_firstRoot = Visible(root);
            m_firstSize = body.size();
            m_firstHash = hash;
        }
        else if (m_firstSize != body.size() || m_firstHash != hash)
        {
            m_report.Add(Finding::OfFile(Rule::OutputDiffers, file,
                                         "has other content than in " + m_firstRoot +
                                             ": a run ended early, and readers find different things"));
        }
    }

    const OutputRow& m_output;
    const timespec& m_newestInput;
    Report& m_report;
    std::string m_firstRoot; ///< of the first whole copy; empty as long as there is none
    std::size_t m_firstSize = 0;
    std::size_t m_firstHash = 0;
};

} // namespace

void CheckOutputs(const std::vector<SetModule>& modules, Report& report)
{
    const timespec newestInput = NewestInput(modules);
    for (const OutputRow& output : kOutputs)
    {
        CopyCheck check(output.id, newestInput, report);
        for (const SetModule& module : modules)
        {
            if (module.hasDocdata) // otherwise output-blocked reports it
            {
                check.Check(module);
            }
        }
    }
}

void CheckLeftovers(const std::vector<SetModule>& modules, Report& report)
{
    for (const SetModule& module : modules)
    {
        for (const OutputRow& output : kOutputs)
        {
            const ModuleFile temporary = module.File(TemporaryPathOf(module.path.PathOf(output)));
            if (FileStatus::Of(temporary.path).IsRegularFile())
            {
                report.Add(Finding::OfFile(Rule::Leftover, temporary,
                                           "a temporary file is left over: a run was ended, and the output "
                                           "beside it may be old"));
            }
        }
    }
}
