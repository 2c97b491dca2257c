#include "Tools/DocTools/PagemeldCheck/Explain/ValuePlaces.h"

#include "tests/support/ParsedJson.h"
#include "tests/support/Repeated.h"

#include <gtest/gtest.h>

#include <string>
#include <utility>

namespace
{

/// Appends the value and all that it holds, in document order.
void AppendValues(std::vector<const rapidjson::Value*>& values, const rapidjson::Value& value)
{
    values.push_back(&value);
    for (rapidjson::SizeType i = 0; value.IsArray() && i < value.Size(); ++i)
    {
        AppendValues(values, value[i]);
    }
    for (rapidjson::SizeType i = 0; value.IsObject() && i < value.MemberCount(); ++i)
    {
        AppendValues(values, (value.MemberBegin() + i)->value);
    }
}

/// The places as "line:column " each.
std::string Places(const std::string& text, const rapidjson::Value& document,
                   const std::vector<const rapidjson::Value*>& values)
{
    std::string shown;
    for (const ValuePlace& place : LocateValues(text.c_str(), document, values))
    {
        shown += std::to_string(place.line) + ":" + std::to_string(place.column) + " ";
        EXPECT_EQ(place.column, PlaceOfOffset(text.c_str(), place.offset).column);
    }
    return shown;
}

} // namespace

TEST(ValuePlaces, LocatesEveryValueOfADocument)
{
    const std::pair<std::string, const char*> cases[] = {
        {"7", "1:1 "},
        {" \r\n\t\"\xC3\xA9\\\"\\n\" ", "2:2 "},
        {"[\"\",-1.5e-3,\n0,true , false\r,null]", "1:1 1:2 1:5 2:1 2:3 2:10 2:17 "},
        {"[[],[ ],{}\n,{ },[[[1]],[2]]]", "1:1 1:2 1:5 1:9 2:2 2:6 2:7 2:8 2:9 2:13 2:14 "},
        {R"({"a":1,"a" : ["],{:"],"\u0022b":{"":{"a":"a"}},"c":[{}],"a":2})",
         "1:1 1:6 1:14 1:15 1:33 1:37 1:42 1:52 1:53 1:61 "},
        {"[1e-00000000009,0.1e-99999999999999999999,2]", "1:1 1:2 1:17 1:43 "}};
    for (const auto& [text, places] : cases)
    {
        const rapidjson::Document document = ParsedJson(text);
        std::vector<const rapidjson::Value*> values;
        AppendValues(values, document);
        EXPECT_EQ(places, Places(text, document, values)) << text;
    }
}

TEST(ValuePlaces, ReturnsPlacesInTheOrderOfTheValues)
{
    const char* const text = "{\"a\":[1,\n2],\"b\":3}";
    const rapidjson::Document document = ParsedJson(text);
    const rapidjson::Value& list = document.MemberBegin()->value;
    EXPECT_EQ("2:1 1:1 2:1 1:6 ", Places(text, document, {&list[1], &document, &list[1], &list}));
    EXPECT_EQ("", Places(text, document, {}));
    EXPECT_EQ(9U, LocateValues(text, document, {&list[1]})[0].offset);
    EXPECT_EQ(2U, PlaceOfOffset("\n\n", 1).line);
}

TEST(ValuePlaces, ReachesTheDeepestValue)
{
    const std::string text = Repeated("[\n", 9'999) + "{\"a\":7}" + Repeated("]", 9'999);
    const rapidjson::Document document = ParsedJson(text);
    const rapidjson::Value* inner = &document;
    while (inner->IsArray())
    {
        inner = &(*inner)[0];
    }
    EXPECT_EQ("10000:6 ", Places(text, document, {&inner->MemberBegin()->value}));
}
