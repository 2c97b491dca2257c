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
