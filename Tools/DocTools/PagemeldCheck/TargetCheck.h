#pragma once

#include "Tools/DocTools/PagemeldCheck/Report/FileFindings.h"
#include "Tools/DocTools/VantorPagemeld/System/FileStatus.h"

#include <set>
#include <string>
#include <string_view>
#include <utility>

/// Checks where the page paths and links of one file lead, if that is asked for.
class TargetCheck
{
public:
    explicit TargetCheck(FileFindings& findings) : m_findings(findings) {}

    /// Checks a page path or link, called by name, that the scripts hold as path.
    void Check(const char* name, const rapidjson::Value& link, const JsonPointer& pointer,
               std::string_view path);

    /// Counts the HTML files below the set's directory to which no path has led.
    void ReportUnreached();

private:
    [[nodiscard]] std::string ProblemOf(std::string_view path);
    [[nodiscard]] bool Reach(std::string_view name);
    [[nodiscard]] FileStatus StatusOf(std::string_view name) const;

    FileFindings& m_findings;
    std::set<std::pair<dev_t, ino_t>> m_reached; ///< files, by device and number
};
