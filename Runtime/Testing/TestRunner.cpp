#include "Runtime/Testing/TestRunner.h"

#include <cstring>

namespace UnitTest
{

namespace
{

float SecondsOn(const TimerImplPosix& timer)
{
    return static_cast<float>(timer.GetTimeInMs() / 1000.0);
}

} // namespace

void TestResults::OnTestStart(const TestDetails& details)
{
    ++totalTestCount;
    currentTestFailed = false;
    if (reporter != nullptr)
    {
        reporter->ReportTestStart(details);
    }
}

void TestResults::OnTestFailure(const TestDetails& details, const char* message)
{
    ++failureCount;
    if (!currentTestFailed)
    {
        ++failedTestCount;
        currentTestFailed = true;
    }
    if (reporter != nullptr)
    {
        reporter->ReportFailure(details, message);
    }
}

void TestResults::OnTestFinish(const TestDetails& details, float seconds)
{
    if (reporter != nullptr)
    {
        reporter->ReportTestFinish(details, seconds);
    }
}

TestRunner::TestRunner(TestReporter& reporter)
    : m_reporter(reporter), m_results(std::make_unique<TestResults>(&reporter))
{
    m_timer.Start();
}

bool TestRunner::IsTestInSuite(const Test* test, const char* suiteName) const
{
    return suiteName == nullptr || std::strcmp(test->m_details.suiteName, suiteName) == 0;
}

void TestRunner::RunTest(TestResults* results, const Test* test) const
{
    CurrentTest::Results() = results;
    results->OnTestStart(test->m_details);
    TimerImplPosix timer;
    timer.Start();
    test->Run();
    results->OnTestFinish(test->m_details, SecondsOn(timer));
}

int TestRunner::Finish() const
{
    m_reporter.ReportSummary(m_results->GetTotalTestCount(), m_results->GetFailedTestCount(),
                             m_results->GetFailureCount(), SecondsOn(m_timer));
    return m_results->GetFailureCount();
}

} // namespace UnitTest
