#pragma once

#include "Runtime/Testing/NativeTestReporter.h"

#include <cstdint>

/// Logs status lines for programs: one when a test begins, one when it ends, and the test's failures between
/// them. Neither a summary nor ignored tests are reported.
class AutomationTestReporter : public NativeTestReporter
{
public:
    void ReportSummary(int /*total*/, int /*failed*/, int /*failures*/, float /*seconds*/) override {}
    void ReportIgnoredTests(std::vector<DisabledTestInfo>& /*ignoredTests*/) override {}
    void ReportTestNameOnTestStart(const UnitTest::TestDetails& details) override;

    /// A negative time is not clamped: the line shows it modulo 2^64.
    void ReportTestStatusOnFinish(const UnitTest::TestDetails& details, float seconds) override;

    bool reportPerformanceData = false; ///< set by the run; no output depends on it yet
};

/// The texts of the status lines: "##qzm:" and a compact JSON object, without a line break. They show the
/// time of the call and the process id. No argument may be null.
namespace Testing
{

constexpr unsigned int kProtocolVersion = 2;
constexpr const char* kPhaseBegin = "Begin";
constexpr const char* kPhaseEnd = "End";

enum class TestState : std::uint32_t
{
    NoResult = 0,
    Passed = 4,
    Failed = 5
};

/// Returns the line for a test that begins. The misspelling in both names is kept on purpose.
core::string TestStatusBeginMesssageToQZMString(const char* name);

/// Returns the line for a test that ended, with its failure text, which may be empty, and the place where it
/// is defined.
core::string TestStatusEndMesssageToQZMString(const char* name, TestState state,
                                              unsigned long long durationMicroseconds, const char* message,
                                              const char* fileName, int lineNumber);

} // namespace Testing
