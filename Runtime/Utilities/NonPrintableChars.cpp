#include "Runtime/Utilities/NonPrintableChars.h"

#include "Runtime/Utilities/Format.h"

#include <cstdint>
#include <string_view>

namespace
{

std::uint32_t ByteAt(std::string_view text, std::size_t position)
{
    return static_cast<unsigned char>(text[position]);
}

/// The multi-byte forms, by the bits that are fixed in the first byte.
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
    for (const Utf8Form& form : kForms)
    {
        if ((lead & form.leadMask) == form.lead)
        {
            return &form;
        }
    }
    return nullptr;
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
