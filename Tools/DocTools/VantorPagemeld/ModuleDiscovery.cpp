#include "Tools/DocTools/VantorPagemeld/ModuleDiscovery.h"

#include "Tools/DocTools/VantorPagemeld/ModuleLayout.h"
#include "Tools/DocTools/VantorPagemeld/System/DirectoryListing.h"
#include "Tools/DocTools/VantorPagemeld/System/FileStatus.h"

void GetPathsOfDocs(const std::string& directory, std::list<std::string>& moduleRoots)
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
            moduleRoots.push_back(path);
        }
        else
        {
            GetPathsOfDocs(path, moduleRoots);
        }
    }
}

bool IsModuleRoot(const std::string& path)
{
    return (FileStatus::Of(ModulePath(path, DocSet::Manual).Docdata()).Details().st_mode & S_IFDIR) != 0;
}
