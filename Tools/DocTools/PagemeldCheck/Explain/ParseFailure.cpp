#include "Tools/DocTools/PagemeldCheck/Explain/ParseFailure.h"

#include "Tools/DocTools/PagemeldCheck/Explain/ShownText.h"
#include "Tools/DocTools/VantorPagemeld/Read/JsonReader.h"
#include "Tools/DocTools/VantorPagemeld/Read/NumberGuard.h"

#include <rapidjson/error/en.h>

#include <cctype>
#include <cstring>

namespace
{

constexpr const char* kWhiteSpace = " \t\r\n";

bool BeginsWith(std::string_view text, std::string_view start)
{
    return text.substr(0, start.size()) == start;
}

/// Whether the last character before the offset, but for white space, is a comma.
bool FollowsComma(std::string_view text, std::size_t offset)
{
    const std::size_t last = text.substr(0, offset).find_last_not_of(kWhiteSpace);
    return last != std::string_view::npos && text[last] == ',';
}

/// Returns what is wrong with the file as a whole, or an empty text.
std::string DescribeEncoding(std::string_view text, std::size_t size)
{
    if (BeginsWith(text, "\xFF\xFE") || BeginsWith(text, "\xFE\xFF") || (text.size() == 1 && size > 1))
    {
        return "the file is in UTF-16: save it as UTF-8";
    }
    if (BeginsWith(text, "\xEF\xBB\xBF"))
    {
        return "the file begins with a byte order mark: save it without";
    }
    if (text.empty())
    {
        return size == 0 ? "the file is empty"
                         : "the file begins with a NUL byte: it is in UTF-16, or was never written";
    }
    if (text.find_first_not_of(kWhiteSpace) == std::string_view::npos)
    {
        return std::string("the file holds nothing but white space") +
               (text.size() < size ? " before its first NUL byte" : "");
    }
    return "";
}

/// Returns how many arrays and objects are open at the end of a text.
std::size_t CountOpenBrackets(std::string_view text)
{
    std::size_t count = 0;
    bool isInString = false;
    for (std::size_t i = 0; i < text.size(); ++i)
    {
        const char c = text[i];
        i += isInString && c == '\\' ? 1 : 0;
        isInString = isInString != (c == '"');
        count += !isInString && (c == '[' || c == '{') ? 1 : 0;
        count -= !isInString && (c == ']' || c == '}') ? 1 : 0;
    }
    return count;
}

/// Returns which of the reader's limits the text exceeds at the offset.
std::string DescribeLimit(std::string_view text, std::size_t offset)
{
    if (CountOpenBrackets(text.substr(0, offset)) > kMaxNestingDepth)
    {
        return "nested deeper than " + std::to_string(kMaxNestingDepth) + " levels";
    }
    return text.substr(offset, 1).find_first_of("-0123456789") == 0
               ? "a number is too large"
               : "a string is longer than " + std::to_string(kMaxStringBytes) + " bytes";
}

/// Returns what the character at the offset, outside of strings, tells of the cause, or an empty text.
std::string DescribeCharacter(std::string_view text, std::size_t offset)
{
    const char c = offset < text.size() ? text[offset] : '\0';
    switch (c)
    {
    case ']':
    case '}':
        return FollowsComma(text, offset) ? "there is a comma before the closing bracket" : "";
    case '/':
    case '#':
        return "JSON has no comments";
    case '\'':
        return "strings need double quotes";
    default:
        return "";
    }
}

/// Returns what is wrong with an escape or with a control character in a string, or an empty text.
std::string DescribeStringCharacter(char c)
{
    switch (c)
    {
    case '\\':
        return "every backslash that is meant as one must be doubled; in a title or path, use another "
               "character";
    case '\n':
    case '\r':
        return "a line break in a string: write a space, or \\n if it is not in a title or path";
    case '\t':
        return "a tab in a string must be written as \\t";
    default:
        return "";
    }
}

std::string DescribeCause(std::string_view text, std::size_t size, const rapidjson::ParseResult& failure)
{
    std::string cause = DescribeEncoding(text, size);
    if (!cause.empty())
    {
        return cause;
    }
    if (failure.Code() == rapidjson::kParseErrorTermination)
    {
        return DescribeLimit(text, failure.Offset());
    }
    if (failure.Offset() >= text.size())
    {
        return "the text ends too early: it was cut, or brackets are left open: write the file again";
    }
    switch (failure.Code())
    {
    case rapidjson::kParseErrorNumberTooBig:
        return "a number is too large";
    case rapidjson::kParseErrorDocumentRootNotSingular:
        cause = DescribeCharacter(text, failure.Offset());
        return cause.empty() ? "there is a second root after the first" : cause;
    case rapidjson::kParseErrorStringEscapeInvalid:
        return DescribeStringCharacter(text[failure.Offset()]);
    case rapidjson::kParseErrorStringUnicodeEscapeInvalidHex:
        return "\\u needs four hexadecimal digits; " + DescribeStringCharacter('\\');
    case rapidjson::kParseErrorStringUnicodeSurrogateInvalid:
        return "half of a surrogate pair, as cutting a text leaves it: write both halves or neither";
    default:
        return DescribeCharacter(text, failure.Offset());
    }
}

} // namespace

std::string DescribeParseFailure(std::string_view text, std::size_t size,
                                 const rapidjson::ParseResult& failure)
{
    std::string cause = DescribeCause(text, size, failure);
    if (cause.empty())
    {
        cause = rapidjson::GetParseError_En(failure.Code());
        cause.erase(cause.find_last_not_of('.') + 1);
        cause[0] = static_cast<char>(std::tolower(cause[0]));
    }
    const std::string found =
        failure.Offset() < text.size() ? Quoted(text.substr(failure.Offset()), 12) : "the end of the text";
    return "not JSON: " + cause + "; refused at byte " + std::to_string(failure.Offset()) + ", at " + found;
}
