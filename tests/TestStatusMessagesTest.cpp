#include "Runtime/Testing/TestStatusMessages.h"

#include "Modules/JSONSerialize/Public/JSONWrite.h"
#include "tests/support/CapturedConsole.h"
#include "tests/support/NeutralText.h"

#include <gtest/gtest.h>

#include <chrono>

#include <unistd.h>

namespace
{

long long MillisecondsNow()
{
    const auto now = std::chrono::system_clock::now().time_since_epoch();
    return std::chrono::duration_cast<std::chrono::milliseconds>(now).count();
}

} // namespace

TEST(TestStatusMessages, AreCompactJsonOnOneLine)
{
    const std::string process = ",\"processId\":" + std::to_string(::getpid());
    const long long before = MillisecondsNow();
    const std::string begin = Testing::TestStatusBeginMesssageToQZMString("S.\"quo\\ted\"\n\x01");
    const std::string end = Testing::TestStatusEndMesssageToQZMString("S.T", Testing::TestState::Failed, 1999,
                                                                      "m/\t\xC3\xA4", "file", -1);
    for (const std::string& line : {begin, end})
    {
        const long long time = std::stoll(line.substr(line.find("\"time\":") + 7));
        EXPECT_LE(before, time);
        EXPECT_GE(MillisecondsNow(), time);
    }
    EXPECT_EQ("##qzm:{\"type\":\"TestStatus\",\"version\":2,\"phase\":\"Begin\",\"time\":N" + process +
                  ",\"name\":\"S.\\\"quo\\\\ted\\\"\\n\\u0001\",\"state\":0}",
              WithoutNumbers(begin, {"\"time\":"}));
    EXPECT_EQ("##qzm:{\"type\":\"TestStatus\",\"version\":2,\"phase\":\"End\",\"time\":N" + process +
                  ",\"name\":\"S.T\",\"state\":5,\"message\":\"m/\\t\xC3\xA4\",\"fileName\":\"file\","
                  "\"lineNumber\":-1,\"durationMicroseconds\":1999,\"duration\":1}",
              WithoutNumbers(end, {"\"time\":"}));
    EXPECT_EQ(0U, CountLiveBlocks(MemoryLabel::Json));
}

TEST(JSONWrite, AddsToObjectsAndArraysAndLogsAnErrorForOthers)
{
    const CapturedConsole console;
    JSONWrite json(0, nullptr);
    std::string text = "old";
    const char* word = "a";
    unsigned long long largest = UINT64_MAX;
    json.Transfer(word, "same", 0);
    json.Transfer(largest, "same", 0);
    json.OutputToString(text, false);
    EXPECT_EQ("{\"same\":\"a\",\"same\":18446744073709551615}", text);
    json.OutputToString(text, true);
    EXPECT_EQ("{\n    \"same\": \"a\",\n    \"same\": 18446744073709551615\n}", text);

    json.CurrentNode().SetArray();
    int number = -1;
    json.Transfer(number, "ignored", 0);
    json.OutputToString(text, false);
    EXPECT_EQ("[-1]", text);

    json.CurrentNode().SetNull();
    json.Transfer(number, "ignored", 0);
    json.OutputToString(text, false);
    EXPECT_EQ("null", text);
    EXPECT_EQ("ERROR: ./Modules/JSONSerialize/Public/JSONWrite:47 Unexpected node type.\n",
              console.GetText());
}
