#include "tests/support/CapturedStderr.h"
#include "tests/support/Files.h"
#include "tests/support/ParsedJson.h"
#include "tests/support/TemporaryDirectory.h"

#include <gtest/gtest.h>

TEST(JsonWriting, CompactAndPrettyForm)
{
    const struct
    {
        const char* json;
        const char* compact;
        const char* pretty;
    } cases[] = {
        {"{}", "{}", "{}"},
        {" 7 ", "7", "7"}, // a root without a closing bracket reaches the file too
        {"\"x\"", "\"x\"", "\"x\""},
        {"{\"a\":[1,2]}", "{\"a\":[1,2]}", "{\n    \"a\": [\n        1,\n        2\n    ]\n}"},
        {R"([[],{},[{"b":true,"a":false}]])", R"([[],{},[{"b":true,"a":false}]])",
         "[\n    [],\n    {},\n    [\n        {\n            \"b\": true,\n            \"a\": false\n        "
         "}\n    ]\n]"},
        {"[0,-0,-2147483648,4294967295,-9223372036854775808,18446744073709551615]",
         "[0,0,-2147483648,4294967295,-9223372036854775808,18446744073709551615]",
         "[\n    0,\n    0,\n    -2147483648,\n    4294967295,\n    -9223372036854775808,\n    "
         "18446744073709551615\n]"},
        {"[1.0,0.1,-0.0,1e21,1E-7,5e-324,18446744073709551616]",
         "[1.0,0.1,-0.0,1e21,1e-7,5e-324,18446744073709553000.0]",
         "[\n    1.0,\n    0.1,\n    -0.0,\n    1e21,\n    1e-7,\n    5e-324,\n    "
         "18446744073709553000.0\n]"},
        {R"(["\"\\\/\b\f\n\r\t\u0000\u0001\u001f\u007f\u00e9\ud83d\ude00"])",
         "[\"\\\"\\\\/\\b\\f\\n\\r\\t\\u0000\\u0001\\u001F\x7F\xC3\xA9\xF0\x9F\x98\x80\"]",
         "[\n    \"\\\"\\\\/\\b\\f\\n\\r\\t\\u0000\\u0001\\u001F\x7F\xC3\xA9\xF0\x9F\x98\x80\"\n]"},
        {"[\"\xFF\xC3\"]", "[\"\xFF\xC3\"]", "[\n    \"\xFF\xC3\"\n]"}, // bytes that are not UTF-8
        {R"({"\u0000":1,"":2,"":3})", R"({"\u0000":1,"":2,"":3})",
         "{\n    \"\\u0000\": 1,\n    \"\": 2,\n    \"\": 3\n}"},
    };
    const TemporaryDirectory directory;
    for (const auto& c : cases)
    {
        const rapidjson::Document document = ParsedJson(c.json);
        EXPECT_EQ(c.compact, RapidJsonIoUtil::OutputJsonValueToString(document)) << c.json;
        EXPECT_TRUE(RapidJsonIoUtil::OutputJsonValueToFile(document, (directory / "file").c_str())) << c.json;
        EXPECT_EQ(c.pretty, ReadFile(directory / "file")) << c.json;
    }
    CapturedStderr captured;
    EXPECT_FALSE(
        RapidJsonIoUtil::OutputJsonValueToFile(ParsedJson("1"), (directory / "missing/file").c_str()));
    EXPECT_TRUE(RapidJsonIoUtil::OutputJsonValueToFile(ParsedJson("1"), "/dev/full")); // on purpose
}
