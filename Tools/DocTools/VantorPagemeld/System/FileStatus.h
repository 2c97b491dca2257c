#pragma once

#include <cerrno>
#include <cstdio>
#include <string>
#include <utility>

#include <sys/stat.h>

/// What the system tells of a file, directory or anything else that has a name.
class FileStatus
{
public:
    /// Of what is at path, after following links.
    static FileStatus Of(const std::string& path) { return Ask(::stat, path.c_str()); }

    /// Of what is at path itself, which may be a link.
    static FileStatus OfEntry(const std::string& path) { return Ask(::lstat, path.c_str()); }

    static FileStatus Of(std::FILE* file) { return Ask(::fstat, ::fileno(file)); }

    /// Whether something is there. Otherwise every other question about it is answered by no.
    [[nodiscard]] bool Exists() const { return m_error == 0; }

    /// Why nothing is there: an errno such as ENOENT, or EACCES if a directory may hide it.
    [[nodiscard]] int Error() const { return m_error; }

    [[nodiscard]] bool IsDirectory() const { return S_ISDIR(m_status.st_mode); }
    [[nodiscard]] bool IsRegularFile() const { return S_ISREG(m_status.st_mode); }
    [[nodiscard]] bool IsPipe() const { return S_ISFIFO(m_status.st_mode); }
    [[nodiscard]] bool IsSocket() const { return S_ISSOCK(m_status.st_mode); }
    [[nodiscard]] bool IsLink() const { return S_ISLNK(m_status.st_mode); }
    [[nodiscard]] bool IsDevice() const { return S_ISCHR(m_status.st_mode) || S_ISBLK(m_status.st_mode); }

    /// What tells apart all that is there at one time, whatever its names are.
    [[nodiscard]] std::pair<dev_t, ino_t> Id() const { return {m_status.st_dev, m_status.st_ino}; }

    /// All else that the system tells; zeros if nothing is there.
    [[nodiscard]] const struct stat& Details() const { return m_status; }

private:
    FileStatus() = default;

    template <class Call, class Subject>
    static FileStatus Ask(Call call, Subject subject)
    {
        FileStatus status;
        status.m_error = call(subject, &status.m_status) == 0 ? 0 : errno;
        return status;
    }

    struct stat m_status = {};
    int m_error = 0;
};
