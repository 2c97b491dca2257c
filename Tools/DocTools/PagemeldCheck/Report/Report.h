#pragma once

#include "Tools/DocTools/PagemeldCheck/Report/Finding.h"

#include <cstdio>
#include <string>
#include <vector>

/// How findings are printed.
struct ReportForm
{
    bool isJson = false;
    bool showsErrorsOnly = false;
    bool isColored = false;
    bool countsWarningsAsErrors = false;
};

/// Collects findings, and prints them in order: by module, set, file and place.
class Report
{
public:
    void Add(Finding finding);

    /// Counts findings that are not shown one by one.
    void Count(Rule rule, std::size_t findings);

    MissingModules& MissingOf(DocSet set) { return m_summary.MissingOf(set); }

    /// Prints all findings and the summary. roots are the modules as typed.
    void Print(std::FILE* stream, const ReportForm& form, const std::vector<std::string>& roots);

    /// Whether there are errors; warnings too, if they count.
    [[nodiscard]] bool HasErrors(const ReportForm& form) const;

private:
    std::vector<Finding> m_findings;
    Summary m_summary;
};
