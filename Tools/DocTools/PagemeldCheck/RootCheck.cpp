#include "Tools/DocTools/PagemeldCheck/RootCheck.h"

#include "Tools/DocTools/PagemeldCheck/Explain/ShownText.h"
#include "Tools/DocTools/VantorPagemeld/ModuleDiscovery.h"
#include "Tools/DocTools/VantorPagemeld/ModuleLayout.h"
#include "Tools/DocTools/VantorPagemeld/System/FileStatus.h"

#include <algorithm>
#include <iterator>
#include <map>

namespace
{

const char* DescribePassedOver(PassedOver reason)
{
    switch (reason)
    {
    case PassedOver::Link:
        return "a link to a module is not followed: its pages will be missing";
    case PassedOver::Hidden:
        return "a hidden module is not taken: its pages will be missing";
    default:
        return "has ScriptReference/docdata but no Manual/docdata, so it is not taken: its pages will be "
               "missing";
    }
}

bool IsModule(const std::string& root)
{
    return std::any_of(std::begin(kDocSets), std::end(kDocSets),
                       [&](const auto& set)
                       { return FileStatus::Of(ModulePath(root, set.id).Docdata()).IsDirectory(); });
}

/// Reports the first root if none is a module. If only some are not, output-blocked reports each of them in
/// every set that is written.
void ReportIfNoneIsModule(const std::vector<std::string>& roots, Report& report)
{
    if (!roots.empty() && std::none_of(roots.begin(), roots.end(), IsModule))
    {
        report.Add(Finding::OfRoot(
            Rule::NoModules, 0, roots[0],
            std::string("neither Manual/docdata nor ScriptReference/docdata is found in it") +
                (roots.size() > 1 ? ", nor in any other root" : "") + ": nothing will be combined"));
    }
}

void ReportDuplicates(const std::vector<std::string>& roots, Report& report)
{
    std::map<std::pair<dev_t, ino_t>, std::size_t> known;
    for (std::size_t i = 0; i < roots.size(); ++i)
    {
        const FileStatus status = FileStatus::Of(roots[i]);
        if (!status.Exists())
        {
            continue;
        }
        const auto [first, isNew] = known.try_emplace({status.Details().st_dev, status.Details().st_ino}, i);
        if (!isNew)
        {
            report.Add(Finding::OfRoot(Rule::DuplicateRoot, i, roots[i],
                                       "is the same directory as " + Visible(roots[first->second]) +
                                           ": its pages will be in the search twice"));
        }
    }
}

} // namespace

void DiscoverRoots(const std::string& directory, std::vector<std::string>& roots, Report& report)
{
    std::string converted = directory;
    std::replace(converted.begin(), converted.end(), '\\', '/');
    std::list<std::string> found;
    FindModules(converted, found,
                [&](const std::string& path, PassedOver reason)
                { report.Add(Finding::OfRun(Rule::PassedOver, path, DescribePassedOver(reason))); });
    roots.assign(found.begin(), found.end());
    if (roots.empty())
    {
        report.Add(Finding::OfRun(Rule::NoModules, directory,
                                  "no directory below it has Manual/docdata: nothing will be combined"));
    }
}

void CheckRoots(const std::vector<std::string>& roots, Report& report)
{
    ReportIfNoneIsModule(roots, report);
    ReportDuplicates(roots, report);
}
