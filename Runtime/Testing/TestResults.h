#pragma once

#include "Runtime/Testing/TestReporter.h"

namespace UnitTest
{

/// Counts what happens in a run, and tells the reporter.
class TestResults
{
public:
    /// The reporter, which may be null, must outlive this object.
    explicit TestResults(TestReporter* reporter) : m_reporter(reporter) {}

    void OnTestStart(const TestDetails& details);
    void OnTestFailure(const TestDetails& details, const char* message);
    void OnTestFinish(const TestDetails& details, float seconds);

    [[nodiscard]] int GetTotalTestCount() const { return m_totalTestCount; }
    [[nodiscard]] int GetFailedTestCount() const { return m_failedTestCount; }
    [[nodiscard]] int GetFailureCount() const { return m_failureCount; } ///< a test can have several

private:
    TestReporter* m_reporter;
    int m_totalTestCount = 0;
    int m_failedTestCount = 0;
    int m_failureCount = 0;
    bool m_currentTestFailed = false;
};

} // namespace UnitTest
