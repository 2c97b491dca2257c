#include "Tools/DocTools/VantorPagemeld/Output/ScopedFile.h"

#include <cerrno>
#include <utility>

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

namespace
{

/// Returns the stream of a descriptor, which it owns from then on, or nothing for one that is negative.
ScopedFile StreamOf(int descriptor, const char* mode)
{
    if (descriptor < 0)
    {
        return nullptr;
    }
    ScopedFile file(::fdopen(descriptor, mode));
    if (file == nullptr)
    {
        (void)::close(descriptor);
    }
    return file;
}

bool IsPipe(std::FILE* file)
{
    struct stat status = {};
    return ::fstat(::fileno(file), &status) == 0 && S_ISFIFO(status.st_mode);
}

} // namespace

ScopedFile OpenForReading(const char* path)
{
    int descriptor = ::open(path, O_RDONLY | O_CLOEXEC | O_NONBLOCK);
    if (descriptor < 0 && errno == EWOULDBLOCK)
    {
        // Somebody holds a lease on a regular file, and gives it back when asked.
        descriptor = ::open(path, O_RDONLY | O_CLOEXEC);
    }
    return StreamOf(descriptor, "rb");
}

ScopedFile OpenForWriting(const char* path)
{
    ScopedFile file(std::fopen(path, "w+b")); // does not wait, as it asks for both ends of a pipe
    return file != nullptr && IsPipe(file.get()) ? nullptr : std::move(file);
}
