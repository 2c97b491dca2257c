#pragma once

#include "Runtime/Testing/TestDetails.h"
#include "Runtime/Testing/TestProperty.h"

namespace UnitTest
{

/// Receives the events of a run. Per test: one start, any number of failures and properties, one finish; at
/// the end of the run one summary.
class TestReporter
{
public:
    TestReporter() = default;
    virtual ~TestReporter() = default;

    TestReporter(const TestReporter&) = delete;
    TestReporter& operator=(const TestReporter&) = delete;

    virtual void ReportTestStart(const TestDetails& details) = 0;

    /// The details are those of the running test, but for the line, which is that of the failing check.
    virtual void ReportFailure(const TestDetails& details, const char* message) = 0;

    virtual void ReportTestFinish(const TestDetails& details, float seconds) = 0;
    virtual void ReportTestProperty(const TestDetails& details, const char* name,
                                    const TestProperty& property) = 0;

    /// The seconds are those of the whole run.
    virtual void ReportSummary(int totalTests, int failedTests, int failures, float seconds) = 0;
};

} // namespace UnitTest
