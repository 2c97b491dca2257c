#include "Runtime/Testing/TestCategories.h"
#include "Runtime/Testing/TestFilter.h"
#include "Runtime/Utilities/NonPrintableChars.h"
#include "fuzz/Property.h"

// A name is shown as its definition says, and a filter selects what its definition selects. An input is a
// filter, a suite's name and a test's name.

namespace
{

/// Returns the form of so many bytes that stands for the character; its first byte announces the length.
std::string Encoded(std::uint32_t character, std::size_t length)
{
    std::string form(length, '\0');
    for (std::size_t i = length; i-- > 1; character >>= 6)
    {
        form[i] = static_cast<char>(0x80 | (character & 0x3F));
    }
    form[0] = static_cast<char>((0xFF00U >> length & 0xFF) | character);
    return form;
}

/// Returns the length of the well-formed sequence at the start of text, or 0: found by encoding what it
/// holds.
std::size_t LengthOfSequence(const std::string& text)
{
    constexpr std::uint32_t kSmallest[] = {0, 0, 0x80, 0x800, 0x10000, 0x200000, 0x4000000};
    for (std::size_t length = 2; length <= 6 && length <= text.size(); ++length)
    {
        std::uint32_t character = static_cast<unsigned char>(text[0]) & (0xFFU >> (length + 1));
        for (std::size_t i = 1; i < length; ++i)
        {
            character = character << 6 | (static_cast<unsigned char>(text[i]) & 0x3F);
        }
        const bool isExcluded =
            length == 3 && ((character >= 0xD800 && character <= 0xDFFF) || character >= 0xFFFE);
        if (Encoded(character, length) == text.substr(0, length))
        {
            return character >= kSmallest[length] && !isExcluded ? length : 0;
        }
    }
    return 0;
}

std::string ShownByDefinition(std::string text)
{
    constexpr const char* kDigits = "0123456789ABCDEF";
    std::string shown;
    while (!text.empty())
    {
        const auto byte = static_cast<unsigned char>(text[0]);
        const std::size_t copied = byte >= 0x20 && byte <= 0x7E ? 1 : LengthOfSequence(text);
        shown +=
            copied > 0 ? text.substr(0, copied) : std::string{'%', kDigits[byte >> 4], kDigits[byte & 15]};
        text.erase(0, copied > 0 ? copied : 1);
    }
    return shown;
}

std::string Lower(std::string text)
{
    for (char& c : text)
    {
        c = c >= 'A' && c <= 'Z' ? static_cast<char>(c + ('a' - 'A')) : c;
    }
    return text;
}

bool Occurs(const std::string& part, const std::string& text)
{
    for (std::size_t i = 0; i + part.size() <= text.size(); ++i)
    {
        if (text.compare(i, part.size(), part) == 0)
        {
            return true;
        }
    }
    return false;
}

bool SelectsByDefinition(const std::string& filter, const std::string& suite, const std::string& test)
{
    const std::size_t fullStop = filter.find('.');
    return fullStop == std::string::npos
               ? Occurs(filter, suite) || Occurs(filter, test)
               : Occurs(filter.substr(0, fullStop), suite) && Occurs(filter.substr(fullStop + 1), test);
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    std::vector<std::string> texts = SplitInput(data, size);
    texts.resize(3);
    const std::string& suite = texts[1];
    const std::string& test = texts[2];
    const std::string shown(ConvertNonPrintableCharsToHex(test.c_str()));
    Require(shown == ShownByDefinition(test), "a name is shown as defined");

    TestFilter filter;
    filter.nameFilters.emplace_back(Lower(texts[0]));
    const UnitTest::Test subject(
        UnitTest::TestDetails(test.c_str(), suite.c_str(), Testing::kUnitTestCategory, "", 1, nullptr));
    Require(filter.Filter(&subject) == SelectsByDefinition(Lower(texts[0]), Lower(suite), Lower(shown)),
            "a filter selects as defined");
    return 0;
}
