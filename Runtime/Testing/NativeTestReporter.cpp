#include "Runtime/Testing/NativeTestReporter.h"

#include <algorithm>

using UnitTest::TestDetails;

float ToSmallerUnit(float seconds, float unitsPerSecond)
{
    // An x87 register holds more digits than a float, also after a cast; a store into memory rounds.
    volatile const float rounded = seconds * unitsPerSecond;
    return rounded;
}

void NativeTestReporter::ReportTestStart(const TestDetails& details)
{
    if (!suppressNameOutput)
    {
        ReportTestNameOnTestStart(details);
    }
    currentTest = details;
    testInProgress = true;
    currentTestFailed = false;
    testStarted = true;
    hasAttributeOfType3 = FindAttribute(details, 3) != nullptr;
    hasAttributeOfType7 = FindAttribute(details, 7) != nullptr;
    hasAttributeOfType8 = FindAttribute(details, 8) != nullptr;
}

void NativeTestReporter::ReportFailure(const TestDetails& details, const char* message)
{
    const Failure failure{details.filename, details.lineNumber, message};
    if (std::find(failures.begin(), failures.end(), failure) == failures.end())
    {
        failures.push_back(failure);
        MarkCurrentTestAsFailure();
    }
}

void NativeTestReporter::ReportTestFinish(const TestDetails& details, float seconds)
{
    testInProgress = false;
    if (!suppressNameOutput)
    {
        ReportTestStatusOnFinish(details, seconds);
    }
    properties.clear();
    failures.clear();
    currentTest = TestDetails();
    if (intraTestHandler != nullptr)
    {
        intraTestHandler(details, seconds);
    }
}

void NativeTestReporter::ReportTestProperty(const TestDetails& /*details*/, const char* name,
                                            const UnitTest::TestProperty& property)
{
    properties.insert_or_assign(name, property);
}

void NativeTestReporter::MarkCurrentTestAsFailure()
{
    if (!currentTestFailed)
    {
        currentTestFailed = true;
        failedTests.push_back(currentTest);
    }
}
