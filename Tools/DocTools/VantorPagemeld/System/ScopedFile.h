#pragma once

#include <cstdio>
#include <memory>

struct FileCloser
{
    void operator()(std::FILE* file) const
    {
        // Where it matters, a flush has reported before what a close could still report.
        (void)std::fclose(file);
    }
};

/// Owns an open C stream, or nothing when the open failed.
using ScopedFile = std::unique_ptr<std::FILE, FileCloser>;
