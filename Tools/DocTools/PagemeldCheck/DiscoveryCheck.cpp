#include "Tools/DocTools/PagemeldCheck/DiscoveryCheck.h"

#include "Tools/DocTools/PagemeldCheck/Explain/FileProblem.h"
#include "Tools/DocTools/PagemeldCheck/Explain/ShownText.h"
#include "Tools/DocTools/PagemeldCheck/RootCheck.h"
#include "Tools/DocTools/VantorPagemeld/ModuleDiscovery.h"
#include "Tools/DocTools/VantorPagemeld/ModuleLayout.h"
#include "Tools/DocTools/VantorPagemeld/System/DirectoryListing.h"
#include "Tools/DocTools/VantorPagemeld/System/FileStatus.h"

#include <algorithm>
#include <iterator>
#include <set>
#include <string_view>

#include <strings.h>

// pagemeld's search for modules passes over some in silence. The directories are walked again here to find
// these, so that its own walk asks the file system for nothing that it does not need.

namespace
{

bool IsInput(std::string_view name)
{
    return std::any_of(std::begin(kInputs), std::end(kInputs),
                       [&](const auto& input) { return name == input.name; });
}

bool IsPage(std::string_view name)
{
    constexpr std::string_view kEnd = ".html";
    return name.size() > kEnd.size() && name.substr(name.size() - kEnd.size()) == kEnd;
}

/// Whether the name is that of a directory itself, or of the one above it.
bool IsDots(std::string_view name)
{
    return name == "." || name == "..";
}

template <typename Test>
bool HasEntry(const std::string& directory, Test test)
{
    const SortedListing listing(directory.c_str());
    return std::any_of(listing.begin(), listing.end(),
                       [&](const dirent* entry) { return !IsDots(entry->d_name) && test(entry->d_name); });
}

/// Looks for what a walk below a directory does not take, although it looks like a module.
class PassedOverSearch
{
public:
    PassedOverSearch(const std::vector<std::string>& taken, Report& report) : m_report(report)
    {
        for (const std::string& root : taken)
        {
            m_taken.insert(FileStatus::Of(root).Id());
        }
    }

    /// Walks as pagemeld does, and looks at the entries that it does not follow.
    void Walk(const std::string& directory)
    {
        const SortedListing listing(directory.c_str());
        if (listing.Failed())
        {
            Add(directory, "can't be listed, so the modules below it are not found");
        }
        for (const dirent* entry : listing)
        {
            const std::string path = directory + "/" + entry->d_name;
            const bool isItself = IsDirectoryItself(*entry, path);
            if (entry->d_name[0] == '.' || !isItself)
            {
                LookAtUnfollowed(path, entry->d_name, isItself);
            }
            else if (IsModuleRoot(path))
            {
                LookInsideModule(path, path, 2);
            }
            else
            {
                LookAtDirectory(path, entry->d_name);
                Walk(path);
            }
        }
    }

private:
    /// Reports a hidden or linked directory that is a module, or a link to a directory that holds modules.
    /// Those deeper below it are not looked for: a link can lead anywhere.
    void LookAtUnfollowed(const std::string& path, std::string_view name, bool isItself)
    {
        if (IsDots(name) || !FileStatus::Of(path).IsDirectory())
        {
            return;
        }
        if (IsMissed(path))
        {
            Add(path, isItself ? "a hidden module is not taken: its pages will be missing"
                               : "a link to a module is not followed: its pages will be missing");
        }
        else if (!isItself &&
                 HasEntry(path, [&](const std::string& below) { return IsMissed(path + "/" + below); }))
        {
            Add(path, "a link to a directory of modules is not followed: their pages will be missing");
        }
    }

    /// Reports modules inside a module, a few levels deep, so that no tree of pages is walked.
    void LookInsideModule(const std::string& module, const std::string& directory, int levels)
    {
        for (const dirent* entry : SortedListing(directory.c_str()))
        {
            const std::string path = directory + "/" + entry->d_name;
            if (entry->d_name[0] == '.' || !IsDirectoryItself(*entry, path))
            {
                continue;
            }
            if (IsModuleRoot(path))
            {
                Add(path,
                    "a module inside " + Visible(module) + " is not looked for: its pages will be missing");
            }
            else if (levels > 1)
            {
                LookInsideModule(module, path, levels - 1);
            }
        }
    }

    /// Reports a directory that would be a module or a set, but for a name or a level.
    void LookAtDirectory(const std::string& path, const char* name)
    {
        const auto* const set =
            std::find_if(std::begin(kDocSets), std::end(kDocSets),
                         [&](const auto& row) { return ::strcasecmp(row.name, name) == 0; });
        if (set != std::end(kDocSets))
        {
            LookAtSet(path, name, set->name);
        }
        else if (HasSet(path, DocSet::ScriptReference))
        {
            Add(path, "has ScriptReference/docdata but no Manual/docdata, so it is not taken: its pages will "
                      "be missing");
        }
        else if (HasEntry(path + "/" + kDocdata, IsInput))
        {
            Add(path,
                "has docdata itself, which belongs one level deeper, into a directory Manual: its pages will "
                "be missing");
        }
    }

    void LookAtSet(const std::string& path, std::string_view name, const std::string& setName)
    {
        const bool hasDocdata = FileStatus::Of(path + "/" + kDocdata).IsDirectory();
        if (name != setName && hasDocdata)
        {
            Add(path, "is not spelled " + setName + ", so it is not taken: its pages will be missing");
        }
        else if (!hasDocdata && HasEntry(path, IsPage))
        {
            Add(path, "has pages but no docdata, so it is not taken: its pages will be missing");
        }
    }

    /// Whether a module is at path and not taken under any name.
    [[nodiscard]] bool IsMissed(const std::string& path) const
    {
        return IsModule(path) && m_taken.count(FileStatus::Of(path).Id()) == 0;
    }

    void Add(const std::string& path, std::string message)
    {
        m_report.Add(Finding::OfRun(Rule::PassedOver, path, std::move(message)));
    }

    std::set<std::pair<dev_t, ino_t>> m_taken;
    Report& m_report;
};

/// Returns why nothing is found below a directory.
std::string DescribeNoModules(const std::string& directory)
{
    const FileStatus status = FileStatus::Of(directory);
    if (status.Exists() && !status.IsDirectory())
    {
        return "is not a directory";
    }
    if (status.Exists())
    {
        return IsModule(directory) ? "is a module itself: give it as a root"
                                   : "no directory below it has Manual/docdata";
    }
    return DescribeUnreadable(directory);
}

} // namespace

std::vector<std::string> DiscoverRoots(const std::string& directory, Report& report)
{
    std::string converted = directory;
    std::replace(converted.begin(), converted.end(), '\\', '/');
    std::list<std::string> found;
    GetPathsOfDocs(converted, found);
    std::vector<std::string> roots(found.begin(), found.end());
    if (roots.empty())
    {
        report.Add(Finding::OfRun(Rule::NoModules, directory,
                                  DescribeNoModules(converted) + ": nothing will be combined"));
    }
    else if (IsModule(converted))
    {
        report.Add(Finding::OfRun(Rule::PassedOver, directory,
                                  "is a module itself, which is not looked for: its pages will be missing"));
    }
    if (FileStatus::Of(converted).IsDirectory())
    {
        PassedOverSearch(roots, report).Walk(converted);
    }
    return roots;
}
