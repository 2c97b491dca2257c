#include "Tools/DocTools/VantorPagemeld/Write/SharedText.h"

#include "Tools/DocTools/VantorPagemeld/System/FileStatus.h"

#include <algorithm>
#include <utility>

#ifdef PAGEMELD_HAVE_FILE_CLONES
#include <linux/fs.h>
#include <sys/ioctl.h>
#endif

SharedText::SharedText(TextBuffer text) : m_text(std::move(text)) {}

bool SharedText::WriteTo(ScopedFile file, std::string_view head)
{
    if (head.empty() && CloneTo(file.get()))
    {
        return true;
    }
    // The flush comes last: a write that only filled the buffer has proved nothing yet.
    return WriteText(file.get(), head) && WriteText(file.get(), TextOf(m_text)) &&
           std::fflush(file.get()) == 0;
}

#ifdef PAGEMELD_HAVE_FILE_CLONES
bool SharedText::CloneTo(std::FILE* file) const
{
    const ScopedFile original(m_originalPath.empty() ? nullptr : std::fopen(m_originalPath.c_str(), "rb"));
    if (original == nullptr || ::ioctl(::fileno(file), FICLONE, ::fileno(original.get())) != 0)
    {
        return false;
    }
    // The original can have been cut short by a full disk. Or file is the original itself, by a link: opening
    // it has then emptied the original.
    const FileStatus status = FileStatus::Of(file);
    return status.Exists() && static_cast<std::size_t>(status.Details().st_size) == m_text.GetSize();
}
#else
bool SharedText::CloneTo(std::FILE*) const
{
    return false;
}
#endif

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
