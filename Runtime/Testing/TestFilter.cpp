#include "Runtime/Testing/TestFilter.h"

#include "Runtime/Testing/TestCategories.h"
#include "Runtime/Utilities/AsciiCase.h"

#include <algorithm>
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

bool IsCategorySelected(const TestDetails& details, const std::vector<core::string>& categoryPrefixes)
{
    const char* const category =
        UnitTest::HasCategory(details) ? details.category : Testing::kUnitTestCategory;
    return categoryPrefixes.empty() || std::any_of(categoryPrefixes.begin(), categoryPrefixes.end(),
                                                   [category](const core::string& prefix)
                                                   { return BeginsWithIgnoringCase(category, prefix); });
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

void SetReason(DisabledTestInfo& info, const TestAttribute& attribute)
{
    info.kind = attribute.type + 1;
    if (attribute.text != nullptr)
    {
        info.reason = attribute.text;
    }
}

/// Says why a test is ignored. Where several attributes give a reason, the last kind of them counts. Only the
/// first attribute of a type is asked, so a condition behind another one ignores a test without a reason.
DisabledTestInfo DescribeIgnored(const TestDetails& details)
{
    DisabledTestInfo info;
    info.details = details;
    if (const TestAttribute* attribute = FindAttribute(details, TestAttribute::kIgnoredForCase))
    {
        SetReason(info, *attribute);
        info.caseNumber = attribute->caseNumber;
    }
    if (const TestAttribute* attribute = FindAttribute(details, TestAttribute::kIgnored))
    {
        SetReason(info, *attribute);
    }
    const TestAttribute* const condition = FindAttribute(details, TestAttribute::kIgnoredIf);
    if (condition != nullptr && IsConditionThatHolds(condition))
    {
        SetReason(info, *condition);
    }
    return info;
}

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
    if (!IsCategorySelected(details, categoryPrefixes))
    {
        return false;
    }
    const core::string suiteName = ToLower(details.suiteName);
    const core::string testName = ToLower(GetDisplayedTestName(details));
    return nameFilters.empty() ||
           std::any_of(nameFilters.begin(), nameFilters.end(),
                       [&](const core::string& filter) { return MatchesName(filter, suiteName, testName); });
}

bool TestFilter::IsIgnored(const UnitTest::Test* test)
{
    return IsIgnoredByAttribute(test->m_details) || HasPrefixedName(test->m_details, "DISABLED_");
}
