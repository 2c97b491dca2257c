#include "Runtime/Testing/ConsoleTestReporter.h"

#include "Runtime/Testing/IgnoredTests.h"
#include "Runtime/Utilities/ConsoleLog.h"
#include "Runtime/Utilities/Format.h"

#include <algorithm>
#include <cstdio>

using UnitTest::TestDetails;

namespace
{

/// Returns how many blanks fill a column behind a text: none if the text is longer than the column.
int FillerWidth(int columnWidth, std::size_t textLength)
{
    return std::max(0, columnWidth - static_cast<int>(textLength));
}

float ClampDuration(const TestDetails& details, float seconds)
{
    if (seconds >= 0)
    {
        return seconds;
    }
    std::fprintf(stderr, "Test %s reported negative time: %fms. Time output clamped to 0ms.\n",
                 GetDisplayedTestName(details).c_str(), static_cast<double>(seconds * 1000));
    return 0;
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
    if (HasCurrentTestFailed())
    {
        printf_console("FAIL!!!!\n");
    }
    else
    {
        PrintPass(details, seconds);
    }
    PrintFailures();
}

void ConsoleTestReporter::PrintPass(const TestDetails& details, float seconds) const
{
    const float milliseconds = ClampDuration(details, seconds) * 1000;
    core::string status = Format("PASS(%lldms", static_cast<long long>(milliseconds));
    for (const auto& [name, property] : GetProperties())
    {
        status += ", " + name + ": " + property.AsString();
    }
    status += ")\n";
    printf_console("%s", status.c_str());
}

void ConsoleTestReporter::PrintFailures() const
{
    for (const Failure& failure : GetFailures())
    {
        if (failure.message.empty())
        {
            printf_console("\tCHECK FAILURE: (%s:%i)\n", failure.filename.c_str(), failure.line);
        }
        else
        {
            printf_console("\tCHECK FAILURE: %s (%s:%i)\n", failure.message.c_str(), failure.filename.c_str(),
                           failure.line);
        }
        printf_console("%s", ""); // the log handler sees an empty message behind each failure
    }
}

void ConsoleTestReporter::ReportSummary(int totalTests, int /*failedTests*/, int /*failures*/, float seconds)
{
    printf_console("Ran %i tests with %i failures in %.2f seconds\n", totalTests,
                   static_cast<int>(GetFailedTests().size()), static_cast<double>(seconds));
    for (const TestDetails& details : GetFailedTests())
    {
        printf_console("\tFAILED: %s [%s]\n", GetDisplayedTestName(details).c_str(), details.suiteName);
    }
}

void ConsoleTestReporter::ReportIgnoredTests(std::vector<DisabledTestInfo>& ignoredTests)
{
    printf_console("%s", DescribeIgnoredTests(ignoredTests).c_str());
}
