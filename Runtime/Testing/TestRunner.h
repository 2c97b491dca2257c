#pragma once

#include "Runtime/Testing/TestList.h"
#include "Runtime/Testing/TestResults.h"
#include "Runtime/Testing/TimerImplPosix.h"

#include <memory>

namespace UnitTest
{

/// Runs tests one after another, and tells a reporter.
class TestRunner
{
public:
    /// Starts the clock of the whole run. The reporter must outlive this object.
    explicit TestRunner(TestReporter& reporter);

    /// Runs every test of the suite (of all suites for null) that the predicate, called with a pointer to
    /// each, wants to be run; then finishes. Returns the number of failures.
    template <class Predicate>
    int RunTestsIf(const TestList& tests, const char* suiteName, Predicate& predicate) const;

    /// Returns whether the test belongs to the suite; every test belongs to the suite null.
    [[nodiscard]] bool IsTestInSuite(const Test* test, const char* suiteName) const;

    /// Runs one test. The time that it is reported with is whole milliseconds.
    void RunTest(TestResults* results, const Test* test) const;

    /// Reports the summary and returns the number of failures.
    [[nodiscard]] int Finish() const;

private:
    TestReporter& m_reporter;
    std::unique_ptr<TestResults> m_results; ///< a pointer, since the operations that count are const
    TimerImplPosix m_timer;
};

template <class Predicate>
int TestRunner::RunTestsIf(const TestList& tests, const char* suiteName, Predicate& predicate) const
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

} // namespace UnitTest
