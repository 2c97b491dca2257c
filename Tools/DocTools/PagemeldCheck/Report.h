#pragma once

#include "Tools/DocTools/PagemeldCheck/Rules.h"
#include "Tools/DocTools/PagemeldCheck/ValuePlaces.h"

#include <cstdio>
#include <map>
#include <optional>
#include <string>
#include <vector>

/// Something that a rule found. What does not apply is left empty.
struct Finding
{
    const Rule* rule = nullptr;
    std::string message;               ///< visible text
    std::optional<std::size_t> module; ///< its position in the list of roots
    std::optional<std::size_t> set;    ///< its position in kSetNames
    std::string file;                  ///< as pagemeld would name it
    std::optional<ValuePlace> place;
    std::optional<std::string> pointer;
};

constexpr const char* kSetNames[] = {"Manual", "ScriptReference"};

/// The roots of modules that are missing from the search and from the contents of a set.
struct MissingModules
{
    std::vector<std::string> search;
    std::vector<std::string> contents;
};

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
    void Count(const Rule& rule, std::size_t findings);

    MissingModules& MissingOf(std::size_t set) { return m_missing[set]; }

    /// Prints all findings and the summary. roots are the modules as typed.
    void Print(std::FILE* stream, const ReportForm& form, const std::vector<std::string>& roots);

    /// Whether there are errors; warnings too, if they count.
    [[nodiscard]] bool HasErrors(const ReportForm& form) const;

private:
    [[nodiscard]] std::size_t CountOf(Level level) const;
    void Sort();
    [[nodiscard]] std::string TextSummary(std::size_t moduleCount) const;
    [[nodiscard]] std::string JsonSummary(std::size_t moduleCount) const;

    std::vector<Finding> m_findings;
    std::map<Level, std::size_t> m_counts;
    MissingModules m_missing[2];
};
