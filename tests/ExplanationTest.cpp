#include "Tools/DocTools/PagemeldCheck/Explain/ParseFailure.h"
#include "Tools/DocTools/PagemeldCheck/Explain/ShownText.h"
#include "Tools/DocTools/VantorPagemeld/Read/JsonReader.h"

#include <gtest/gtest.h>

#include <utility>

namespace
{

std::string Describe(const std::string& text)
{
    rapidjson::Document document;
    return DescribeParseFailure(text.c_str(), text.size(), ParseJson(text.c_str(), document));
}

} // namespace

TEST(Explanation, NamesWhatUsuallyCausesAParseFailure)
{
    const std::pair<std::string, std::string> cases[] = {
        {"", R"(the file is empty; refused at byte 0, at the end of the text)"},
        {" \n", R"(the file holds nothing but white space; refused at byte 2, at the end of the text)"},
        {"\xFF\xFE{", R"(the file is in UTF-16: save it as UTF-8; refused at byte 0, at "\xFF\xFE{")"},
        {"\xFE\xFF", R"(the file is in UTF-16: save it as UTF-8; refused at byte 0, at "\xFE\xFF")"},
        {std::string("[\0]\0", 4),
         R"(the file is in UTF-16: save it as UTF-8; refused at byte 1, at the end of the text)"},
        {std::string("\0[\0]", 4),
         R"(the file begins with a NUL byte: it is in UTF-16, or was never written; refused at byte 0, at the end of the text)"},
        {std::string(" \n\0", 3),
         R"(the file holds nothing but white space before its first NUL byte; refused at byte 2, at the end of the text)"},
        {"[1.\n]", R"(miss fraction part in number; refused at byte 3, at "\n]")"},
        {"{\"a\":tru\t}", R"(invalid value; refused at byte 8, at "\t}")"},
        {R"({\"a":1})", R"(missing a name for object member; refused at byte 1, at "\\\"a\":1}")"},
        {R"("\ud83d")",
         R"(half of a surrogate pair, as cutting a text leaves it: write both halves or neither; refused at byte 1, at "\\ud83d\"")"},
        {R"("\uZZ12")",
         R"(\u needs four hexadecimal digits; every backslash that is meant as one must be doubled; in a title or path, use another character; refused at byte 1, at "\\uZZ12\"")"},
        {"[",
         R"(the text ends too early: it was cut, or brackets are left open: write the file again; refused at byte 1, at the end of the text)"},
        {"[1,\n]", R"(there is a comma before the closing bracket; refused at byte 4, at "]")"},
        {"{,}", R"(missing a name for object member; refused at byte 1, at ",}")"},
        {R"({"a":})", R"(invalid value; refused at byte 5, at "}")"},
        {"[1 # one\n]", R"(JSON has no comments; refused at byte 3, at "# one\n]")"},
        {"[] // end", R"(JSON has no comments; refused at byte 3, at "// end")"},
        {"[] []", R"(there is a second root after the first; refused at byte 3, at "[]")"},
        {"\"a\rb\"",
         R"(a line break in a string: write a space, or \n if it is not in a title or path; refused at byte 2, at "\rb\"")"},
        {"[\"a\tb\"]", R"(a tab in a string must be written as \t; refused at byte 3, at "\tb\"]")"},
        {R"(["\z and more"])",
         R"(every backslash that is meant as one must be doubled; in a title or path, use another character; refused at byte 2, at "\\z and more"...)"},
        {"[1e999]", R"(a number is too large; refused at byte 1, at "1e999]")"},
        {R"(["\")" + std::string(10'001, '[') + R"(",)" + std::string(10'001, ' ') + "-1.8e308]",
         R"(a number is too large; refused at byte 20008, at "-1.8e308]")"},
        {std::string(10'001, '['),
         R"(nested deeper than 10000 levels; refused at byte 10001, at the end of the text)"},
    };
    for (const auto& [text, explanation] : cases)
    {
        EXPECT_EQ("not JSON: " + explanation, Describe(text)) << text.substr(0, 40);
    }
}

TEST(Explanation, ShowsNoCharacterThatDeceivesAReader)
{
    const std::string harmless =
        " ~\xC2\xA0\u061B\u061D\u200D\u2010\u2027\u202F\u2065\u206A\uFEFE\uFF00\U0001F600";
    EXPECT_EQ(harmless, Visible(harmless));
    EXPECT_EQ(R"(\x00\x1F\x7F\u0080\u009F)", Visible({"\0\x1F\x7F\xC2\x80\xC2\x9F", 7}));
    const char* marks =
        "\u061C\u200E\u200F\u2028\u202E\u2066\u2069\uFEFF"; // NOLINT(misc-misleading-bidirectional)
    EXPECT_EQ(R"(\u061C\u200E\u200F\u2028\u202E\u2066\u2069\uFEFF)", Visible(marks));
    for (const char* sound : {"\xC2\x80", "\xDF\xBF", "\xE0\xA0\x80", "\xED\x9F\xBF", "\xEE\x80\x80",
                              "\xEF\xBF\xBF", "\xF0\x90\x80\x80", "\xF4\x8F\xBF\xBF", "eight letters"})
    {
        EXPECT_EQ(std::string::npos, FindInvalidUtf8(sound)) << sound;
    }
    for (const char* broken :
         {"\x80", "\xBF", "\xC1\xBF", "\xDF", "\xC2\x7F", "\xC2\xC0", "\xE0\x9F\xBF", "\xED\xA0\x80",
          "\xED\xBF\xBF", "\xE2\x82", "\xF0\x8F\xBF\xBF", "\xF4\x90\x80\x80", "\xF5\x80\x80\x80"})
    {
        EXPECT_EQ(8U, FindInvalidUtf8(std::string("123456\xC3\xA9") + broken)) << broken;
    }
}

TEST(Explanation, CutsLongLists)
{
    std::vector<std::string> names(10, "m");
    EXPECT_EQ("m, m, m, m, m, m, m, m, m, m", Listed(names));
    names.resize(300, "x");
    EXPECT_EQ("m, m, m, m, m, m, m, m, m, m and 290 more", Listed(names));
}
