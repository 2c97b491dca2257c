#include "Runtime/Testing/TestFilter.h"

#include "Runtime/Testing/TestRunner.h"
#include "Runtime/Utilities/TextConversion.h"

#include <algorithm>
#include <deque>
#include <string_view>

using UnitTest::TestAttribute;
using UnitTest::TestDetails;

namespace
{

bool BeginsWith(std::string_view text, std::string_view prefix)
{
    return text.substr(0, prefix.size()) == prefix;
}

bool Contains(std::string_view text, std::string_view part)
{
    return text.find(part) != std::string_view::npos;
}

bool HasPrefixedName(const TestDetails& details, std::string_view prefix)
{
    return BeginsWith(details.suiteName, prefix) || BeginsWith(details.testName, prefix);
}

bool MatchesName(std::string_view filter, std::string_view suiteName, std::string_view testName)
{
    const std::size_t fullStop = filter.find('.');
    if (fullStop == std::string_view::npos)
    {
        return Contains(suiteName, filter) || Contains(testName, filter);
    }
    return Contains(suiteName, filter.substr(0, fullStop)) && Contains(testName, filter.substr(fullStop + 1));
}

bool IsConditionThatHolds(const TestAttribute* attribute)
{
    return attribute->type == TestAttribute::kIgnoredIf && attribute->predicate != nullptr &&
           attribute->predicate();
}

bool IsIgnoredByAttribute(const TestDetails& details)
{
    return FindAttribute(details, TestAttribute::kIgnoredForCase) != nullptr ||
           FindAttribute(details, TestAttribute::kIgnored) != nullptr ||
           (details.attributes != nullptr &&
            std::any_of(details.attributes->begin(), details.attributes->end(), IsConditionThatHolds));
}

/// Describes why a test is ignored. If attributes of several types give a reason, the highest type counts.
/// Only the first attribute of each type gives one: if the first condition does not hold but a later one
/// does, the test is ignored without a reason. That is intentional.
DisabledTestInfo DescribeIgnored(const TestDetails& details)
{
    DisabledTestInfo info;
    info.details = details;
    for (const int type :
         {TestAttribute::kIgnoredForCase, TestAttribute::kIgnored, TestAttribute::kIgnoredIf})
    {
        const TestAttribute* const attribute = FindAttribute(details, type);
        if (attribute == nullptr || (type == TestAttribute::kIgnoredIf && !IsConditionThatHolds(attribute)))
        {
            continue;
        }
        info.kind = type + 1;
        info.reason = attribute->text != nullptr ? attribute->text : info.reason;
        info.caseNumber = type == TestAttribute::kIgnoredForCase ? attribute->caseNumber : info.caseNumber;
    }
    return info;
}

/// Collects the tests that need a substitute. The list can't grow while it is visited, so the substitutes are
/// added afterwards.
struct NoCategoryTestCollector
{
    void operator()(const UnitTest::Test* test)
    {
        if (filter.Filter(test) && !HasCategory(test->m_details))
        {
            collected.push_back(test->m_details);
        }
    }

    const TestFilter& filter;
    std::vector<TestDetails> collected;
};

} // namespace

bool TestFilter::operator()(const UnitTest::Test* test)
{
    if (!Filter(test))
    {
        return false;
    }
    if (IsIgnored(test))
    {
        ignoredTests.push_back(DescribeIgnored(test->m_details));
        return false;
    }
    return HasCategory(test->m_details);
}

bool TestFilter::Filter(const UnitTest::Test* test) const
{
    const TestDetails& details = test->m_details;
    if (runOnlyPrefixedTests && !HasPrefixedName(details, "RUN_"))
    {
        return false;
    }
    if (!SelectsCategory(HasCategory(details) ? details.category : Testing::kUnitTestCategory))
    {
        return false;
    }
    const core::string suiteName = ToLower(details.suiteName);
    const core::string testName = ToLower(GetDisplayedTestName(details));
    return nameFilters.empty() ||
           std::any_of(nameFilters.begin(), nameFilters.end(),
                       [&](const core::string& filter) { return MatchesName(filter, suiteName, testName); });
}

bool TestFilter::SelectsCategory(const char* category) const
{
    return categoryPrefixes.empty() || std::any_of(categoryPrefixes.begin(), categoryPrefixes.end(),
                                                   [category](const core::string& prefix)
                                                   { return BeginsWithIgnoringCase(category, prefix); });
}

bool TestFilter::IsIgnored(const UnitTest::Test* test)
{
    return IsIgnoredByAttribute(test->m_details) || HasPrefixedName(test->m_details, "DISABLED_");
}

NoCategoryTest::NoCategoryTest(const TestDetails& details)
    : Test(TestDetails(details.testName, details.suiteName, Testing::kUnitTestCategory, details.filename,
                       details.lineNumber))
{
}

void NoCategoryTest::RunImpl() const
{
    UnitTest::CurrentTest::Results()->OnTestFailure(
        m_details, "DOES NOT HAVE AN ASSOCIATED SUITE, PLEASE USE A SPECIFIC SUITE e.g. UNIT_TEST_SUITE, "
                   "INTEGRATION_TEST_SUITE, etc.");
}

void AddNoCategoryTests(UnitTest::TestList& tests, const TestFilter& filter)
{
    static std::deque<NoCategoryTest> substitutes; // the list points to them, even in later runs
    NoCategoryTestCollector collector{filter, {}};
    tests.ForEach(collector);
    for (const TestDetails& details : collector.collected)
    {
        tests.AddProcedurallyGeneratedTest(&substitutes.emplace_back(details));
    }
}
