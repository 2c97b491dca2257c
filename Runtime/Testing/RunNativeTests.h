#pragma once

#include "Runtime/Core/Containers/String.h"
#include "Runtime/Utilities/ConsoleLog.h"

class NativeTestReporter;
class TestFilter;

namespace UnitTest
{
class TestList;
}

/// Runs the self-tests compiled into the program, in all categories, and reports them on the console. Returns
/// the number of failed tests.
///
/// The filter ignores ASCII case; TestFilter says which names it selects. An empty filter selects all. On the
/// command line that SetCommandLine was given, the switch "automated" chooses status lines for programs
/// instead of lines for people, and "dontReportPerformanceData" clears reportPerformanceData of their
/// reporter.
int RunNativeTests(const core::string& filter);

/// The same for the categories that begin with categoryFilter; an empty one selects all.
int RunNativeTests(const core::string& categoryFilter, const core::string& nameFilter);

/// The same for the tests that the filter selects. It collects the ignored tests.
///
/// Substitutes for tests without a category stay in the list of tests, and LogEntryHandlerForTests stays
/// installed.
int RunNativeTests(TestFilter& filter);

/// The same for a list of tests other than that of the process.
int RunNativeTests(TestFilter& filter, UnitTest::TestList& tests);

/// Keeps the output of test bodies off the console: refuses every message while the reporter of the current
/// run has a test in progress, and accepts all others, among them the reporter's own. A mutex serialises its
/// callers.
bool LogEntryHandlerForTests(LogType type, const char* format, std::va_list arguments);

/// Increments g_AssertCountBeforeTests and returns false whatever the text: no failed assertion is ever
/// expected on this platform.
bool IsNativeTestExpectingAssertionFailure(const char* text);

namespace Testing
{

extern bool g_IsRunningNativeTests;        ///< set when a run starts, and never cleared
extern NativeTestReporter* g_TestReporter; ///< that of the current run; null outside a run
extern int g_AssertCountBeforeTests;       ///< calls of IsNativeTestExpectingAssertionFailure

} // namespace Testing
