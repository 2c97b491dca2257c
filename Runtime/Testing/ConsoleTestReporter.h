#pragma once

#include "Runtime/Testing/NativeTestReporter.h"

/// Prints aligned lines for people on the console: the name when a test starts, and the status behind it when
/// the test ends.
class ConsoleTestReporter : public NativeTestReporter
{
public:
    /// Shows the number of failed tests, not that of failures, and then those tests.
    void ReportSummary(int totalTests, int failedTests, int failures, float seconds) override;

    void ReportIgnoredTests(std::vector<DisabledTestInfo>& ignoredTests) override;

protected:
    void ReportTestNameOnTestStart(const UnitTest::TestDetails& details) override;

    /// Shows the time of a test that passed in whole milliseconds: in single precision, the rest cut off. A
    /// negative one is reported on standard error and shown as 0.
    void ReportTestStatusOnFinish(const UnitTest::TestDetails& details, float seconds) override;

private:
    void PrintPass(const UnitTest::TestDetails& details, float seconds) const;
    void PrintFailures() const;
};
