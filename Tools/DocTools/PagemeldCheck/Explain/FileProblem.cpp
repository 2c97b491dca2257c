#include "Tools/DocTools/PagemeldCheck/Explain/FileProblem.h"

#include "Tools/DocTools/VantorPagemeld/System/FileStatus.h"

#include <cerrno>
#include <cstdint>
#include <filesystem>

#include <fcntl.h>
#include <unistd.h>

namespace
{

bool MayAccess(const std::string& path, int mode)
{
    return ::faccessat(AT_FDCWD, path.c_str(), mode, AT_EACCESS) == 0;
}

/// Returns why nothing is at path, or can't be reached there.
std::string DescribeAbsence(const std::string& path, int error)
{
    switch (error)
    {
    case EACCES:
        return "can't be reached: permission denied";
    case ELOOP:
        return "is a link that leads back to itself";
    default:
        return FileStatus::OfEntry(path).IsLink() ? "is a link to what does not exist" : "is missing";
    }
}

/// Whether a link, or the last of several, leads to a name that can be made.
bool LeadsToFreeName(std::filesystem::path path)
{
    constexpr int kMaxLinks = 40; // as many as Linux follows
    std::error_code ignored;
    for (int i = 0; i < kMaxLinks && FileStatus::OfEntry(path).IsLink(); ++i)
    {
        path = path.parent_path() / std::filesystem::read_symlink(path, ignored);
    }
    return DescribeUnwritableDirectory(path.parent_path()).empty();
}

/// What can't be opened for what its kind is; an empty text for files and devices.
std::string DescribeKind(const FileStatus& status)
{
    return status.IsDirectory() ? "a directory"
           : status.IsPipe()    ? "a pipe"
           : status.IsSocket()  ? "a socket"
                                : "";
}

} // namespace

std::string DescribeUnreadable(const std::string& path)
{
    const FileStatus status = FileStatus::Of(path);
    if (!status.Exists())
    {
        return DescribeAbsence(path, status.Error());
    }
    const std::string kind = DescribeKind(status);
    if (!kind.empty())
    {
        return "is " + kind + ", not a file";
    }
    if (!MayAccess(path, R_OK))
    {
        return "can't be read: permission denied";
    }
    return status.Details().st_size > UINT32_MAX ? "can't be read: it is larger than 4 GiB" : "can't be read";
}

std::string DescribeUnwritableDirectory(const std::string& path)
{
    const FileStatus status = FileStatus::Of(path);
    if (!status.Exists())
    {
        return DescribeAbsence(path, status.Error());
    }
    if (!status.IsDirectory())
    {
        return "is not a directory";
    }
    return MayAccess(path, W_OK | X_OK) ? ""
           : errno == EROFS             ? "is on a file system that is read-only"
                                        : "can't be written to: permission denied";
}

std::string DescribeObstacle(const std::string& path)
{
    const FileStatus status = FileStatus::Of(path);
    if (status.Exists())
    {
        const std::string kind = DescribeKind(status);
        return !kind.empty() || MayAccess(path, R_OK | W_OK) ? kind : "a file that can't be read and written";
    }
    if (!FileStatus::OfEntry(path).IsLink() || (status.Error() == ENOENT && LeadsToFreeName(path)))
    {
        return "";
    }
    return status.Error() == ELOOP ? "a link that leads back to itself"
                                   : "a link to where no file can be made";
}

bool IsReservedForOwner(const std::string& directory, const std::string& path)
{
    const FileStatus holder = FileStatus::Of(directory);
    const FileStatus entry = FileStatus::OfEntry(path);
    const uid_t user = ::geteuid();
    return user != 0 && (holder.Details().st_mode & S_ISVTX) != 0 && holder.Details().st_uid != user &&
           entry.Exists() && entry.Details().st_uid != user;
}
