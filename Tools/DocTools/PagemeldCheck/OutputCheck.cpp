#include "Tools/DocTools/PagemeldCheck/OutputCheck.h"

#include "Tools/DocTools/PagemeldCheck/Explain/FileProblem.h"
#include "Tools/DocTools/PagemeldCheck/OutputText.h"
#include "Tools/DocTools/VantorPagemeld/Read/InputFile.h"
#include "Tools/DocTools/VantorPagemeld/Render/ModulePrefix.h"

#include <algorithm>
#include <array>
#include <ctime>
#include <functional>
#include <iterator>
#include <map>
#include <optional>
#include <string_view>
#include <tuple>
#include <utility>

namespace
{

/// An input of the set, and when it was last changed.
struct DatedInput
{
    std::string path;
    timespec time = {};
};

bool IsEarlier(const timespec& a, const timespec& b)
{
    return std::tie(a.tv_sec, a.tv_nsec) < std::tie(b.tv_sec, b.tv_nsec);
}

DatedInput NewestInput(const std::vector<SetModule>& modules)
{
    DatedInput newest;
    for (const SetModule& module : modules)
    {
        for (const auto& input : kInputs)
        {
            const std::string path = module.path.PathOf(input.id);
            const timespec time = FileStatus::Of(path).Details().st_mtim;
            newest = IsEarlier(newest.time, time) ? DatedInput{path, time} : newest;
        }
    }
    return newest;
}

std::string DescribeStale(const DatedInput& newest)
{
    const std::string older = "is older than " + Visible(newest.path);
    if (newest.time.tv_sec <= std::time(nullptr))
    {
        return older + ": readers see an earlier build";
    }
    std::array<char, 32> date = {};
    (void)std::strftime(date.data(), date.size(), "%Y-%m-%d %H:%M:%S UTC", std::gmtime(&newest.time.tv_sec));
    return older + ", which is dated in the future, " + date.data() +
           ": correct that date, or every output will be older";
}

/// Returns the modules that a run merges into an output, as the combiner numbers them.
std::map<int, std::string> MergedModules(const OutputRow& output, const std::vector<SetModule>& modules)
{
    const bool isIndex = output.id == Output::IndexJson || output.id == Output::IndexScript;
    std::map<int, std::string> merged;
    for (const SetModule& module : modules)
    {
        if ((isIndex ? module.index : module.toc).IsSound())
        {
            merged.emplace(static_cast<int>(merged.size()), module.path.AsLinkTarget());
        }
    }
    return merged;
}

/// What tells bodies of outputs apart: size and hash.
using Fingerprint = std::pair<std::size_t, std::size_t>;

Fingerprint FingerprintOf(std::string_view body)
{
    return {body.size(), std::hash<std::string_view>()(body)};
}

/// Compares the copies of one output with what a run would write, as far as that is known without merging:
/// with its prefix lines, with the first whole copy and with the dates of the inputs.
class CopyCheck
{
public:
    CopyCheck(const OutputRow& output, const std::vector<SetModule>& modules, const DatedInput& newestInput,
              Report& report)
        : m_output(output),
          m_merged(MergedModules(output, modules)),
          m_newestInput(newestInput),
          m_report(report)
    {
    }

    void Check(const SetModule& module)
    {
        const ModuleFile file = module.File(m_output);
        const InputText text = ReadInputFile(file.path.c_str());
        if (text.outcome != InputText::Outcome::Read)
        {
            Add(Rule::OutputMissing, file,
                DescribeUnreadable(file.path) + ": readers of the module can't use it");
            return;
        }
        const std::string_view whole(text.bytes.get(), text.bytesRead);
        const std::size_t start = FindBody(m_output, whole);
        if (start == std::string_view::npos || !IsWholeCopy(whole.substr(start)))
        {
            Add(Rule::OutputBroken, file, "is cut short or broken: readers of the module can't use it");
            return;
        }
        Compare(module, file, whole.substr(0, start), whole.substr(start));
    }

private:
    /// A copy that is the same as a whole one is whole. So only the first JSON text is parsed.
    [[nodiscard]] bool IsWholeCopy(std::string_view body) const
    {
        return m_first == FingerprintOf(body) || IsWholeBody(m_output, body);
    }

    void Compare(const SetModule& module, const ModuleFile& file, std::string_view head,
                 std::string_view body)
    {
        if (!m_first)
        {
            m_first = FingerprintOf(body);
            m_firstRoot = Visible(module.root);
        }
        if (head != ExpectedHead(module))
        {
            Add(Rule::WrongPrefixes, file,
                "its links were made for other modules, or for other names or places of them: run pagemeld "
                "again");
        }
        else if (m_first != FingerprintOf(body))
        {
            Add(Rule::OutputDiffers, file,
                "has other content than in " + m_firstRoot +
                    ": a run ended early, and readers find different things");
        }
        else if (IsEarlier(FileStatus::Of(file.path).Details().st_mtim, m_newestInput.time))
        {
            Add(Rule::OutputStale, file, DescribeStale(m_newestInput));
        }
    }

    [[nodiscard]] std::string ExpectedHead(const SetModule& module) const
    {
        return m_output.form == OutputRow::Form::Script ? RenderPrefixLines(module.path.Text(), m_merged)
                                                        : "";
    }

    void Add(Rule rule, const ModuleFile& file, std::string message)
    {
        m_report.Add(Finding::OfFile(rule, file, std::move(message)));
    }

    const OutputRow& m_output;
    const std::map<int, std::string> m_merged;
    const DatedInput& m_newestInput;
    Report& m_report;
    std::optional<Fingerprint> m_first; ///< of the first whole copy
    std::string m_firstRoot;
};

} // namespace

void CheckOutputs(const std::vector<SetModule>& modules, Report& report)
{
    const DatedInput newestInput = NewestInput(modules);
    for (const OutputRow& output : kOutputs)
    {
        CopyCheck check(output, modules, newestInput, report);
        for (const SetModule& module : modules)
        {
            if (module.hasDocdata) // otherwise output-blocked reports it
            {
                check.Check(module);
            }
        }
    }
}

bool HasOutputs(const std::vector<SetModule>& modules)
{
    return std::any_of(modules.begin(), modules.end(),
                       [](const SetModule& module)
                       {
                           return std::any_of(std::begin(kOutputs), std::end(kOutputs),
                                              [&](const OutputRow& output) {
                                                  return FileStatus::Of(module.path.PathOf(output)).Exists();
                                              });
                       });
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
