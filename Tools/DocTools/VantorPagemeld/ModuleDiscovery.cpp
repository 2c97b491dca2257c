#include "Tools/DocTools/VantorPagemeld/ModuleDiscovery.h"

#include "Tools/DocTools/VantorPagemeld/ModulePath.h"
#include "Tools/DocTools/VantorPagemeld/System/DirectoryListing.h"

#include <string_view>

#include <sys/stat.h>

namespace
{

bool HasDocdata(const std::string& path, const char* setName)
{
    const std::string probe = ModulePath(path, setName).File("docdata");
    struct stat status = {};
    // Only the directory bit is tested, which sockets and block devices have too; this is intentional.
    return ::stat(probe.c_str(), &status) == 0 && (status.st_mode & S_IFDIR) != 0;
}

bool IsModuleRoot(const std::string& path)
{
    return HasDocdata(path, "Manual");
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
        if (entry->d_name[0] == '.' || !IsDirectory(*entry, path))
        {
            ReportPassedOver(path, entry->d_name, onPassedOver);
            continue;
        }
        if (IsModuleRoot(path))
        {
            moduleRoots.push_back(path);
            continue;
        }
        if (onPassedOver && HasDocdata(path, "ScriptReference"))
        {
            onPassedOver(path, PassedOver::WithoutManual);
        }
        FindModules(path, moduleRoots, onPassedOver);
    }
}
