#include "Tools/DocTools/PagemeldCheck/Explain/ShownText.h"

#include <rapidjson/encodings.h>
#include <rapidjson/memorystream.h>

#include <cstdint>
#include <cstring>

namespace
{

constexpr std::size_t kNone = std::string_view::npos;

/// Returns how many of the bytes at the start of text are ASCII. Takes eight at a time.
std::size_t CountAscii(std::string_view text)
{
    std::size_t count = 0;
    for (std::uint64_t word = 0; text.size() - count >= sizeof word; count += sizeof word)
    {
        std::memcpy(&word, text.data() + count, sizeof word);
        if ((word & 0x8080808080808080U) != 0)
        {
            break;
        }
    }
    while (count < text.size() && static_cast<unsigned char>(text[count]) < 0x80)
    {
        ++count;
    }
    return count;
}

struct Character
{
    std::uint32_t code = 0;
    std::size_t length = 0; ///< in bytes; 0 if there is no well-formed one
};

Character ReadCharacter(std::string_view text)
{
    rapidjson::MemoryStream stream(text.data(), text.size());
    unsigned code = 0;
    const bool isWellFormed = rapidjson::UTF8<>::Decode(stream, &code);
    return isWellFormed ? Character{code, stream.Tell()} : Character{};
}

/// Whether the escape that begins text is that of half a surrogate pair: its backslash is followed by 'u',
/// 'd' and one of the digits.
bool IsHalf(std::string_view text, std::string_view digits)
{
    const std::string_view start = text.substr(1, 2);
    return (start == "ud" || start == "uD") && text.substr(3, 1).find_first_of(digits) == 0;
}

bool IsUnsafe(std::uint32_t code)
{
    return code < 0x20 || (code >= 0x7F && code <= 0x9F) || code == 0x061C ||
           (code >= 0x200E && code <= 0x200F) || (code >= 0x2028 && code <= 0x202E) ||
           (code >= 0x2066 && code <= 0x2069) || code == 0xFEFF;
}

/// Returns an escape: the prefix, then the code in as many upper-case hexadecimal digits.
std::string HexEscape(const char* prefix, std::uint32_t code, unsigned digits)
{
    std::string escape = prefix;
    for (unsigned shift = 4 * digits; shift > 0;)
    {
        shift -= 4;
        escape += "0123456789ABCDEF"[code >> shift & 0xFU];
    }
    return escape;
}

std::string EscapeOf(std::uint32_t code)
{
    switch (code)
    {
    case '\n':
        return "\\n";
    case '\r':
        return "\\r";
    case '\t':
        return "\\t";
    default:
        return code < 0x80 ? HexEscape("\\x", code, 2) : HexEscape("\\u", code, 4);
    }
}

/// Appends the first character of text in its visible form. Returns how many bytes it has.
std::size_t AppendVisible(std::string& visible, std::string_view text)
{
    const Character character = ReadCharacter(text);
    if (character.length == 0)
    {
        visible += HexEscape("\\x", static_cast<unsigned char>(text.front()), 2);
        return 1;
    }
    if (IsUnsafe(character.code))
    {
        visible += EscapeOf(character.code);
    }
    else
    {
        visible += text.substr(0, character.length);
    }
    return character.length;
}

} // namespace

std::size_t FindInvalidUtf8(std::string_view text)
{
    for (std::size_t i = CountAscii(text); i < text.size(); i += CountAscii(text.substr(i)))
    {
        const std::size_t length = ReadCharacter(text.substr(i)).length;
        if (length == 0)
        {
            return i;
        }
        i += length;
    }
    return kNone;
}

std::size_t FindLoneHalf(std::string_view json)
{
    std::size_t i = json.find('\\');
    while (i != kNone && !IsHalf(json.substr(i), "cdefCDEF"))
    {
        i = json.find('\\', i + (IsHalf(json.substr(i), "89abAB") ? 12 : 2));
    }
    return i;
}

std::string Visible(std::string_view text)
{
    std::string visible;
    for (std::size_t i = 0; i < text.size();)
    {
        i += AppendVisible(visible, text.substr(i));
    }
    return visible;
}

std::string Quoted(std::string_view text, std::size_t maxBytes)
{
    std::string quoted = "\"";
    for (std::size_t i = 0; i < text.size();)
    {
        if (quoted.size() > maxBytes)
        {
            return quoted + "\"...";
        }
        if (text[i] == '"' || text[i] == '\\')
        {
            quoted += '\\';
        }
        i += AppendVisible(quoted, text.substr(i));
    }
    return quoted + "\"";
}

std::string NameOfRoot(std::string_view root)
{
    const std::size_t last = root.find_last_not_of('/');
    if (last == kNone)
    {
        return std::string(root);
    }
    const std::string_view path = root.substr(0, last + 1);
    return std::string(path.substr(path.rfind('/') + 1));
}

std::string Counted(std::size_t count, const std::string& noun)
{
    return std::to_string(count) + " " + noun + (count == 1 ? "" : "s");
}

std::string Listed(const std::vector<std::string>& items)
{
    constexpr std::size_t kMaxShown = 10;
    std::string list;
    for (std::size_t i = 0; i < items.size() && i < kMaxShown; ++i)
    {
        list += (i == 0 ? "" : ", ") + items[i];
    }
    return items.size() <= kMaxShown ? list
                                     : list + " and " + std::to_string(items.size() - kMaxShown) + " more";
}
