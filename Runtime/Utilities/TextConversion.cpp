#include "Runtime/Utilities/TextConversion.h"

#include <algorithm>
#include <cstdarg>
#include <cstdint>
#include <cstdio>
#include <iterator>

namespace
{

char ToLowerByte(char byte)
{
    return byte >= 'A' && byte <= 'Z' ? static_cast<char>(byte - 'A' + 'a') : byte;
}

std::uint32_t ByteAt(std::string_view text, std::size_t position)
{
    return static_cast<unsigned char>(text[position]);
}

/// The multi-byte forms of UTF-8 as first defined, with up to six bytes a character; each is recognised by
/// the fixed bits of its first byte. Later definitions stop at four bytes, but names are shown by this one.
struct Utf8Form
{
    std::uint32_t leadMask;
    std::uint32_t lead;
    std::size_t length;
    std::uint32_t smallestCharacter;
};

constexpr Utf8Form kForms[] = {
    {0xE0, 0xC0, 2, 0x80},      {0xF0, 0xE0, 3, 0x800},      {0xF8, 0xF0, 4, 0x10000},
    {0xFC, 0xF8, 5, 0x20'0000}, {0xFE, 0xFC, 6, 0x400'0000},
};

/// Returns the form that the first byte announces, or null.
const Utf8Form* FindForm(std::uint32_t lead)
{
    const auto* const found =
        std::find_if(std::begin(kForms), std::end(kForms),
                     [lead](const Utf8Form& form) { return (lead & form.leadMask) == form.lead; });
    return found == std::end(kForms) ? nullptr : found;
}

bool IsExcluded(std::uint32_t character)
{
    const bool isSurrogate = character >= 0xD800 && character <= 0xDFFF;
    return isSurrogate || character == 0xFFFE || character == 0xFFFF;
}

/// Returns the length of the well-formed sequence of several bytes that text begins with, or 0.
std::size_t LengthOfSequence(std::string_view text)
{
    const Utf8Form* const form = FindForm(ByteAt(text, 0));
    if (form == nullptr || text.size() < form->length)
    {
        return 0;
    }
    std::uint32_t character = ByteAt(text, 0) & ~form->leadMask;
    for (std::size_t position = 1; position < form->length; ++position)
    {
        if ((ByteAt(text, position) & 0xC0) != 0x80)
        {
            return 0;
        }
        character = character << 6 | (ByteAt(text, position) & 0x3F);
    }
    return character < form->smallestCharacter || IsExcluded(character) ? 0 : form->length;
}

/// Returns the length of the printable character that text begins with, or 0.
std::size_t LengthOfPrintable(std::string_view text)
{
    const bool isPrintableAscii = text.front() >= 0x20 && text.front() <= 0x7E;
    return isPrintableAscii ? 1 : LengthOfSequence(text);
}

} // namespace

core::string Format(const char* format, ...)
{
    std::va_list arguments;
    std::va_list sameArguments;
    va_start(arguments, format);
    va_copy(sameArguments, arguments);
    const int length = std::vsnprintf(nullptr, 0, format, arguments);
    core::string text(static_cast<std::size_t>(length), '\0');
    (void)std::vsnprintf(text.data(), text.size() + 1, format, sameArguments);
    va_end(sameArguments);
    va_end(arguments);
    return text;
}

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

core::string ConvertNonPrintableCharsToHex(const char* text)
{
    core::string converted;
    std::string_view rest(text);
    while (!rest.empty())
    {
        const std::size_t printable = LengthOfPrintable(rest);
        if (printable > 0)
        {
            converted += rest.substr(0, printable);
            rest.remove_prefix(printable);
        }
        else
        {
            converted += Format("%%%02X", ByteAt(rest, 0));
            rest.remove_prefix(1);
        }
    }
    return converted;
}
