#include "Tools/DocTools/PagemeldCheck/RootCheck.h"

#include "Tools/DocTools/PagemeldCheck/Explain/ShownText.h"
#include "Tools/DocTools/VantorPagemeld/ModuleLayout.h"
#include "Tools/DocTools/VantorPagemeld/System/FileStatus.h"

#include <algorithm>
#include <iterator>
#include <map>

namespace
{

/// Reports roots that do not exist. Whatever else is wrong with them follows from that.
void ReportMissing(const std::vector<std::string>& roots, Report& report)
{
    for (std::size_t i = 0; i < roots.size(); ++i)
    {
        if (!RootExists(roots[i]))
        {
            report.Add(
                Finding::OfRoot(Rule::MissingRoot, i, roots[i],
                                "does not exist: a run ends with status 255 where it comes to its outputs, "
                                "and later modules stay unwritten"));
        }
    }
}

/// Reports the first root that exists if none is a module. If only some are not, output-blocked reports each
/// of them in every set that is written.
void ReportIfNoneIsModule(const std::vector<std::string>& roots, Report& report)
{
    const auto first = std::find_if(roots.begin(), roots.end(), RootExists);
    if (first != roots.end() && std::none_of(roots.begin(), roots.end(), IsModule))
    {
        report.Add(Finding::OfRoot(
            Rule::NoModules, static_cast<std::size_t>(first - roots.begin()), *first,
            std::string("neither Manual/docdata nor ScriptReference/docdata is found in it") +
                (roots.size() > 1 ? ", nor in any other root" : "") + ": nothing will be combined"));
    }
}

/// Finds directories that have two names.
class KnownDirectories
{
public:
    /// Returns the path of a directory that is the same as the one at path, and was asked for earlier; an
    /// empty text if there is none, or no directory is at path.
    std::string FindSame(const std::string& path)
    {
        const FileStatus status = FileStatus::Of(path);
        if (!status.IsDirectory())
        {
            return "";
        }
        const auto [known, isNew] = m_paths.try_emplace(status.Id(), path);
        return isNew ? "" : Visible(known->second);
    }

private:
    std::map<std::pair<dev_t, ino_t>, std::string> m_paths;
};

/// Reports a set of a root whose docdata directory is that of another root or set.
void ReportSharedDocdata(const std::string& root, std::size_t position, KnownDirectories& known,
                         Report& report)
{
    for (const auto& set : kDocSets)
    {
        const std::string same = known.FindSame(ModulePath(root, set.id).Docdata());
        if (!same.empty())
        {
            report.Add(Finding::OfRoot(Rule::DuplicateRoot, position, root,
                                       std::string(set.name) + "/" + kDocdata + " is the same directory as " +
                                           same + ": the outputs of one replace those of the other"));
        }
    }
}

void ReportDuplicates(const std::vector<std::string>& roots, Report& report)
{
    KnownDirectories knownRoots;
    KnownDirectories knownDocdata;
    for (std::size_t i = 0; i < roots.size(); ++i)
    {
        const std::string same = knownRoots.FindSame(roots[i]);
        if (same.empty())
        {
            ReportSharedDocdata(roots[i], i, knownDocdata, report);
            continue;
        }
        report.Add(
            Finding::OfRoot(Rule::DuplicateRoot, i, roots[i],
                            "is the same directory as " + same + ": its pages will be in the search twice"));
    }
}

} // namespace

bool RootExists(const std::string& root)
{
    return FileStatus::Of(root.empty() ? "/" : root).Exists();
}

bool HasSet(const std::string& root, DocSet set)
{
    return FileStatus::Of(ModulePath(root, set).Docdata()).IsDirectory();
}

bool IsModule(const std::string& root)
{
    return std::any_of(std::begin(kDocSets), std::end(kDocSets),
                       [&](const auto& set) { return HasSet(root, set.id); });
}

void CheckRoots(const std::vector<std::string>& roots, Report& report)
{
    ReportMissing(roots, report);
    ReportIfNoneIsModule(roots, report);
    ReportDuplicates(roots, report);
}
