#include "Runtime/Testing/TestFilter.h"

#include "Runtime/Testing/TestList.h"
#include "tests/support/DescribedTests.h"

#include <gtest/gtest.h>

using UnitTest::TestAttribute;

namespace
{

/// Returns the full names of the tests that the filter selects, each behind a blank.
std::string Selected(const TestFilter& filter, const UnitTest::TestList& tests)
{
    std::string names;
    tests.ForEach([&](const UnitTest::Test* test)
                  { names += filter.Filter(test) ? " " + GetTestName(test->m_details) : ""; });
    return names;
}

bool Holds()
{
    return true;
}

bool HoldsNot()
{
    return false;
}

} // namespace

TEST(TestFilter, SelectsByPartsOfNames)
{
    const DescribedTests tests(
        {{"Index", "OneValid"}, {"Toc", "Two"}, {"Toc", "In.dex"}, {"\x01Odd", "Li\nne\xC3\x84"}});
    const struct
    {
        std::vector<std::string> nameFilters;
        const char* expected;
    } cases[] = {
        {{}, " Index.OneValid Toc.Two Toc.In.dex \x01Odd.Li%0Ane\xC3\x84"},
        {{""}, " Index.OneValid Toc.Two Toc.In.dex \x01Odd.Li%0Ane\xC3\x84"},
        {{"."}, " Index.OneValid Toc.Two Toc.In.dex \x01Odd.Li%0Ane\xC3\x84"},
        {{"index"}, " Index.OneValid"},
        {{"valid"}, " Index.OneValid"},
        {{"toc"}, " Toc.Two Toc.In.dex"},
        {{"toc."}, " Toc.Two Toc.In.dex"},
        {{"oc.tw"}, " Toc.Two"},
        {{".tw"}, " Toc.Two"},
        {{".toc"}, ""},                // the test's name alone
        {{"in.dex"}, ""},              // the first full stop splits
        {{"toc.in.d"}, " Toc.In.dex"}, // and a second one belongs to the test
        {{"%0ane"}, " \x01Odd.Li%0Ane\xC3\x84"},
        {{"%01odd"}, ""}, // a suite is not converted
        {{"ne\xC3\x84"}, " \x01Odd.Li%0Ane\xC3\x84"},
        {{"ne\xC3\xA4"}, ""}, // no case beyond ASCII
        {{"nothing", "two"}, " Toc.Two"},
    };
    for (const auto& c : cases)
    {
        TestFilter filter;
        filter.nameFilters = c.nameFilters;
        EXPECT_EQ(c.expected, Selected(filter, tests.list)) << ::testing::PrintToString(c.nameFilters);
    }
}

TEST(TestFilter, SelectsByBeginningsOfCategoriesAndByThePrefixRun)
{
    const DescribedTests tests({{"S", "Unit"},
                                {"S", "Null", nullptr},
                                {"S", "Empty", ""},
                                {"S", "RUN_Fast", "Performance"},
                                {"RUN_S", "Other", "UNITED"},
                                {"S", "run_", "perf"}});
    const struct
    {
        std::vector<std::string> categoryPrefixes;
        bool runOnlyPrefixedTests;
        const char* expected;
    } cases[] = {
        {{}, false, " S.Unit S.Null S.Empty S.RUN_Fast RUN_S.Other S.run_"},
        {{"unit"}, false, " S.Unit S.Null S.Empty RUN_S.Other"},
        {{"perf"}, false, " S.RUN_Fast S.run_"},
        {{"performance", "units"}, false, " S.RUN_Fast"},
        {{}, true, " S.RUN_Fast RUN_S.Other"},
    };
    for (const auto& c : cases)
    {
        TestFilter filter;
        filter.categoryPrefixes = c.categoryPrefixes;
        filter.runOnlyPrefixedTests = c.runOnlyPrefixedTests;
        EXPECT_EQ(c.expected, Selected(filter, tests.list)) << ::testing::PrintToString(c.categoryPrefixes);
    }
}

TEST(TestFilter, IgnoresByAttributeAndByNameAndNotesWhy)
{
    const TestAttribute always{0, 12, "broken", nullptr};
    const TestAttribute alwaysWithoutText{0, 5, nullptr, nullptr};
    const TestAttribute unstable{1, 99, "unstable", nullptr};
    const TestAttribute unstableWithoutText{1, 0, nullptr, nullptr};
    const TestAttribute condition{2, 99, "condition", Holds};
    const TestAttribute otherCondition{2, 0, "other", Holds};
    const TestAttribute failingCondition{2, 0, "not now", HoldsNot};
    const TestAttribute noCondition{2, 0, "never", nullptr};
    const TestAttribute remark{3, 4, "remark", Holds};
    const struct
    {
        const char* suiteName;
        const char* testName;
        UnitTest::TestAttributes attributes;
        const char* expected; ///< "runs", or kind, reason and case number
    } cases[] = {
        {"Suite", "Test", {}, "runs"},
        {"Suite", "Test", {&remark, &failingCondition, &noCondition}, "runs"},
        {"Suite", "DISABLED_Test", {}, "0||0"},
        {"DISABLED_Suite", "Test", {}, "0||0"},
        {"Suite", "disabled_Test", {}, "runs"},
        {"Suite", "Test_DISABLED_", {}, "runs"},
        {"Suite", "Test", {&always, &alwaysWithoutText}, "1|broken|12"},
        {"Suite", "Test", {&alwaysWithoutText}, "1||5"},
        {"Suite", "Test", {&unstable}, "2|unstable|0"},
        {"Suite", "Test", {&condition}, "3|condition|0"},
        {"Suite", "Test", {&condition, &unstable, &always}, "3|condition|12"},
        {"Suite", "Test", {&failingCondition, &unstableWithoutText, &always}, "2|broken|12"},
        {"Suite", "Test", {&failingCondition, &otherCondition}, "0||0"}, // only the first gives a reason
    };
    for (const auto& c : cases)
    {
        const DescribedTests tests({{c.suiteName, c.testName, "Unit", nullptr, c.attributes}});
        TestFilter filter;
        std::string outcome;
        tests.list.ForEach([&](const UnitTest::Test* test) { outcome += filter(test) ? "runs" : ""; });
        for (const DisabledTestInfo& info : filter.ignoredTests)
        {
            outcome += std::to_string(info.kind) + "|" + info.reason + "|" + std::to_string(info.caseNumber);
        }
        EXPECT_EQ(c.expected, outcome) << "case " << &c - cases;
    }
}
