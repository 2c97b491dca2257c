#include "Runtime/Testing/AutomationTestReporter.h"

#include "Runtime/Testing/TestStatusMessages.h"
#include "Runtime/Utilities/ConsoleLog.h"
#include "Runtime/Utilities/Format.h"

using UnitTest::TestDetails;

namespace
{

constexpr const char* kSourceFile = "./Runtime/Testing/AutomationTestReporter";

void Log(const core::string& message, const char* file, int line)
{
    DebugStringToFile({message.c_str(), LogType::Log, file, line});
}

/// Logs the failures and returns their texts, one behind the other.
core::string LogFailures(const std::vector<NativeTestReporter::Failure>& failures)
{
    core::string combined;
    for (const NativeTestReporter::Failure& failure : failures)
    {
        const char* const file = failure.filename.c_str();
        const core::string text =
            Format("CHECK FAILURE: %s\n\t(%s:%i)\n", failure.message.c_str(), file, failure.line);
        Log(text, file, failure.line);
        combined += text;
    }
    return combined;
}

/// Goes through a signed number, since a negative one has no direct way to an unsigned one.
unsigned long long ToMicroseconds(float seconds)
{
    return static_cast<unsigned long long>(static_cast<long long>(seconds * 1'000'000));
}

} // namespace

void AutomationTestReporter::ReportTestNameOnTestStart(const TestDetails& details)
{
    Log(Testing::TestStatusBeginMesssageToQZMString(GetTestName(details).c_str()), kSourceFile, 33);
}

void AutomationTestReporter::ReportTestStatusOnFinish(const TestDetails& details, float seconds)
{
    const core::string failureText = LogFailures(GetFailures());
    const auto state = HasCurrentTestFailed() ? Testing::TestState::Failed : Testing::TestState::Passed;
    Log(Testing::TestStatusEndMesssageToQZMString(GetTestName(details).c_str(), state,
                                                  ToMicroseconds(seconds), failureText.c_str(),
                                                  details.filename, details.lineNumber),
        kSourceFile, 110);
}

void AutomationTestReporter::ReportSummary(int /*totalTests*/, int /*failedTests*/, int /*failures*/,
                                           float /*seconds*/)
{
}

void AutomationTestReporter::ReportIgnoredTests(std::vector<DisabledTestInfo>& /*ignoredTests*/) {}
