#pragma once

#include "Tools/DocTools/PagemeldCheck/Report/Report.h"

#include <optional>
#include <string>
#include <vector>

/// What the command line asks for.
struct Options
{
    enum class Action
    {
        Check,
        Explain,
        ShowHelp,
        ShowVersion,
    };

    Action action = Action::Check;
    std::vector<std::string> roots;      ///< as typed
    std::optional<std::string> discover; ///< the directory below which roots are looked for
    std::string ruleToExplain;
    CheckOptions checks;
    ReportForm form;
};

/// Returns the options, or nothing after a message on standard error.
std::optional<Options> ParseOptions(int argc, char* argv[]);

/// Returns the text that --help shows: usage, options and all rules.
std::string HelpText();

/// Returns the text that --explain shows of a rule, or nothing after a message, with the list of rules, on
/// standard error.
std::optional<std::string> ExplainRule(const std::string& id);
