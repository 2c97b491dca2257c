#include "Tools/DocTools/VantorPagemeld/Json/ExponentLimit.h"

#include <algorithm>
#include <cstddef>
#include <cstring>

namespace
{

constexpr std::size_t kMaxDigits = 9;

std::size_t CountDigits(const char* text)
{
    return std::strspn(text, "0123456789");
}

/// A fast look that nearly every text passes; it takes strings for numbers.
bool MayHaveLongExponent(const char* text)
{
    for (const char* mark : {"e-", "E-"})
    {
        for (const char* found = std::strstr(text, mark); found != nullptr;
             found = std::strstr(found + 2, mark))
        {
            if (CountDigits(found + 2) > kMaxDigits)
            {
                return true;
            }
        }
    }
    return false;
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

bool IsExponentSign(const std::string& text, std::size_t i)
{
    return text[i] == '-' && i > 0 && (text[i - 1] == 'e' || text[i - 1] == 'E');
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

std::optional<std::string> LimitExponents(const char* text)
{
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
        else if (IsExponentSign(limited, i))
        {
            LimitDigits(limited, i + 1, CountDigits(limited.c_str() + i + 1));
        }
    }
    return limited;
}
