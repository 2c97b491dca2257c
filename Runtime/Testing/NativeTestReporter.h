#pragma once

#include "Runtime/Testing/TestReporter.h"

#include <map>
#include <tuple>
#include <vector>

/// Returns seconds in a smaller unit, rounded to single precision also where the processor computes with more
/// digits: 0.015 seconds are 15 milliseconds, not 14.99.
float ToSmallerUnit(float seconds, float unitsPerSecond);

/// What all reporters share: keeps the state of the running test and the list of failed ones. A derived class
/// turns it into output.
class NativeTestReporter : public UnitTest::TestReporter
{
public:
    struct Failure
    {
        core::string filename; ///< of the failing check, like the line
        int line;
        core::string message;

        bool operator==(const Failure& other) const
        {
            return std::tie(filename, line, message) == std::tie(other.filename, other.line, other.message);
        }
    };

    using IntraTestHandler = void (*)(const UnitTest::TestDetails& details, float seconds);

    /// The name is reported before the test counts as in progress, so that the log handler for tests lets it
    /// through.
    void ReportTestStart(const UnitTest::TestDetails& details) override;

    /// A failure with the file, line and message of an earlier one in the same test is left out.
    void ReportFailure(const UnitTest::TestDetails& details, const char* message) override;

    /// The status is reported when the test no longer counts as in progress.
    void ReportTestFinish(const UnitTest::TestDetails& details, float seconds) override;

    /// Keeps the property until the test finishes. It replaces an earlier one of the same name.
    void ReportTestProperty(const UnitTest::TestDetails& details, const char* name,
                            const UnitTest::TestProperty& property) override;

    /// Reports the selected tests that were not run, and may sort them.
    virtual void ReportIgnoredTests(std::vector<DisabledTestInfo>& ignoredTests) = 0;

    /// Reports that a test starts; it is not the current one yet.
    virtual void ReportTestNameOnTestStart(const UnitTest::TestDetails& details) = 0;

    /// Reports the outcome of the current test.
    virtual void ReportTestStatusOnFinish(const UnitTest::TestDetails& details, float seconds) = 0;

    /// Appends the current test to failedTests, unless it has failed before.
    void MarkCurrentTestAsFailure();

    IntraTestHandler intraTestHandler = nullptr; ///< called after every test, unless null
    bool testInProgress = false;
    bool suppressNameOutput = false; ///< whether to report neither names nor statuses
    bool testStarted = false;        ///< whether a test was ever started
    int longestSuiteNameLength = 0;  ///< column widths
    int longestTestNameLength = 0;
    std::vector<UnitTest::TestDetails> failedTests; ///< in the order in which they first failed, each once

    // Of the current test.
    bool currentTestFailed = false;
    UnitTest::TestDetails currentTest;
    std::map<core::string, UnitTest::TestProperty> properties; ///< ordered by the bytes of their names
    std::vector<Failure> failures;
    bool hasAttributeOfType3 = false;
    bool hasAttributeOfType7 = false;
    bool hasAttributeOfType8 = false;
};
