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
    Add(json, 2U);
    Add(json, 3UL);
    Add(json, -5'000'000'000L);
    Add(json, -6'000'000'000LL);
    EXPECT_EQ("[-1,2,3,-5000000000,-6000000000]", TextOf(json, false));

    json.CurrentNode().SetNull();
    Add(json, 1);
    EXPECT_EQ("null", TextOf(json, false));
    EXPECT_EQ("ERROR: ./Modules/JSONSerialize/Public/JSONWrite:47 Unexpected node type.\n",
              console.GetText());
}

TEST(JSONWrite, GrowsBeyondTheFirstBlockAndFreesAll)
{
    std::string expected = "{";
    {
        JSONWrite json(0, nullptr);
        for (int i = 0; i < 40; ++i)
        {
            Add(json, i);
            expected += (i > 0 ? ",\"same\":" : "\"same\":") + std::to_string(i);
        }
        EXPECT_EQ(expected + "}", TextOf(json, false));
        EXPECT_EQ(1U, CountLiveBlocks(MemoryLabel::Json)); // short names need no block of their own
    }
    EXPECT_EQ(0U, CountLiveBlocks(MemoryLabel::Json));
}
