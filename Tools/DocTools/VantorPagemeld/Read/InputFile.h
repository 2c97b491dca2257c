#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>

/// The result of reading an input file.
struct InputText
{
    enum class Outcome
    {
        Read,
        NotOpened, ///< missing, or not readable by this user
        NotWhole,  ///< a directory or pipe, above 4 GiB, out of memory, or not as many bytes came as its size
    };

    Outcome outcome = Outcome::NotOpened;
    std::unique_ptr<char[]> bytes; ///< all of the file and a NUL after it; null unless outcome is Read
    std::int64_t size = 0; ///< of the file in bytes; -1 for what has none, such as a directory or a pipe
    std::size_t bytesRead = 0;
};

/// Reads the whole file at path. Reports nothing.
///
/// Doesn't wait for the writer of a named pipe, which could block the build for ever. If another process
/// holds a lease on the file, waits until it gives the lease back or the system ends the lease.
[[nodiscard]] InputText ReadInputFile(const char* path);
