#include "Tools/DocTools/PagemeldCheck/Report/Report.h"

#include "Tools/DocTools/PagemeldCheck/Report/JsonReport.h"
#include "Tools/DocTools/PagemeldCheck/Report/TextReport.h"

#include <algorithm>
#include <cstdint>
#include <tuple>

namespace
{

/// Within a module, findings without a set come before the sets; those without a module come last. The count
/// of findings that are not shown has no place, and comes after those that are.
auto OrderOf(const Finding& finding)
{
    return std::make_tuple(finding.module.value_or(SIZE_MAX),
                           finding.set ? static_cast<int>(*finding.set) + 1 : 0,
                           std::string_view(finding.file), finding.place ? finding.place->offset : SIZE_MAX);
}

} // namespace

void Report::Add(Finding finding)
{
    Count(finding.rule, 1);
    m_findings.push_back(std::move(finding));
}

void Report::Count(Rule rule, std::size_t findings)
{
    m_summary.findings[static_cast<std::size_t>(RowOf(rule).level)] += findings;
}

void Report::Print(std::FILE* stream, const ReportForm& form, const std::vector<std::string>& roots)
{
    std::stable_sort(m_findings.begin(), m_findings.end(),
                     [](const Finding& a, const Finding& b) { return OrderOf(a) < OrderOf(b); });
    const Level lowest = !form.showsErrorsOnly         ? Level::Note
                         : form.countsWarningsAsErrors ? Level::Warning
                                                       : Level::Error;
    for (const Finding& finding : m_findings)
    {
        if (RowOf(finding.rule).level <= lowest)
        {
            const std::string line =
                form.isJson ? JsonLine(finding, roots) : TextLine(finding, form.isColored);
            (void)std::fprintf(stream, "%s\n", line.c_str());
        }
    }
    m_summary.modules = roots.size();
    if (form.isJson || !form.showsErrorsOnly)
    {
        const std::string line = form.isJson ? JsonSummary(m_summary) : TextSummary(m_summary);
        (void)std::fprintf(stream, "%s\n", line.c_str());
    }
}

bool Report::HasErrors(const ReportForm& form) const
{
    return m_summary.CountOf(Level::Error) > 0 ||
           (form.countsWarningsAsErrors && m_summary.CountOf(Level::Warning) > 0);
}
