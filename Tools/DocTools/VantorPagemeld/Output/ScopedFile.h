#pragma once

#include <cstdio>
#include <memory>

struct FileCloser
{
    void operator()(std::FILE* file) const
    {
        // What a close could still report was asked for before, where it matters.
        (void)std::fclose(file);
    }
};

/// Owns an open C stream, or nothing when the open failed.
using ScopedFile = std::unique_ptr<std::FILE, FileCloser>;

/// Opens a file for reading. Returns nothing when that fails.
///
/// Doesn't wait for a writer of a named pipe, which would hold up the build for ever. Waits for the end of a
/// lease that somebody holds on the file, which the system sees to.
[[nodiscard]] ScopedFile OpenForReading(const char* path);

/// Opens a file for writing and reading, created if it is missing and emptied if it is there. Returns nothing
/// when that fails, or when a named pipe stands there, which keeps nothing and makes its writer wait.
[[nodiscard]] ScopedFile OpenForWriting(const char* path);
