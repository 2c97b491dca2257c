#pragma once

class NativeTestReporter;

namespace Testing
{

extern bool g_IsRunningNativeTests;        ///< set when a run starts, and never cleared
extern NativeTestReporter* g_TestReporter; ///< that of the current run; null outside a run
extern int g_AssertCountBeforeTests;       ///< calls of IsNativeTestExpectingAssertionFailure

} // namespace Testing

/// Counts in g_AssertCountBeforeTests and returns false whatever the text: no failed assertion is ever
/// expected on this platform.
bool IsNativeTestExpectingAssertionFailure(const char* text);
