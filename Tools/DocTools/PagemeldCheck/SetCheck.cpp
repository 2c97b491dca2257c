#include "Tools/DocTools/PagemeldCheck/SetCheck.h"

#include "Tools/DocTools/PagemeldCheck/ContentsCheck.h"
#include "Tools/DocTools/PagemeldCheck/Explain/FileProblem.h"
#include "Tools/DocTools/PagemeldCheck/OutputCheck.h"
#include "Tools/DocTools/PagemeldCheck/SetModule.h"
#include "Tools/DocTools/PagemeldCheck/WriteCheck.h"

#include <algorithm>

namespace
{

using Modules = std::vector<SetModule>;

Modules ModulesOf(DocSet set, const std::vector<std::string>& roots, const CheckOptions& options)
{
    Modules modules;
    modules.reserve(roots.size());
    for (const std::string& root : roots)
    {
        modules.emplace_back(modules.size(), set, root, options);
    }
    return modules;
}

void ReportUnreadable(const FileScope& scope, const InputFacts& facts, Report& report)
{
    const bool isMissing = facts.state == InputFacts::State::Missing;
    if (isMissing || facts.state == InputFacts::State::Unreadable)
    {
        const Input other = scope.input == Input::Index ? Input::Toc : Input::Index;
        const std::string reason = isMissing ? std::string("is missing beside ") + NameOf(other)
                                             : DescribeUnreadable(scope.file.path);
        report.Add(Finding::OfFile(Rule::Unreadable, scope.file, reason + "; " + scope.Loss()));
    }
}

void CheckModule(SetModule& module, EarlierModules& earlier, Report& report)
{
    for (const auto& input : kInputs)
    {
        module.FactsOf(input.id) = CheckInput(module.ScopeOf(input.id), earlier, report);
    }
    if (!module.HasFiles())
    {
        report.Add(
            Finding::OfFile(Rule::SetEmpty, module.docdata,
                            std::string("has neither index.json nor toc.json: the module adds nothing to ") +
                                NameOf(module.docdata.set)));
        return;
    }
    for (const auto& input : kInputs)
    {
        ReportUnreadable(module.ScopeOf(input.id), module.FactsOf(input.id), report);
    }
}

void CheckCommonWords(DocSet set, const Modules& modules, Report& report)
{
    const auto hasWords = [](const SetModule& module) { return !module.index.commonWords.empty(); };
    const auto counts = std::find_if(modules.begin(), modules.end(), hasWords);
    std::vector<std::string> differing;
    for (auto module = counts; module != modules.end(); ++module)
    {
        if (hasWords(*module) && module->index.commonWords != counts->index.commonWords)
        {
            differing.push_back(module->name);
        }
    }
    if (!differing.empty())
    {
        report.Add(Finding::OfSet(Rule::CommonIgnored, set,
                                  "the common words of " + counts->name +
                                      " count for all modules; those that differ are ignored, of " +
                                      Listed(differing)));
    }
}

/// Returns whether a run writes the set, and reports if it does not though it has files.
bool CheckWhetherWritten(DocSet set, const Modules& modules, Report& report)
{
    const auto has = [&](auto test) { return std::any_of(modules.begin(), modules.end(), test); };
    const bool hasIndex = has([](const SetModule& module) { return module.index.IsSound(); });
    const bool hasToc = has([](const SetModule& module) { return module.toc.IsSound(); });
    const bool hasFiles = has([](const SetModule& module) { return module.HasFiles(); });
    const bool hasOutputs = !(hasIndex && hasToc) && HasOutputs(modules);
    if (!hasFiles && hasOutputs)
    {
        report.Add(
            Finding::OfSet(Rule::NothingToCombine, set,
                           "no module has an index.json or a toc.json, but outputs of an earlier run are "
                           "there: they stay, and readers see them"));
    }
    if (hasFiles && !(hasIndex && hasToc))
    {
        report.Add(Finding::OfSet(Rule::NothingToCombine, set,
                                  std::string("no module has ") +
                                      (hasIndex ? "a sound toc.json"
                                       : hasToc ? "a sound index.json"
                                                : "a sound index.json, and none a sound toc.json") +
                                      ": nothing will be written" +
                                      (hasOutputs ? ", and the outputs of an earlier run stay" : "")));
    }
    return hasIndex && hasToc;
}

void NoteMissing(const Modules& modules, MissingModules& missing)
{
    for (const SetModule& module : modules)
    {
        if (module.HasFiles() && !module.index.IsSound())
        {
            missing.search.push_back(module.root);
        }
        if (module.HasFiles() && (!module.toc.IsSound() || module.isDropped))
        {
            missing.contents.push_back(module.root);
        }
    }
}

} // namespace

bool CheckSet(DocSet set, const std::vector<std::string>& roots, const CheckOptions& options, bool runEnds,
              Report& report)
{
    Modules modules = ModulesOf(set, roots, options);
    EarlierModules earlier;
    for (SetModule& module : modules)
    {
        if (module.hasDocdata)
        {
            CheckModule(module, earlier, report);
        }
    }
    CheckContentRoots(modules, report);
    CheckCommonWords(set, modules, report);
    const bool isWritten = CheckWhetherWritten(set, modules, report);
    runEnds = isWritten ? CheckWritable(modules, runEnds, report) : runEnds;
    if (isWritten && options.checksOutputs)
    {
        CheckOutputs(modules, report);
    }
    if (options.checksOutputs)
    {
        CheckLeftovers(modules, report);
    }
    NoteMissing(modules, report.MissingOf(set));
    return runEnds;
}
