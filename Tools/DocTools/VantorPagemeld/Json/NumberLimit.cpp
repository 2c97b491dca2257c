#include "Tools/DocTools/VantorPagemeld/Json/NumberLimit.h"

#include <algorithm>
#include <cstddef>
#include <cstring>
#include <string_view>
#include <utility>

namespace
{

constexpr std::size_t kMaxDigits = 9;
constexpr std::size_t kMaxDecimals = 1'000'000'000;

std::size_t CountDigits(const char* text)
{
    return std::strspn(text, "0123456789");
}

/// Whether the minus at that position stands behind an exponent mark.
bool IsExponentSign(const char* text, std::size_t minus)
{
    return minus > 0 && (text[minus - 1] == 'e' || text[minus - 1] == 'E');
}

/// A fast look that nearly every text passes; it takes strings for numbers.
bool MayHaveLongExponent(const char* text)
{
    for (const char* minus = std::strchr(text, '-'); minus != nullptr; minus = std::strchr(minus + 1, '-'))
    {
        if (IsExponentSign(text, static_cast<std::size_t>(minus - text)) &&
            CountDigits(minus + 1) > kMaxDigits)
        {
            return true;
        }
    }
    return false;
}

/// Returns the start of the first run of more than kMaxDecimals digits, or npos, as in nearly every text.
std::size_t FindEndlessDigits(std::string_view text)
{
    if (text.size() <= kMaxDecimals)
    {
        return std::string_view::npos;
    }
    for (std::size_t i = 0; i < text.size();)
    {
        const std::size_t digits = CountDigits(text.data() + i);
        if (digits > kMaxDecimals)
        {
            return i;
        }
        i += digits + 1;
    }
    return std::string_view::npos;
}

/// Returns the position of the quote that ends the string begun at start, or the end of the text.
std::size_t FindStringEnd(const std::string& text, std::size_t start)
{
    std::size_t i = start + 1;
    while (i < text.size() && text[i] != '"')
    {
        i += text[i] == '\\' ? 2 : 1;
    }
    return std::min(i, text.size());
}

void LimitDigits(std::string& text, std::size_t start, std::size_t count)
{
    if (count <= kMaxDigits)
    {
        return;
    }
    const auto first = text.begin() + static_cast<std::ptrdiff_t>(start);
    const auto kept = first + static_cast<std::ptrdiff_t>(count - kMaxDigits);
    if (std::any_of(first, kept, [](char digit) { return digit != '0'; }))
    {
        std::fill(first, kept, '0');
        std::fill_n(kept, kMaxDigits, '9');
    }
}

} // namespace

std::optional<std::string> LimitNumbers(const char* text)
{
    const std::size_t endlessDigits = FindEndlessDigits(text);
    if (endlessDigits != std::string_view::npos)
    {
        std::string readable(text, endlessDigits);
        std::optional<std::string> limited = LimitNumbers(readable.c_str());
        return limited ? std::move(limited) : std::move(readable);
    }
    if (!MayHaveLongExponent(text))
    {
        return std::nullopt;
    }
    std::string limited = text;
    for (std::size_t i = 0; i < limited.size(); ++i)
    {
        if (limited[i] == '"')
        {
            i = FindStringEnd(limited, i);
        }
        else if (limited[i] == '-' && IsExponentSign(limited.c_str(), i))
        {
            LimitDigits(limited, i + 1, CountDigits(limited.c_str() + i + 1));
        }
    }
    return limited;
}
