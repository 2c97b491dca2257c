#include "Tools/DocTools/VantorPagemeld/ModuleDiscovery.h"

#include "Tools/DocTools/VantorPagemeld/ModuleLayout.h"
#include "Tools/DocTools/VantorPagemeld/System/DirectoryListing.h"
#include "Tools/DocTools/VantorPagemeld/System/FileStatus.h"

#include <string_view>

namespace
{

bool HasDocdata(const std::string& path, DocSet set)
{
    // Only the directory bit is tested, which sockets and block devices have too; this is intentional.
    return (FileStatus::Of(ModulePath(path, set).Docdata()).Details().st_mode & S_IFDIR) != 0;
}

bool IsModuleRoot(const std::string& path)
{
    return HasDocdata(path, DocSet::Manual);
}

/// Reports a hidden or linked entry that leads to a module.
void ReportPassedOver(const std::string& path, const char* name, const PassedOverHandler& onPassedOver)
{
    const std::string_view entry = name;
    if (onPassedOver && entry != "." && entry != ".." && IsModuleRoot(path))
    {
        onPassedOver(path, entry.front() == '.' ? PassedOver::Hidden : PassedOver::Link);
    }
}

} // namespace

void GetPathsOfDocs(const std::string& directory, std::list<std::string>& moduleRoots)
{
    FindModules(directory, moduleRoots, nullptr);
}

void FindModules(const std::string& directory, std::list<std::string>& moduleRoots,
                 const PassedOverHandler& onPassedOver)
{
    for (const dirent* entry : SortedListing(directory.c_str()))
    {
        const std::string path = directory + "/" + entry->d_name;
        if (entry->d_name[0] == '.' || !IsDirectoryItself(*entry, path))
        {
            ReportPassedOver(path, entry->d_name, onPassedOver);
            continue;
        }
        if (IsModuleRoot(path))
        {
            moduleRoots.push_back(path);
            continue;
        }
        if (onPassedOver && HasDocdata(path, DocSet::ScriptReference))
        {
            onPassedOver(path, PassedOver::WithoutManual);
        }
        FindModules(path, moduleRoots, onPassedOver);
    }
}
