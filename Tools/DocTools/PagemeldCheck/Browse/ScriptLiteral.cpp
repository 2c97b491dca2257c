#include "Tools/DocTools/PagemeldCheck/Browse/ScriptLiteral.h"

#include <rapidjson/encodings.h>
#include <rapidjson/stringbuffer.h>

#include <algorithm>
#include <charconv>
#include <cstddef>
#include <cstdint>
#include <utility>

// The renderer escapes the double quotes of titles and nothing else, so a browser reads a backslash in a
// title or a link as the start of an escape. To know what readers get, the literal is decoded by the
// language's own rules. Nearly all texts have no backslash, quote or line break, and cost one cheap
// pre-check.

namespace
{

constexpr std::uint32_t kMaxCodePoint = 0x10FFFF;

/// What ends a literal or begins an escape. U+2028 and U+2029 are line ends elsewhere in a script.
bool IsSpecial(char c)
{
    return c == '"' || c == '\\' || c == '\n' || c == '\r';
}

bool IsOctalDigit(char c)
{
    return c >= '0' && c <= '7';
}

std::optional<std::uint32_t> ValueOfHexDigits(std::string_view digits)
{
    std::uint32_t number = 0;
    const auto [end, error] = std::from_chars(digits.begin(), digits.end(), number, 16);
    return error == std::errc() && end == digits.end() ? std::optional(number) : std::nullopt;
}

bool IsHighSurrogate(std::uint32_t codePoint)
{
    return codePoint >= 0xD800 && codePoint <= 0xDBFF;
}

bool IsLowSurrogate(std::uint32_t codePoint)
{
    return codePoint >= 0xDC00 && codePoint <= 0xDFFF;
}

/// Reads what is between the quotes of a literal.
class LiteralBody
{
public:
    explicit LiteralBody(std::string_view body) : m_rest(body) {}

    std::optional<std::string> Value()
    {
        while (!m_rest.empty())
        {
            const auto special = std::find_if(m_rest.begin(), m_rest.end(), IsSpecial);
            m_value += Take(static_cast<std::size_t>(special - m_rest.begin()));
            if (!m_rest.empty() && (m_rest.front() != '\\' || !TakeEscape()))
            {
                return std::nullopt;
            }
        }
        return std::move(m_value);
    }

private:
    std::string_view Take(std::size_t count)
    {
        const std::string_view taken = m_rest.substr(0, count);
        m_rest.remove_prefix(taken.size());
        return taken;
    }

    bool TakeIf(std::string_view text)
    {
        const bool isNext = m_rest.substr(0, text.size()) == text;
        m_rest.remove_prefix(isNext ? text.size() : 0);
        return isNext;
    }

    /// Returns false for an escape that is no part of the language, and for a backslash at the end, which
    /// escapes the closing quote.
    bool TakeEscape()
    {
        Take(1);
        if (m_rest.empty())
        {
            return false;
        }
        if (TakeIf("u"))
        {
            return Append(TakeIf("{") ? TakeBracedCodePoint() : TakeHexDigits(4));
        }
        if (TakeIf("x"))
        {
            return Append(TakeHexDigits(2));
        }
        if (IsOctalDigit(m_rest.front()))
        {
            return Append(TakeOctalDigits());
        }
        if (!TakeLineEnd())
        {
            TakeCharacter();
        }
        return true;
    }

    std::optional<std::uint32_t> TakeHexDigits(std::size_t count)
    {
        const std::string_view digits = Take(count);
        return digits.size() == count ? ValueOfHexDigits(digits) : std::nullopt;
    }

    std::optional<std::uint32_t> TakeBracedCodePoint()
    {
        const std::optional<std::uint32_t> number = ValueOfHexDigits(Take(m_rest.find('}')));
        return TakeIf("}") && number <= kMaxCodePoint ? number : std::nullopt;
    }

    /// At most three digits, and no more than make a number below 256.
    std::uint32_t TakeOctalDigits()
    {
        std::uint32_t number = 0;
        for (int i = 0; i < 3 && number < 32 && !m_rest.empty() && IsOctalDigit(m_rest.front()); ++i)
        {
            number = number * 8 + static_cast<std::uint32_t>(Take(1).front() - '0');
        }
        return number;
    }

    /// A line end after a backslash continues the literal and is no part of its value.
    bool TakeLineEnd()
    {
        return TakeIf("\r\n") || TakeIf("\r") || TakeIf("\n") || TakeIf("\xE2\x80\xA8") ||
               TakeIf("\xE2\x80\xA9");
    }

    /// Takes the character after a backslash: the name of a control character, or any other, which has no
    /// special meaning. Of a character of several bytes this takes the first; the rest is ordinary text.
    void TakeCharacter()
    {
        constexpr std::string_view kNames = "bfnrtv";
        constexpr std::string_view kControls = "\b\f\n\r\t\v";
        const char c = Take(1).front();
        const std::size_t i = kNames.find(c);
        m_value += i == std::string_view::npos ? c : kControls[i];
    }

    bool Append(std::optional<std::uint32_t> codePoint)
    {
        if (!codePoint)
        {
            return false;
        }
        if (IsLowSurrogate(*codePoint) && m_highSurrogate != 0 && m_highSurrogateEnd == m_value.size())
        {
            m_value.resize(m_value.size() - 3);
            AppendBytes(0x10000 + ((m_highSurrogate - 0xD800) << 10) + (*codePoint - 0xDC00));
            return true;
        }
        AppendBytes(*codePoint);
        m_highSurrogate = IsHighSurrogate(*codePoint) ? *codePoint : 0;
        m_highSurrogateEnd = m_value.size();
        return true;
    }

    void AppendBytes(std::uint32_t codePoint)
    {
        rapidjson::StringBuffer bytes;
        rapidjson::UTF8<>::Encode(bytes, codePoint);
        m_value.append(bytes.GetString(), bytes.GetSize());
    }

    std::string_view m_rest;
    std::string m_value;
    std::uint32_t m_highSurrogate = 0;  ///< made by the last numeric escape; 0 if that made something else
    std::size_t m_highSurrogateEnd = 0; ///< size of the value after it
};

} // namespace

std::optional<std::string> ValueOfScriptLiteral(std::string_view literal)
{
    if (literal.size() < 2 || literal.front() != '"' || literal.back() != '"')
    {
        return std::nullopt;
    }
    const std::string_view body = literal.substr(1, literal.size() - 2);
    if (std::none_of(body.begin(), body.end(), IsSpecial))
    {
        return std::string(body);
    }
    return LiteralBody(body).Value();
}
