#include "Runtime/Testing/ConsoleTestReporter.h"

#include "Runtime/Utilities/ConsoleLog.h"
#include "Runtime/Utilities/TextConversion.h"

#include <algorithm>
#include <cstdio>
#include <tuple>

using UnitTest::TestDetails;

namespace
{

/// Returns how many spaces fill a column after a text: none if the text is longer than the column.
int FillerWidth(int columnWidth, std::size_t textLength)
{
    return std::max(0, columnWidth - static_cast<int>(textLength));
}

/// Returns the duration to print: 0 for a negative one, which it reports on standard error.
float ClampPrintedDuration(const TestDetails& details, float seconds)
{
    if (seconds >= 0)
    {
        return seconds;
    }
    std::fprintf(stderr, "Test %s reported negative time: %fms. Time output clamped to 0ms.\n",
                 GetDisplayedTestName(details).c_str(), static_cast<double>(ToSmallerUnit(seconds, 1000)));
    return 0;
}

core::string DescribePass(const NativeTestReporter& reporter, float seconds)
{
    core::string status = Format("PASS(%lldms", static_cast<long long>(ToSmallerUnit(seconds, 1000)));
    for (const auto& [name, property] : reporter.properties)
    {
        status += ", " + name + ": " + property.AsString();
    }
    return status + ")\n";
}

void PrintFailure(const NativeTestReporter::Failure& failure)
{
    const core::string message = failure.message.empty() ? "" : failure.message + " ";
    printf_console("\tCHECK FAILURE: %s(%s:%i)\n", message.c_str(), failure.filename.c_str(), failure.line);
    printf_console("%s", ""); // on purpose: the log handler sees an empty message after each failure
}

const char* TestsWere(std::size_t count)
{
    return count == 1 ? "test was" : "tests were";
}

/// Whether a goes before b in the report on ignored tests.
bool GroupByBugAndReason(const DisabledTestInfo& a, const DisabledTestInfo& b)
{
    const auto lengthOfName = [](const DisabledTestInfo& info)
    { return GetDisplayedTestName(info.details).size(); };
    // The first two descend, so a and b change places in them.
    return std::make_tuple(b.caseNumber, b.reason, lengthOfName(a)) <
           std::make_tuple(a.caseNumber, a.reason, lengthOfName(b));
}

bool ShareLine(const DisabledTestInfo& a, const DisabledTestInfo& b)
{
    return !a.reason.empty() && a.caseNumber == b.caseNumber && a.reason == b.reason;
}

/// The space after a reason stays even if no case number follows.
void PrintReason(const DisabledTestInfo& info)
{
    if (info.caseNumber == 0 && info.reason.empty())
    {
        printf_console("No reason given");
        return;
    }
    if (!info.reason.empty())
    {
        printf_console("%s ", info.reason.c_str());
    }
    if (info.caseNumber != 0)
    {
        printf_console("(case %i)", info.caseNumber);
    }
}

void PrintIgnoredGroup(const DisabledTestInfo& first, std::size_t otherCount)
{
    printf_console("[%s] %s", first.details.suiteName, GetDisplayedTestName(first.details).c_str());
    if (otherCount > 0)
    {
        printf_console(" and %d other %s ignored", static_cast<int>(otherCount), TestsWere(otherCount));
    }
    printf_console(": ");
    PrintReason(first);
    printf_console("\n");
}

} // namespace

void ConsoleTestReporter::ReportTestNameOnTestStart(const TestDetails& details)
{
    const core::string suiteName = details.suiteName;
    const core::string testName = GetDisplayedTestName(details);
    printf_console("[%s]  %*s", suiteName.c_str(), FillerWidth(longestSuiteNameLength, suiteName.size()), "");
    printf_console("%s  %*s", testName.c_str(), FillerWidth(longestTestNameLength, testName.size()), "");
}

void ConsoleTestReporter::ReportTestStatusOnFinish(const TestDetails& details, float seconds)
{
    if (currentTestFailed)
    {
        printf_console("FAIL!!!!\n");
    }
    else
    {
        printf_console("%s", DescribePass(*this, ClampPrintedDuration(details, seconds)).c_str());
    }
    std::for_each(failures.begin(), failures.end(), PrintFailure);
}

void ConsoleTestReporter::ReportSummary(int totalTests, int /*failedTestCount*/, int /*failureCount*/,
                                        float seconds)
{
    printf_console("Ran %i tests with %i failures in %.2f seconds\n", totalTests,
                   static_cast<int>(failedTests.size()), static_cast<double>(seconds));
    for (const TestDetails& details : failedTests)
    {
        printf_console("\tFAILED: %s [%s]\n", GetDisplayedTestName(details).c_str(), details.suiteName);
    }
}

void ConsoleTestReporter::ReportIgnoredTests(std::vector<DisabledTestInfo>& ignoredTests)
{
    if (ignoredTests.empty())
    {
        return;
    }
    std::sort(ignoredTests.begin(), ignoredTests.end(), GroupByBugAndReason);
    // One print a step, since a log handler sees each of them.
    printf_console("\n%zu %s IGNORED!\n", ignoredTests.size(), TestsWere(ignoredTests.size()));
    for (auto first = ignoredTests.begin(); first != ignoredTests.end();)
    {
        const auto end =
            std::find_if_not(first + 1, ignoredTests.end(),
                             [&](const DisabledTestInfo& info) { return ShareLine(*first, info); });
        PrintIgnoredGroup(*first, static_cast<std::size_t>(end - first) - 1);
        first = end;
    }
}
