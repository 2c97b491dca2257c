#include "Runtime/Utilities/AsciiCase.h"

#include <algorithm>

namespace
{

char ToLowerByte(char byte)
{
    return byte >= 'A' && byte <= 'Z' ? static_cast<char>(byte - 'A' + 'a') : byte;
}

} // namespace

core::string ToLower(std::string_view text)
{
    core::string lower(text);
    std::transform(lower.begin(), lower.end(), lower.begin(), ToLowerByte);
    return lower;
}

bool EqualsIgnoringCase(std::string_view a, std::string_view b)
{
    return ToLower(a) == ToLower(b);
}

bool BeginsWithIgnoringCase(std::string_view text, std::string_view prefix)
{
    return EqualsIgnoringCase(text.substr(0, prefix.size()), prefix);
}
