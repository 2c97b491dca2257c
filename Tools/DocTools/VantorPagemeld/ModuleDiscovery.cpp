#include "Tools/DocTools/VantorPagemeld/ModuleDiscovery.h"

#include <cstdlib>

#include <dirent.h>
#include <sys/stat.h>

namespace
{

/// Owns the sorted entries of a directory; none if it can't be listed.
class SortedListing
{
public:
    explicit SortedListing(const char* directory)
        : m_count(::scandir(directory, &m_entries, nullptr, ::alphasort))
    {
    }

    ~SortedListing()
    {
        for (int i = 0; i < m_count; ++i)
        {
            std::free(m_entries[i]);
        }
        std::free(m_entries);
    }

    SortedListing(const SortedListing&) = delete;
    SortedListing& operator=(const SortedListing&) = delete;

    [[nodiscard]] dirent* const* begin() const { return m_entries; }
    [[nodiscard]] dirent* const* end() const { return m_count > 0 ? m_entries + m_count : m_entries; }

private:
    dirent** m_entries = nullptr;
    int m_count;
};

/// Whether the entry is a directory itself, and not a link to one.
bool IsDirectory(const dirent& entry, const std::string& path)
{
    if (entry.d_type != DT_UNKNOWN)
    {
        return entry.d_type == DT_DIR;
    }
    struct stat status = {};
    return ::lstat(path.c_str(), &status) == 0 && S_ISDIR(status.st_mode);
}

bool IsModuleRoot(const std::string& path)
{
    const std::string probe = path + "/Manual/docdata";
    struct stat status = {};
    // The bit alone is asked for, which sockets and block devices have too; this is kept.
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
