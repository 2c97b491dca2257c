#pragma once

#include <cstdio>
#include <memory>

struct FileCloser
{
    void operator()(std::FILE* file) const
    {
        // Writers whose result matters flush first, so that no error is left for the close to report.
        (void)std::fclose(file);
    }
};

/// Owns an open C stream, or nothing when the open failed.
using ScopedFile = std::unique_ptr<std::FILE, FileCloser>;
