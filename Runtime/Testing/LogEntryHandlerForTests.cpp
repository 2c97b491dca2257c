#include "Runtime/Testing/LogEntryHandlerForTests.h"

#include "Runtime/Testing/NativeTestReporter.h"
#include "Runtime/Testing/TestingGlobals.h"

#include <mutex>

bool LogEntryHandlerForTests(LogType /*type*/, const char* /*format*/, std::va_list /*arguments*/)
{
    static std::mutex mutex;
    const std::lock_guard<std::mutex> lock(mutex);
    const NativeTestReporter* const reporter = Testing::g_TestReporter;
    if (reporter == nullptr || !reporter->IsTestInProgress())
    {
        return true;
    }
    return !reporter->WasTestStarted();
}
