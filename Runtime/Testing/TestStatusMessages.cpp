#include "Runtime/Testing/TestStatusMessages.h"

#include "Modules/JSONSerialize/Public/JSONWrite.h"
#include "Runtime/Utilities/DateTime.h"

#include <unistd.h>

namespace
{

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

/// Adds what both messages begin with.
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

namespace Testing
{

core::string TestStatusBeginMesssageToQZMString(const char* name)
{
    JSONWrite json(0, nullptr);
    AddStatus(json, kPhaseBegin, name, TestState::NoResult);
    return ToLine(json);
}

core::string TestStatusEndMesssageToQZMString(const char* name, TestState state,
                                              unsigned long long durationMicroseconds, const char* message,
                                              const char* fileName, int lineNumber)
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

} // namespace Testing
