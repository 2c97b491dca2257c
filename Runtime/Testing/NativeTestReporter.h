#pragma once

#include "Runtime/Testing/DisabledTestInfo.h"
#include "Runtime/Testing/TestReporter.h"

#include <map>
#include <vector>

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

        bool operator==(const Failure& other) const;
    };

    using IntraTestHandler = void (*)(const UnitTest::TestDetails& details, float seconds);

    /// The name is reported before the test counts as in progress, so it still reaches the console.
    void ReportTestStart(const UnitTest::TestDetails& details) override;

    /// A failure with the file, line and message of an earlier one in the same test is left out.
    void ReportFailure(const UnitTest::TestDetails& details, const char* message) override;

    /// The status is reported when the test no longer counts as in progress.
    void ReportTestFinish(const UnitTest::TestDetails& details, float seconds) override;

    /// Keeps the property until the test finishes, in the place of one with that name.
    void ReportTestProperty(const UnitTest::TestDetails& details, const char* name,
                            const UnitTest::TestProperty& property) override;

    /// Reports the selected tests that were not run, and may sort them.
    virtual void ReportIgnoredTests(std::vector<DisabledTestInfo>& ignoredTests) = 0;

    [[nodiscard]] bool IsTestInProgress() const { return m_testInProgress; }

    /// Whether a test was ever started.
    [[nodiscard]] bool WasTestStarted() const { return m_testStarted; }

    /// Returns the failed tests in the order in which they first failed, each once.
    [[nodiscard]] const std::vector<UnitTest::TestDetails>& GetFailedTests() const { return m_failedTests; }

    // Set by the run before its first test.
    IntraTestHandler intraTestHandler = nullptr; ///< called behind every test, unless null
    bool suppressNameOutput = false;             ///< whether to report neither names nor statuses
    int longestSuiteNameLength = 0;              ///< column widths
    int longestTestNameLength = 0;

protected:
    /// Reports that a test starts; it is not the current one yet.
    virtual void ReportTestNameOnTestStart(const UnitTest::TestDetails& details) = 0;

    /// Reports the outcome of the current test.
    virtual void ReportTestStatusOnFinish(const UnitTest::TestDetails& details, float seconds) = 0;

    [[nodiscard]] bool HasCurrentTestFailed() const { return m_currentTestFailed; }
    [[nodiscard]] const std::vector<Failure>& GetFailures() const { return m_failures; }

    /// Returns the properties of the current test, ordered by the bytes of their names.
    [[nodiscard]] const std::map<core::string, UnitTest::TestProperty>& GetProperties() const
    {
        return m_properties;
    }

    /// Which of the attributes that only concern reporters the current test carries, by their types.
    struct AttributeFlags
    {
        bool type3 = false;
        bool type7 = false;
        bool type8 = false;
    };
    [[nodiscard]] const AttributeFlags& GetAttributeFlags() const { return m_attributeFlags; }

private:
    void MarkCurrentTestAsFailure();

    bool m_testInProgress = false;
    bool m_testStarted = false;
    std::vector<UnitTest::TestDetails> m_failedTests;

    // Of the current test.
    bool m_currentTestFailed = false;
    UnitTest::TestDetails m_currentTest;
    std::map<core::string, UnitTest::TestProperty> m_properties;
    std::vector<Failure> m_failures;
    AttributeFlags m_attributeFlags;
};
