#include "Runtime/Testing/AutomationTestReporter.h"

#include "Modules/JSONSerialize/Public/JSONWrite.h"
#include "Runtime/Utilities/ConsoleLog.h"
#include "Runtime/Utilities/TextConversion.h"
#include "Runtime/Utilities/WallClock.h"

#include <unistd.h>

using UnitTest::TestDetails;

namespace
{

constexpr const char* kSourceFile = "./Runtime/Testing/AutomationTestReporter";

void Log(const core::string& message, const char* file, int line)
{
    DebugStringToFile({message.c_str(), LogType::Log, file, line});
}

/// Logs the failures and returns their texts, one after the other.
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

/// Converts through a signed number: converting a negative float to an unsigned number is undefined.
unsigned long long ToMicroseconds(float seconds)
{
    return static_cast<unsigned long long>(static_cast<long long>(ToSmallerUnit(seconds, 1'000'000)));
}

unsigned long long MillisecondsSinceUnixEpoch()
{
    constexpr std::int64_t kTicksPerMillisecond = 10'000;
    return static_cast<unsigned long long>((GetCurrentTimeAsDateTime() - kDateTimeOfUnixEpoch) /
                                           kTicksPerMillisecond);
}

template <class T>
void Add(JSONWrite& json, const char* name, T value)
{
    json.Transfer(value, name, 0);
}

/// Adds the members that both lines begin with.
void AddStatus(JSONWrite& json, const char* phase, const char* name, Testing::TestState state)
{
    Add(json, "type", "TestStatus");
    Add(json, "version", Testing::kProtocolVersion);
    Add(json, "phase", phase);
    Add(json, "time", MillisecondsSinceUnixEpoch());
    Add(json, "processId", static_cast<int>(::getpid()));
    Add(json, "name", name);
    Add(json, "state", static_cast<unsigned int>(state));
}

core::string ToLine(const JSONWrite& json)
{
    core::string text;
    json.OutputToString(text, false);
    return "##qzm:" + text;
}

} // namespace

core::string Testing::TestStatusBeginMesssageToQZMString(const char* name)
{
    JSONWrite json(0, nullptr);
    AddStatus(json, kPhaseBegin, name, TestState::NoResult);
    return ToLine(json);
}

core::string Testing::TestStatusEndMesssageToQZMString(const char* name, TestState state,
                                                       unsigned long long durationMicroseconds,
                                                       const char* message, const char* fileName,
                                                       int lineNumber)
{
    JSONWrite json(0, nullptr);
    AddStatus(json, kPhaseEnd, name, state);
    Add(json, "message", message);
    Add(json, "fileName", fileName);
    Add(json, "lineNumber", lineNumber);
    Add(json, "durationMicroseconds", durationMicroseconds);
    Add(json, "duration", durationMicroseconds / 1000);
    return ToLine(json);
}

void AutomationTestReporter::ReportTestNameOnTestStart(const TestDetails& details)
{
    Log(Testing::TestStatusBeginMesssageToQZMString(GetTestName(details).c_str()), kSourceFile, 33);
}

void AutomationTestReporter::ReportTestStatusOnFinish(const TestDetails& details, float seconds)
{
    const core::string failureText = LogFailures(failures);
    const auto state = currentTestFailed ? Testing::TestState::Failed : Testing::TestState::Passed;
    Log(Testing::TestStatusEndMesssageToQZMString(GetTestName(details).c_str(), state,
                                                  ToMicroseconds(seconds), failureText.c_str(),
                                                  details.filename, details.lineNumber),
        kSourceFile, 110);
}
