#pragma once

#include "Runtime/Testing/NativeTestReporter.h"

/// Prints aligned lines for people on the console: the name when a test starts, and the status after it when
/// the test ends.
class ConsoleTestReporter : public NativeTestReporter
{
public:
    /// Shows the number of failed tests, not that of failures, and lists those tests.
    void ReportSummary(int totalTests, int failedTestCount, int failureCount, float seconds) override;

    /// Sorts the tests. The highest case number comes first, then the greatest reason by bytes, then the
    /// shortest displayed test name; the letters of the names are not compared, on purpose. Tests with the
    /// same case number and the same reason share a line; those without a reason never do.
    void ReportIgnoredTests(std::vector<DisabledTestInfo>& ignoredTests) override;

    void ReportTestNameOnTestStart(const UnitTest::TestDetails& details) override;

    /// Shows the time of a test that passed in milliseconds, computed in single precision and truncated. A
    /// negative time is reported on standard error and shown as 0.
    void ReportTestStatusOnFinish(const UnitTest::TestDetails& details, float seconds) override;
};
