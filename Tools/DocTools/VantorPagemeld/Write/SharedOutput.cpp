#include "Tools/DocTools/VantorPagemeld/Write/SharedOutput.h"

#include "Tools/DocTools/VantorPagemeld/ModuleLayout.h"
#include "Tools/DocTools/VantorPagemeld/System/FileStatus.h"
#include "Tools/DocTools/VantorPagemeld/System/ScopedFile.h"

#include <algorithm>
#include <cerrno>

#include <unistd.h>

#ifdef PAGEMELD_HAVE_FILE_CLONES
#include <linux/fs.h>
#include <sys/ioctl.h>
#endif

// Readers open outputs at any time, and a run can be killed at any time. So each output is written under a
// temporary name, and renamed only then: the rename replaces the old file by the new one in one step.

namespace
{

/// Returns null when the open fails or a named pipe is at path. A pipe would store nothing, and its reader
/// could block the run.
ScopedFile OpenForWriting(const char* path)
{
    ScopedFile file(std::fopen(path, "w+b")); // does not wait: it opens both ends of a pipe
    return file != nullptr && FileStatus::Of(file.get()).IsPipe() ? nullptr : std::move(file);
}

/// Makes an empty file share the content of another. Returns 0, or an errno that says why it does not.
int Clone([[maybe_unused]] std::FILE* file, [[maybe_unused]] std::FILE* original)
{
#ifdef PAGEMELD_HAVE_FILE_CLONES
    return ::ioctl(::fileno(file), FICLONE, ::fileno(original)) == 0 ? 0 : errno;
#else
    return EOPNOTSUPP;
#endif
}

} // namespace

bool SharedOutput::Write(const char* path, std::string_view head)
{
    ScopedFile file = OpenForWriting(path);
    if (file == nullptr)
    {
        m_kind.reportUnopened(path);
        return false;
    }
    const bool isComplete = WriteTo(file.get(), head);
    file.reset(); // no file is renamed or removed while it is open
    if (isComplete || m_kind.keepsIncomplete)
    {
        return true;
    }
    (void)::unlink(path);
    return false;
}

void SharedOutput::Replace(const std::string& path, std::string_view head)
{
    const std::string temporaryPath = TemporaryPathOf(path);
    const bool isReplaced =
        Write(temporaryPath.c_str(), head) && std::rename(temporaryPath.c_str(), path.c_str()) == 0;
    if (isReplaced && head.empty())
    {
        m_originalPath = path;
    }
}

/// Returns whether every byte reached the file.
bool SharedOutput::WriteTo(std::FILE* file, std::string_view head)
{
    if (head.empty() && m_canClone && CloneTo(file))
    {
        return true;
    }
    // The flush proves that the file is whole: a write that only filled the buffer has proved nothing yet.
    // The result of the close is deliberately not examined.
    return WriteText(file, head) && WriteText(file, TextOf(m_body)) && std::fflush(file) == 0;
}

bool SharedOutput::CloneTo(std::FILE* file)
{
    // Opened anew each time: an original that stayed open would be renamed while it is open.
    const ScopedFile original(m_originalPath.empty() ? nullptr : std::fopen(m_originalPath.c_str(), "rb"));
    if (original == nullptr)
    {
        return false;
    }
    const int error = Clone(file, original.get());
    m_canClone = error != EOPNOTSUPP;
    // The original can have been cut short by a full disk. Or file is the original itself, by a link: opening
    // it has then emptied the original.
    return error == 0 && static_cast<std::size_t>(FileStatus::Of(file).Details().st_size) == m_body.GetSize();
}

bool WriteText(std::FILE* stream, std::string_view text)
{
    // A single write of everything makes the kernel look for long runs of fresh memory, which takes ext4 two
    // to four times as long; blocks of 64 KB cost more calls.
    constexpr std::size_t kBlockSize = std::size_t{1} << 20;
    for (; !text.empty(); text.remove_prefix(std::min(kBlockSize, text.size())))
    {
        const std::string_view block = text.substr(0, kBlockSize);
        if (std::fwrite(block.data(), 1, block.size(), stream) != block.size())
        {
            return false;
        }
    }
    return true;
}
