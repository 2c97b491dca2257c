#include "Tools/DocTools/VantorPagemeld/Read/NumberGuard.h"

#include <algorithm>
#include <cstring>
#include <string_view>

// The JSON library counts the decimals of a number in 32 bits and adds its exponent to them: the number
// 0.00000000001e-2147483639 overflows the sum, and the library then reads outside a table. A text that can do
// so is changed before the library sees it. Nearly none can: other texts cost only one search for
// "-" and a comparison of sizes.

namespace
{

constexpr std::size_t kMaxExponentDigits = 9;

std::size_t CountDigits(const char* text)
{
    return std::strspn(text, "0123456789");
}

/// Whether the minus at that position follows an exponent mark.
bool IsExponentSign(const char* text, std::size_t minus)
{
    return minus > 0 && (text[minus - 1] == 'e' || text[minus - 1] == 'E');
}

/// Cheap pre-check, false for nearly all texts. It does not tell strings from numbers.
bool MayHaveLongExponent(const char* text)
{
    for (const char* minus = std::strchr(text, '-'); minus != nullptr; minus = std::strchr(minus + 1, '-'))
    {
        if (IsExponentSign(text, static_cast<std::size_t>(minus - text)) &&
            CountDigits(minus + 1) > kMaxExponentDigits)
        {
            return true;
        }
    }
    return false;
}

/// Returns the start of the first run of more than maxDigits digits, or the end of the text.
std::size_t FindEndlessDigits(std::string_view text, std::size_t maxDigits)
{
    if (text.size() <= maxDigits)
    {
        return text.size();
    }
    for (std::size_t i = 0; i < text.size();)
    {
        const std::size_t digits = CountDigits(text.data() + i);
        if (digits > maxDigits)
        {
            return i;
        }
        i += digits + 1;
    }
    return text.size();
}

/// Makes an exponent of count digits one of at most nine significant digits, with zeros before them.
void CutExponent(std::string& text, std::size_t start, std::size_t count)
{
    const std::size_t cut = count - std::min(count, kMaxExponentDigits);
    if (text.find_first_not_of('0', start) < start + cut)
    {
        text.replace(start, count, std::string(cut, '0') + std::string(kMaxExponentDigits, '9'));
    }
}

void CutExponents(std::string& text)
{
    bool isInString = false;
    for (std::size_t i = 0; i < text.size(); ++i)
    {
        if (text[i] == '"')
        {
            isInString = !isInString;
        }
        else if (isInString)
        {
            i += text[i] == '\\' ? 1 : 0; // what it escapes may be a quote
        }
        else if (text[i] == '-' && IsExponentSign(text.c_str(), i))
        {
            CutExponent(text, i + 1, CountDigits(text.c_str() + i + 1));
        }
    }
}

} // namespace

std::optional<std::string> GuardNumbers(const char* text, std::size_t maxDigits)
{
    const std::string_view whole = text;
    const std::size_t end = FindEndlessDigits(whole, maxDigits);
    if (end == whole.size() && !MayHaveLongExponent(text))
    {
        return std::nullopt;
    }
    std::string guarded(whole.substr(0, end));
    CutExponents(guarded);
    return end == whole.size() ? guarded : guarded + '!';
}
