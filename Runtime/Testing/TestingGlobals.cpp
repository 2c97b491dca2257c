#include "Runtime/Testing/TestingGlobals.h"

namespace Testing
{

bool g_IsRunningNativeTests = false;
NativeTestReporter* g_TestReporter = nullptr;
int g_AssertCountBeforeTests = 0;

} // namespace Testing

bool IsNativeTestExpectingAssertionFailure(const char* /*text*/)
{
    ++Testing::g_AssertCountBeforeTests;
    return false;
}
