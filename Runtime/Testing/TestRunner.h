#pragma once

#include "Runtime/Testing/TestList.h"
#include "Runtime/Testing/TestReporter.h"
#include "Runtime/Utilities/WallClock.h"

#include <memory>

namespace UnitTest
{

/// Counts the events of a run, and passes them on to the reporter.
class TestResults
{
public:
    /// The reporter, which may be null, must outlive this object.
    explicit TestResults(TestReporter* testReporter) : reporter(testReporter) {}

    void OnTestStart(const TestDetails& details);
    void OnTestFailure(const TestDetails& details, const char* message);
    void OnTestFinish(const TestDetails& details, float seconds);

    [[nodiscard]] int GetTotalTestCount() const { return totalTestCount; }
    [[nodiscard]] int GetFailedTestCount() const { return failedTestCount; }
    [[nodiscard]] int GetFailureCount() const { return failureCount; }

    TestReporter* reporter;
    int totalTestCount = 0;
    int failedTestCount = 0;
    int failureCount = 0; ///< a test can have several
    bool currentTestFailed = false;
};

/// Runs tests one after another, and reports each to a reporter.
class TestRunner
{
public:
    /// Starts the clock of the whole run. The reporter must outlive this object.
    explicit TestRunner(TestReporter& reporter);

    /// Runs every test of the suite (of all suites for null) for which predicate(test) is true, then
    /// finishes. Returns the number of failures.
    template <class Predicate>
    int RunTestsIf(const TestList& tests, const char* suiteName, Predicate& predicate) const
    {
        tests.ForEach(
            [&](const Test* test)
            {
                if (IsTestInSuite(test, suiteName) && predicate(test))
                {
                    RunTest(m_results.get(), test);
                }
            });
        return Finish();
    }

    /// Returns whether the test belongs to the suite; always true for null.
    [[nodiscard]] bool IsTestInSuite(const Test* test, const char* suiteName) const;

    /// Runs one test, and counts it in the results. Its reported time has a resolution of a millisecond.
    void RunTest(TestResults* results, const Test* test) const;

    /// Reports the summary and returns the number of failures.
    [[nodiscard]] int Finish() const;

private:
    TestReporter& m_reporter;
    std::unique_ptr<TestResults> m_results; ///< a pointer, since the operations that count are const
    TimerImplPosix m_timer;
};

} // namespace UnitTest
