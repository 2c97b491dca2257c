#include "Runtime/Testing/IgnoredTests.h"

#include "Runtime/Utilities/Format.h"

#include <algorithm>

namespace
{

const char* TestsWere(std::size_t count)
{
    return count == 1 ? "test was" : "tests were";
}

bool ShareLine(const DisabledTestInfo& a, const DisabledTestInfo& b)
{
    return !a.reason.empty() && a.caseNumber == b.caseNumber && a.reason == b.reason;
}

/// The blank behind a reason is wanted even if no case number follows.
core::string DescribeReason(const DisabledTestInfo& info)
{
    core::string text = info.reason.empty() ? "" : info.reason + " ";
    if (info.caseNumber != 0)
    {
        text += Format("(case %i)", info.caseNumber);
    }
    return text.empty() ? "No reason given" : text;
}

core::string DescribeGroup(const DisabledTestInfo& first, std::size_t otherCount)
{
    core::string line =
        Format("[%s] %s", first.details.suiteName, GetDisplayedTestName(first.details).c_str());
    if (otherCount > 0)
    {
        line += Format(" and %zu other %s ignored", otherCount, TestsWere(otherCount));
    }
    return line + ": " + DescribeReason(first) + "\n";
}

} // namespace

bool GroupByBugAndReason(const DisabledTestInfo& a, const DisabledTestInfo& b)
{
    if (a.caseNumber != b.caseNumber)
    {
        return a.caseNumber > b.caseNumber;
    }
    if (a.reason != b.reason)
    {
        return a.reason > b.reason;
    }
    return GetDisplayedTestName(a.details).size() < GetDisplayedTestName(b.details).size();
}

core::string DescribeIgnoredTests(std::vector<DisabledTestInfo>& ignoredTests)
{
    if (ignoredTests.empty())
    {
        return "";
    }
    std::sort(ignoredTests.begin(), ignoredTests.end(), GroupByBugAndReason);
    core::string report = Format("\n%zu %s IGNORED!\n", ignoredTests.size(), TestsWere(ignoredTests.size()));
    for (auto first = ignoredTests.begin(); first != ignoredTests.end();)
    {
        const auto end =
            std::find_if_not(first + 1, ignoredTests.end(),
                             [&](const DisabledTestInfo& info) { return ShareLine(*first, info); });
        report += DescribeGroup(*first, static_cast<std::size_t>(end - first) - 1);
        first = end;
    }
    return report;
}
