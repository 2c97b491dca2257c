#include "Tools/DocTools/PagemeldCheck/Options.h"

#include "Tools/DocTools/PagemeldCheck/Explain/ShownText.h"
#include "Tools/DocTools/PagemeldCheck/Report/Rules.h"

#include <algorithm>
#include <charconv>
#include <cstdio>
#include <cstring>
#include <string_view>

#include <getopt.h>

namespace
{

constexpr const char* kUsage = R"(Usage: pagemeld-check [OPTION]... ROOT...
       pagemeld-check [OPTION]... --discover=DIR
)";

constexpr const char* kOptionsHelp =
    R"(Reports before a run of pagemeld which input breaks its result, where, and what readers will see.
ROOT is a module as it would be given to pagemeld, as typed.

  -d, --discover=DIR   check what "pagemeld -autopaths DIR" would take; also
                       report what is passed over
  -t, --targets        check that pages and contents lead to files that exist,
                       and that pages have entries
  -o, --outputs        after a run: check that outputs are there, whole,
                       current and equal
  -f, --format=FORMAT  "text" (default), or "json": one object per line
  -W, --werror         warnings count as errors
  -n, --limit=N        findings shown per rule and file; 0 for all (default 10)
  -q, --quiet          show errors only
  -e, --explain=RULE   explain a rule and how to fix what it finds
  -h, --help           show this help
  -V, --version        show the version

Exit status: 0 no errors, 1 errors, 2 an unusable command line or a check that
could not be done.

Rules:
)";

const option kLongOptions[] = {
    {"discover", required_argument, nullptr, 'd'},
    {"targets", no_argument, nullptr, 't'},
    {"outputs", no_argument, nullptr, 'o'},
    {"format", required_argument, nullptr, 'f'},
    {"werror", no_argument, nullptr, 'W'},
    {"limit", required_argument, nullptr, 'n'},
    {"quiet", no_argument, nullptr, 'q'},
    {"explain", required_argument, nullptr, 'e'},
    {"help", no_argument, nullptr, 'h'},
    {"version", no_argument, nullptr, 'V'},
    {nullptr, 0, nullptr, 0},
};

std::nullopt_t Refuse(const std::string& message)
{
    (void)std::fprintf(stderr, "pagemeld-check: %s\n%sTry 'pagemeld-check --help' for more.\n",
                       message.c_str(), kUsage);
    return std::nullopt;
}

/// Returns a number that consists only of digits.
std::optional<std::size_t> ParseNumber(std::string_view text)
{
    constexpr std::size_t kMaxDigits = 18;
    std::size_t number = 0;
    const auto [end, error] = std::from_chars(text.begin(), text.end(), number);
    const bool isNumber = error == std::errc() && end == text.end() && text.size() <= kMaxDigits;
    return isNumber ? std::optional(number) : std::nullopt;
}

/// Takes one option. Returns why it is unusable, or an empty text.
std::string TakeOption(Options& options, int letter, const char* argument)
{
    switch (letter)
    {
    case 'd':
        options.discover = argument;
        break;
    case 't':
        options.checks.checksTargets = true;
        break;
    case 'o':
        options.checks.checksOutputs = true;
        break;
    case 'f':
        options.form.isJson = std::strcmp(argument, "json") == 0;
        return options.form.isJson || std::strcmp(argument, "text") == 0
                   ? ""
                   : "the format is \"text\" or \"json\", not " + Quoted(argument, options.checks.quoteSize);
    case 'W':
        options.form.countsWarningsAsErrors = true;
        break;
    case 'n':
    {
        const std::optional<std::size_t> limit = ParseNumber(argument);
        options.checks.limit = limit.value_or(0);
        return limit ? ""
                     : "the limit is a number of at most 18 digits, not " +
                           Quoted(argument, options.checks.quoteSize);
    }
    case 'q':
        options.form.showsErrorsOnly = true;
        break;
    case 'e':
        options.action = Options::Action::Explain;
        options.ruleToExplain = argument;
        break;
    case 'h':
        options.action = Options::Action::ShowHelp;
        break;
    default:
        options.action = Options::Action::ShowVersion;
    }
    return "";
}

std::string RuleLine(const RuleRow& rule)
{
    std::string line = "  " + std::string(rule.name);
    line.resize(std::max<std::size_t>(line.size() + 1, 21), ' ');
    return line + NameOf(rule.level) + ": " + rule.meaning + "\n";
}

} // namespace

std::optional<Options> ParseOptions(int argc, char* argv[])
{
    Options options;
    if (std::find(argv, argv + argc, std::string_view("-autopaths")) != argv + argc)
    {
        return Refuse("-autopaths is an option of pagemeld; here it is --discover=DIR");
    }
    for (int letter = 0; (letter = ::getopt_long(argc, argv, "d:tof:Wn:qe:hV", kLongOptions, nullptr)) != -1;)
    {
        if (letter == '?')
        {
            (void)std::fputs("Try 'pagemeld-check --help' for more.\n", stderr);
            return std::nullopt;
        }
        const std::string problem = TakeOption(options, letter, optarg);
        if (!problem.empty())
        {
            return Refuse(problem);
        }
        if (options.action != Options::Action::Check)
        {
            return options;
        }
    }
    options.roots.assign(argv + optind, argv + argc);
    if (options.roots.empty() == !options.discover)
    {
        return Refuse(options.discover ? "give roots or --discover, not both" : "no ROOT is given");
    }
    return options;
}

std::string HelpText()
{
    std::string text = std::string(kUsage) + kOptionsHelp;
    for (const RuleRow& rule : AllRules())
    {
        text += RuleLine(rule);
    }
    return text;
}

std::optional<std::string> ExplainRule(const std::string& id)
{
    if (const RuleRow* rule = FindRule(id))
    {
        return std::string(rule->name) + " (" + NameOf(rule->level) + "): " + rule->meaning + "\n\n" +
               rule->consequence + "\n\n" + rule->remedy + "\n";
    }
    (void)std::fprintf(stderr, "pagemeld-check: there is no rule '%s'. The rules are:\n", id.c_str());
    for (const RuleRow& rule : AllRules())
    {
        (void)std::fputs(RuleLine(rule).c_str(), stderr);
    }
    return std::nullopt;
}
