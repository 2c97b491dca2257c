#include "Tools/DocTools/VantorPagemeld/Read/InputFile.h"

#include "Tools/DocTools/VantorPagemeld/System/FileStatus.h"
#include "Tools/DocTools/VantorPagemeld/System/ScopedFile.h"

#include <algorithm>
#include <cerrno>
#include <new>
#include <utility>

#include <fcntl.h>
#include <unistd.h>

namespace
{

/// The parser counts in 32 bits, and a NUL is added.
constexpr std::int64_t kMaxFileSize = std::min<std::uint64_t>(UINT32_MAX, SIZE_MAX - 1);

int OpenDescriptor(const char* path)
{
    const int descriptor = ::open(path, O_RDONLY | O_CLOEXEC | O_NONBLOCK);
    if (descriptor < 0 && errno == EWOULDBLOCK)
    {
        // Another process holds a lease on this regular file: a blocking open asks for it back.
        return ::open(path, O_RDONLY | O_CLOEXEC);
    }
    return descriptor;
}

ScopedFile OpenForReading(const char* path)
{
    const int descriptor = OpenDescriptor(path);
    ScopedFile file(descriptor < 0 ? nullptr : ::fdopen(descriptor, "rb"));
    if (file == nullptr && descriptor >= 0)
    {
        (void)::close(descriptor);
    }
    return file;
}

/// Returns the size in bytes, or -1 for what has none: a directory, whatever its file system reports, or a
/// pipe. Leaves the stream at its start.
std::int64_t SizeOf(std::FILE* file)
{
    const FileStatus status = FileStatus::Of(file);
    if (!status.Exists() || status.IsDirectory() || ::fseeko(file, 0, SEEK_END) != 0)
    {
        return -1;
    }
    const std::int64_t size = ::ftello(file);
    std::rewind(file);
    return size;
}

/// Returns size + 1 bytes that are not set yet, or null when the size is out of bounds or memory ran out.
std::unique_ptr<char[]> AllocateText(std::int64_t size)
{
    return std::unique_ptr<char[]>(size >= 0 && size <= kMaxFileSize
                                       ? new (std::nothrow) char[static_cast<std::size_t>(size) + 1]
                                       : nullptr);
}

} // namespace

InputText ReadInputFile(const char* path)
{
    InputText text;
    const ScopedFile file = OpenForReading(path);
    if (file == nullptr)
    {
        return text;
    }
    text.outcome = InputText::Outcome::NotWhole;
    text.size = SizeOf(file.get());
    std::unique_ptr<char[]> bytes = AllocateText(text.size);
    const auto size = bytes == nullptr ? 0 : static_cast<std::size_t>(text.size);
    text.bytesRead = std::fread(bytes.get(), 1, size, file.get());
    if (bytes != nullptr && text.bytesRead == size)
    {
        bytes[size] = '\0';
        text.bytes = std::move(bytes);
        text.outcome = InputText::Outcome::Read;
    }
    return text;
}
