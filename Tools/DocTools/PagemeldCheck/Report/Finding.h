#pragma once

#include "Tools/DocTools/PagemeldCheck/Explain/ValuePlaces.h"
#include "Tools/DocTools/PagemeldCheck/Report/Rules.h"

#include <iterator>
#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

/// The documentation sets, in the order in which they are combined.
constexpr const char* kSetNames[] = {"Manual", "ScriptReference"};

/// Something that a rule found. What does not apply is left empty.
struct Finding
{
    Finding(std::string_view ruleId, std::optional<std::size_t> ofModule, std::optional<std::size_t> ofSet,
            std::string inFile, std::string text)
        : rule(&RuleOf(ruleId)),
          module(ofModule),
          set(ofSet),
          file(std::move(inFile)),
          message(std::move(text))
    {
    }

    const Rule* rule;
    std::optional<std::size_t> module; ///< its position in the list of roots
    std::optional<std::size_t> set;    ///< its position in kSetNames
    std::string file;                  ///< or directory, as pagemeld would name it
    std::string message;               ///< visible text
    std::optional<ValuePlace> place;
    std::optional<std::string> pointer;
};

/// The roots of modules that are missing from the search and from the contents of a set.
struct MissingModules
{
    std::vector<std::string> search;
    std::vector<std::string> contents;
};

/// What a report says at its end.
struct Summary
{
    std::size_t modules = 0;
    std::size_t findings[3] = {}; ///< by level
    MissingModules missing[std::size(kSetNames)];

    [[nodiscard]] std::size_t CountOf(Level level) const { return findings[static_cast<std::size_t>(level)]; }
};
