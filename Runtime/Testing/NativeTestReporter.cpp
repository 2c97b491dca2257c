#include "Runtime/Testing/NativeTestReporter.h"

#include <algorithm>

using UnitTest::TestDetails;

bool NativeTestReporter::Failure::operator==(const Failure& other) const
{
    return filename == other.filename && line == other.line && message == other.message;
}

void NativeTestReporter::ReportTestStart(const TestDetails& details)
{
    if (!suppressNameOutput)
    {
        ReportTestNameOnTestStart(details);
    }
    m_currentTest = details;
    m_testInProgress = true;
    m_currentTestFailed = false;
    m_testStarted = true;
    m_attributeFlags.type3 = FindAttribute(details, 3) != nullptr;
    m_attributeFlags.type7 = FindAttribute(details, 7) != nullptr;
    m_attributeFlags.type8 = FindAttribute(details, 8) != nullptr;
}

void NativeTestReporter::ReportFailure(const TestDetails& details, const char* message)
{
    const Failure failure{details.filename, details.lineNumber, message};
    if (std::find(m_failures.begin(), m_failures.end(), failure) == m_failures.end())
    {
        m_failures.push_back(failure);
        MarkCurrentTestAsFailure();
    }
}

void NativeTestReporter::ReportTestFinish(const TestDetails& details, float seconds)
{
    m_testInProgress = false;
    if (!suppressNameOutput)
    {
        ReportTestStatusOnFinish(details, seconds);
    }
    m_properties.clear();
    m_failures.clear();
    m_currentTest = TestDetails();
    if (intraTestHandler != nullptr)
    {
        intraTestHandler(details, seconds);
    }
}

void NativeTestReporter::ReportTestProperty(const TestDetails& /*details*/, const char* name,
                                            const UnitTest::TestProperty& property)
{
    m_properties.insert_or_assign(name, property);
}

void NativeTestReporter::MarkCurrentTestAsFailure()
{
    if (!m_currentTestFailed)
    {
        m_currentTestFailed = true;
        m_failedTests.push_back(m_currentTest);
    }
}
