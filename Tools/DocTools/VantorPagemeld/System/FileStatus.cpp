#include "Tools/DocTools/VantorPagemeld/System/FileStatus.h"

#include <cerrno>

FileStatus FileStatus::Of(const std::string& path)
{
    FileStatus status;
    status.m_error = ::stat(path.c_str(), &status.m_status) == 0 ? 0 : errno;
    return status;
}

FileStatus FileStatus::OfEntry(const std::string& path)
{
    FileStatus status;
    status.m_error = ::lstat(path.c_str(), &status.m_status) == 0 ? 0 : errno;
    return status;
}

FileStatus FileStatus::Of(std::FILE* file)
{
    FileStatus status;
    status.m_error = ::fstat(::fileno(file), &status.m_status) == 0 ? 0 : errno;
    return status;
}
