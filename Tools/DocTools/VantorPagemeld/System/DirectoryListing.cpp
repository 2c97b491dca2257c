#include "Tools/DocTools/VantorPagemeld/System/DirectoryListing.h"

#include "Tools/DocTools/VantorPagemeld/System/FileStatus.h"

#include <cstdlib>

SortedListing::SortedListing(const char* directory)
    : m_count(::scandir(directory, &m_entries, nullptr, ::alphasort))
{
}

SortedListing::~SortedListing()
{
    for (int i = 0; i < m_count; ++i)
    {
        std::free(m_entries[i]);
    }
    std::free(m_entries);
}

bool IsDirectoryItself([[maybe_unused]] const dirent& entry, const std::string& path)
{
#ifdef PAGEMELD_HAVE_DIRENT_TYPE
    if (entry.d_type != DT_UNKNOWN)
    {
        return entry.d_type == DT_DIR;
    }
#endif
    return FileStatus::OfEntry(path).IsDirectory();
}
