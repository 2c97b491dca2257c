#include "Tools/DocTools/VantorPagemeld/Output/RenderedText.h"

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
    return std::fwrite(text.data(), 1, text.size(), stream) == text.size();
}
