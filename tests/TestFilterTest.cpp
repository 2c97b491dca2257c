#include "Runtime/Testing/TestFilter.h"

#include "tests/support/DescribedTests.h"

#include <gtest/gtest.h>

using UnitTest::TestAttribute;

TEST(TestFilter, SelectsByPartsOfNamesAndBeginningsOfCategories)
{
    const DescribedTests tests({{"Index", "One"},
                                {"Toc", "In.dex", nullptr},
                                {"Toc", "RUN_Two", "Performance"},
                                {"\x01Odd", "Li\nne", ""},
                                {"RUN_Last", "Zone", "UNITED"},
                                {"run_", "run_", "perf"}});
    const struct
    {
        std::vector<std::string> nameFilters;
        std::vector<std::string> categoryPrefixes;
        bool runOnlyPrefixedTests;
        const char* expected;
    } cases[] = {
        {{}, {}, false, " One In.dex RUN_Two Li%0Ane Zone run_"},
        {{"index"}, {}, false, " One"},
        {{"toc"}, {}, false, " In.dex RUN_Two"},
        {{"oc.tw"}, {}, false, " RUN_Two"},
        {{".toc"}, {}, false, ""},            // the test's name alone
        {{"in.dex"}, {}, false, ""},          // the first full stop splits
        {{"toc.in.d"}, {}, false, " In.dex"}, // a second one belongs to the test
        {{"%0ane"}, {}, false, " Li%0Ane"},   // the test's name as it is displayed
        {{"%01odd"}, {}, false, ""},          // the suite's name as it is
        {{"none", "two"}, {}, false, " RUN_Two"},
        {{}, {"unit"}, false, " One In.dex Li%0Ane Zone"},
        {{}, {"perf"}, false, " RUN_Two run_"},
        {{}, {"performance", "units"}, false, " RUN_Two"},
        {{}, {}, true, " RUN_Two Zone"},
    };
    for (const auto& c : cases)
    {
        TestFilter filter;
        filter.nameFilters = c.nameFilters;
        filter.categoryPrefixes = c.categoryPrefixes;
        filter.runOnlyPrefixedTests = c.runOnlyPrefixedTests;
        std::string names;
        tests.ForEach([&](const UnitTest::Test* test)
                      { names += filter.Filter(test) ? " " + GetDisplayedTestName(test->m_details) : ""; });
        EXPECT_EQ(c.expected, names) << "case " << &c - cases;
    }
}

TEST(TestFilter, IgnoresByAttributeAndByNameAndNotesWhy)
{
    const TestAttribute always{0, 12, "broken", nullptr};
    const TestAttribute alwaysForOtherCase{0, 5, "other", nullptr};
    const TestAttribute unstable{1, 99, "unstable", nullptr};
    const TestAttribute unstableWithoutText{1, 0, nullptr, nullptr};
    const TestAttribute condition{2, 99, "condition", [] { return true; }};
    const TestAttribute failingCondition{2, 0, "not now", [] { return false; }};
    const TestAttribute noCondition{2, 0, "never", nullptr};
    const TestAttribute remark{3, 4, "remark", [] { return true; }};
    const struct
    {
        const char* suiteName;
        const char* testName;
        UnitTest::TestAttributes attributes;
        const char* expected; ///< "runs", or kind, reason and case number
    } cases[] = {
        {"Suite", "Test", {&remark, &failingCondition, &noCondition}, "runs"},
        {"Suite", "DISABLED_Test", {}, "0||0"},
        {"DISABLED_Suite", "Test", {}, "0||0"},
        {"disabled_Suite", "Test_DISABLED_", {}, "runs"},
        {"Suite", "Test", {&always, &alwaysForOtherCase}, "1|broken|12"},
        {"Suite", "Test", {&unstable}, "2|unstable|0"},
        {"Suite", "Test", {&condition}, "3|condition|0"},
        {"Suite", "Test", {&condition, &unstable, &always}, "3|condition|12"},
        {"Suite", "Test", {&failingCondition, &unstableWithoutText, &always}, "2|broken|12"},
        {"Suite", "Test", {&failingCondition, &condition}, "0||0"}, // only the first gives a reason
    };
    for (const auto& c : cases)
    {
        const DescribedTests tests({{c.suiteName, c.testName, "Unit", [] {}, c.attributes}});
        TestFilter filter;
        std::string outcome;
        tests.ForEach([&](const UnitTest::Test* test) { outcome += filter(test) ? "runs" : ""; });
        for (const DisabledTestInfo& info : filter.ignoredTests)
        {
            outcome += std::to_string(info.kind) + "|" + info.reason + "|" + std::to_string(info.caseNumber);
        }
        EXPECT_EQ(c.expected, outcome) << "case " << &c - cases;
    }
}
