#include "Runtime/Testing/TestResults.h"

namespace UnitTest
{

void TestResults::OnTestStart(const TestDetails& details)
{
    ++m_totalTestCount;
    m_currentTestFailed = false;
    if (m_reporter != nullptr)
    {
        m_reporter->ReportTestStart(details);
    }
}

void TestResults::OnTestFailure(const TestDetails& details, const char* message)
{
    ++m_failureCount;
    if (!m_currentTestFailed)
    {
        ++m_failedTestCount;
        m_currentTestFailed = true;
    }
    if (m_reporter != nullptr)
    {
        m_reporter->ReportFailure(details, message);
    }
}

void TestResults::OnTestFinish(const TestDetails& details, float seconds)
{
    if (m_reporter != nullptr)
    {
        m_reporter->ReportTestFinish(details, seconds);
    }
}

} // namespace UnitTest
