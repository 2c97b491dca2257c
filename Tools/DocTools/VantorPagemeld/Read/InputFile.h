#pragma once

#include <cstddef>
#include <memory>

/// What reading an input file came to.
struct InputText
{
    enum class Outcome
    {
        Read,
        NotOpened, ///< missing, or not to be read by this user
        NotWhole,  ///< no regular file, above 4 GiB, no memory for it, or it gave fewer bytes than it has
    };

    Outcome outcome = Outcome::NotOpened;
    std::unique_ptr<char[]> bytes; ///< all of the file and a NUL after it; null unless outcome is Read
    long size = 0; ///< of the file in bytes; -1 for what has none, such as a directory or a pipe
    std::size_t bytesRead = 0;
};

/// Reads the whole file at path. Reports nothing.
///
/// Doesn't wait for a writer of a named pipe, which would hold up the build for ever. Waits for the end of a
/// lease that somebody holds on the file, which the system enforces.
[[nodiscard]] InputText ReadInputFile(const char* path);
