#pragma once

#include "Tools/DocTools/VantorPagemeld/System/EnumTable.h"

#include <cstddef>
#include <string_view>

/// How much a finding matters.
enum class Level
{
    Error,
    Warning,
    Note,
    Count,
};

struct LevelRow
{
    Level id;
    const char* name;
    const char* color; ///< what makes a terminal show it
};

constexpr LevelRow kLevels[] = {{Level::Error, "error", "\033[1;31m"},
                                {Level::Warning, "warning", "\033[1;35m"},
                                {Level::Note, "note", "\033[1;36m"}};
static_assert(HasRowOfEach(kLevels));

constexpr const char* NameOf(Level level)
{
    return RowOf(kLevels, level).name;
}

/// One thing that the checker looks for.
enum class Rule
{
    NoModules,
    MissingRoot,
    DuplicateRoot,
    PassedOver,
    OutputBlocked,
    WrongLinkPath,
    Unreadable,
    SetEmpty,
    NothingToCombine,
    NotJson,
    Structure,
    MergedInput,
    RootDiffers,
    ShadowedEntry,
    ScriptBroken,
    ScriptAltered,
    PrefixedUrl,
    SpecialTerm,
    UnfoundTerm,
    DoubledMember,
    InvalidUtf8,
    TextAfterNul,
    CommonIgnored,
    MissingTarget,
    UnlistedPage,
    OutputMissing,
    OutputBroken,
    WrongPrefixes,
    OutputDiffers,
    OutputStale,
    Leftover,
    Count,
};

/// What is said of a rule. The texts are shown by --help and --explain and in docs/RULES.md.
struct RuleRow
{
    Rule id;
    Level level;
    const char* name;
    const char* meaning;     ///< one line: when it holds
    const char* consequence; ///< what it does to readers or to the run
    const char* remedy;      ///< how to fix it
};

using RuleTable = RuleRow[static_cast<std::size_t>(Rule::Count)];

/// All rules, in the order in which they are shown.
const RuleTable& AllRules();

const RuleRow& RowOf(Rule rule);

/// Returns the rule of that name, or null.
const RuleRow* FindRule(std::string_view name);
