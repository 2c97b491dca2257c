#include "Tools/DocTools/VantorPagemeld/ModuleDiscovery.h"

#include "Tools/DocTools/VantorPagemeld/ModulePath.h"
#include "Tools/DocTools/VantorPagemeld/System/DirectoryListing.h"

#include <sys/stat.h>

namespace
{

bool IsModuleRoot(const std::string& path)
{
    const std::string probe = ModulePath(path, "Manual").File("docdata");
    struct stat status = {};
    // Only the directory bit is tested, which sockets and block devices have too; this is intentional.
    return ::stat(probe.c_str(), &status) == 0 && (status.st_mode & S_IFDIR) != 0;
}

} // namespace

void GetPathsOfDocs(const std::string& directory, std::list<std::string>& moduleRoots)
{
    for (const dirent* entry : SortedListing(directory.c_str()))
    {
        const std::string path = directory + "/" + entry->d_name;
        if (entry->d_name[0] == '.' || !IsDirectory(*entry, path))
        {
            continue;
        }
        if (IsModuleRoot(path))
        {
            moduleRoots.push_back(path);
        }
        else
        {
            GetPathsOfDocs(path, moduleRoots);
        }
    }
}
