#include "Tools/DocTools/VantorPagemeld/Output/ScopedFile.h"

#include <utility>

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

namespace
{

ScopedFile Open(const char* path, int flags, const char* mode)
{
    constexpr mode_t kReadableAndWritable = 0666; // less what the process's mask takes away
    const int descriptor = ::open(path, flags | O_NONBLOCK | O_CLOEXEC, kReadableAndWritable);
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
    return Open(path, O_RDONLY, "rb");
}

ScopedFile OpenForWriting(const char* path)
{
    ScopedFile file = Open(path, O_RDWR | O_CREAT | O_TRUNC, "w+b");
    return file != nullptr && IsPipe(file.get()) ? nullptr : std::move(file);
}
