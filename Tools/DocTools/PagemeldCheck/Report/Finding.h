#pragma once

#include "Tools/DocTools/PagemeldCheck/Explain/ValuePlaces.h"
#include "Tools/DocTools/PagemeldCheck/FileScope.h"
#include "Tools/DocTools/PagemeldCheck/Report/Rules.h"

#include <optional>
#include <string>
#include <utility>
#include <vector>

/// Something that a rule found, in visible text. What does not apply is left empty.
struct Finding
{
    /// Of the run as a whole; path is a directory.
    static Finding OfRun(Rule rule, std::string path, std::string message)
    {
        return {rule, std::nullopt, std::nullopt, std::move(path), std::move(message)};
    }

    /// Of the root at a position in the list of roots.
    static Finding OfRoot(Rule rule, std::size_t module, std::string root, std::string message)
    {
        return {rule, module, std::nullopt, std::move(root), std::move(message)};
    }

    /// Of all modules' files of a set.
    static Finding OfSet(Rule rule, DocSet set, std::string message)
    {
        return {rule, std::nullopt, set, "", std::move(message)};
    }

    static Finding OfFile(Rule rule, const ModuleFile& file, std::string message)
    {
        return {rule, file.module, file.set, file.path, std::move(message)};
    }

    Rule rule;
    std::optional<std::size_t> module; ///< its position in the list of roots
    std::optional<DocSet> set;
    std::string file; ///< or directory, as pagemeld would name it
    std::string message;
    std::optional<ValuePlace> place = std::nullopt;
    std::optional<std::string> pointer = std::nullopt;
    std::size_t more = 0; ///< findings that this one stands for, which are counted and not shown
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
    std::size_t findings[static_cast<std::size_t>(Level::Count)] = {};
    MissingModules missing[static_cast<std::size_t>(DocSet::Count)];

    [[nodiscard]] std::size_t CountOf(Level level) const { return findings[static_cast<std::size_t>(level)]; }
    MissingModules& MissingOf(DocSet set) { return missing[static_cast<std::size_t>(set)]; }
};
