#pragma once

#include <string>
#include <string_view>
#include <vector>

/// How much a finding matters.
enum class Level
{
    Error,
    Warning,
    Note,
};

/// One thing that the checker looks for. The texts are shown by --help and --explain and in docs/RULES.md.
struct Rule
{
    const char* id;
    Level level;
    const char* meaning;     ///< one line: when it holds
    const char* consequence; ///< what it does to readers or to the run
    const char* remedy;      ///< how to fix it
};

/// All rules, in the order in which they are shown.
const std::vector<Rule>& AllRules();

/// Returns the rule with that id. There must be one.
const Rule& RuleOf(std::string_view id);

/// Returns the rule with that id, or null.
const Rule* FindRule(std::string_view id);

/// Returns "error", "warning" or "note".
const char* NameOf(Level level);
