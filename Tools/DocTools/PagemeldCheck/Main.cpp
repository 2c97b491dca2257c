#include "Tools/DocTools/PagemeldCheck/DiscoveryCheck.h"
#include "Tools/DocTools/PagemeldCheck/LinkCheck.h"
#include "Tools/DocTools/PagemeldCheck/Options.h"
#include "Tools/DocTools/PagemeldCheck/RootCheck.h"
#include "Tools/DocTools/PagemeldCheck/SetCheck.h"
#include "Tools/DocTools/VantorPagemeld/System/Diagnostics.h"

#include <cerrno>
#include <cstdio>
#include <cstdlib>
#include <new>

#include <unistd.h>

namespace
{

constexpr int kSound = 0;
constexpr int kFaulty = 1;
constexpr int kUnusable = 2;

/// Called when memory runs out.
[[noreturn]] void EndWithoutMemory()
{
    (void)std::fputs("pagemeld-check: out of memory\n", stderr);
    std::_Exit(kUnusable);
}

/// Returns the exit status after all is printed: the one given, unless standard output can't be written. A
/// reader that has seen enough and closes its pipe is no failure.
int Finish(int status)
{
    if ((std::fflush(stdout) == 0 && std::ferror(stdout) == 0) || errno == EPIPE)
    {
        return status;
    }
    (void)std::fputs("pagemeld-check: standard output can't be written\n", stderr);
    return kUnusable;
}

int Show(const std::string& text)
{
    (void)std::fputs(text.c_str(), stdout);
    return Finish(kSound);
}

int Explain(const std::string& id)
{
    const std::optional<std::string> text = ExplainRule(id);
    return text ? Show(*text) : kUnusable;
}

bool IsColored()
{
    const char* const noColor = std::getenv("NO_COLOR");
    return ::isatty(STDOUT_FILENO) == 1 && (noColor == nullptr || *noColor == '\0');
}

int Check(Options options)
{
    options.checks.quoteSize = options.form.isJson ? SIZE_MAX : options.checks.quoteSize;
    options.form.isColored = !options.form.isJson && IsColored();
    Report report;
    const std::vector<std::string> roots =
        options.discover ? DiscoverRoots(*options.discover, report) : options.roots;
    CheckRoots(roots, report);
    CheckLinks(roots, report);
    bool runEnds = false;
    for (const auto& set : kDocSets)
    {
        runEnds = CheckSet(set.id, roots, options.checks, runEnds, report);
    }
    report.Print(stdout, options.form, roots);
    return Finish(report.HasErrors(options.form) ? kFaulty : kSound);
}

} // namespace

int main(int argc, char* argv[])
{
    SecureStandardStreams();
    std::set_new_handler(EndWithoutMemory);
    const std::optional<Options> options = ParseOptions(argc, argv);
    if (!options)
    {
        return kUnusable;
    }
    switch (options->action)
    {
    case Options::Action::Explain:
        return Explain(options->ruleToExplain);
    case Options::Action::ShowHelp:
        return Show(HelpText());
    case Options::Action::ShowVersion:
        return Show("pagemeld-check " PAGEMELD_VERSION "\n");
    default:
        return Check(*options);
    }
}
