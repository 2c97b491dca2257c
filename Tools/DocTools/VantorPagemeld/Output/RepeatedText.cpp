#include "Tools/DocTools/VantorPagemeld/Output/RepeatedText.h"

#include <utility>

#include <linux/fs.h>
#include <sys/ioctl.h>
#include <sys/stat.h>

RepeatedText::RepeatedText(RenderedText text) : m_text(std::move(text)) {}

void RepeatedText::WriteTo(ScopedFile file)
{
    if (CloneTo(file.get()))
    {
        return;
    }
    const bool isWritten = WriteText(file.get(), TextOf(m_text)) && std::fflush(file.get()) == 0;
    if (isWritten && m_original == nullptr)
    {
        m_original = std::move(file);
    }
}

bool RepeatedText::CloneTo(std::FILE* file) const
{
    if (m_original == nullptr || ::ioctl(::fileno(file), FICLONE, ::fileno(m_original.get())) != 0)
    {
        return false;
    }
    // Opening the file may have emptied the original: under a name that leads to it, after a failed rename.
    struct stat status = {};
    return ::fstat(::fileno(file), &status) == 0 &&
           static_cast<std::size_t>(status.st_size) == m_text.GetSize();
}
