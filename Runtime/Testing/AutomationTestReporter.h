#pragma once

#include "Runtime/Testing/NativeTestReporter.h"

/// Logs status lines for programs: one when a test begins, one when it ends, with its failures between them.
/// A reader learns everything from these, so summary and ignored tests are not reported.
class AutomationTestReporter : public NativeTestReporter
{
public:
    /// Whether performance data is wanted is only kept: no output depends on it yet.
    explicit AutomationTestReporter(bool reportPerformanceData)
        : m_reportPerformanceData(reportPerformanceData)
    {
    }

    [[nodiscard]] bool ReportsPerformanceData() const { return m_reportPerformanceData; }

    void ReportSummary(int totalTests, int failedTests, int failures, float seconds) override;
    void ReportIgnoredTests(std::vector<DisabledTestInfo>& ignoredTests) override;

protected:
    void ReportTestNameOnTestStart(const UnitTest::TestDetails& details) override;

    /// A negative time is not clamped: the line shows it modulo 2^64.
    void ReportTestStatusOnFinish(const UnitTest::TestDetails& details, float seconds) override;

private:
    bool m_reportPerformanceData;
};
