#include "Modules/JSONSerialize/Public/JSONWrite.h"

#include "tests/support/CapturedConsole.h"

#include <gtest/gtest.h>

#include <limits>

namespace
{

template <class T>
void Add(JSONWrite& json, T value)
{
    json.Transfer(value, "same", 0);
}

std::string TextOf(const JSONWrite& json, bool pretty)
{
    std::string text = "old";
    json.OutputToString(text, pretty);
    return text;
}

} // namespace

TEST(JSONWrite, AddsToObjectsAndArraysAndLogsAnErrorForOthers)
{
    const CapturedConsole console;
    JSONWrite json(0, nullptr);
    Add(json, "a");
    Add(json, std::numeric_limits<unsigned long long>::max());
    EXPECT_EQ("{\"same\":\"a\",\"same\":18446744073709551615}", TextOf(json, false));
    EXPECT_EQ("{\n    \"same\": \"a\",\n    \"same\": 18446744073709551615\n}", TextOf(json, true));

    json.CurrentNode().SetArray();
    Add(json, -1);
    Add(json, 3UL);
    Add(json, -5'000'000'000L);
    EXPECT_EQ("[-1,3,-5000000000]", TextOf(json, false));

    json.CurrentNode().SetNull();
    Add(json, 1);
    EXPECT_EQ("null", TextOf(json, false));
    EXPECT_EQ("ERROR: ./Modules/JSONSerialize/Public/JSONWrite:47 Unexpected node type.\n",
              console.GetText());
}

TEST(JSONWrite, KeepsItsValuesWhileItsMemoryGrowsAndFreesAll)
{
    {
        JSONWrite json(0, nullptr);
        std::string expected;
        for (int i = 0; i < 40; ++i)
        {
            Add(json, i);
            expected += ",\"same\":" + std::to_string(i);
        }
        EXPECT_EQ("{" + expected.substr(1) + "}", TextOf(json, false));
        EXPECT_EQ(1U, CountLiveBlocks(MemoryLabel::Json)); // short names need no block of their own
    }
    FreeLabelled(MemoryLabel::Json, nullptr);
    EXPECT_EQ(0U, CountLiveBlocks(MemoryLabel::Json));
}
