#include "Tools/DocTools/VantorPagemeld/Output/RenderedText.h"

#include <algorithm>
#include <cstring>

void AppendText(RenderedText& destination, std::string_view text)
{
    if (!text.empty())
    {
        std::memcpy(destination.Push(text.size()), text.data(), text.size());
    }
}

std::string_view TextOf(const RenderedText& text)
{
    return {text.GetString(), text.GetSize()};
}

bool WriteText(std::FILE* stream, std::string_view text)
{
    // One write of all makes the kernel look for long runs of fresh memory, which takes ext4 two to four
    // times as long; blocks of 64 KB cost more calls.
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
