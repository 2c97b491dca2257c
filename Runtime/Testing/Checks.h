#pragma once

#include "Runtime/Core/Containers/String.h"
#include "Runtime/Testing/TestDetails.h"

// The checks that test bodies call. One that fails reports a failure; the test goes on.

namespace UnitTest
{

class TestResults;

/// Reports a failure that shows both texts, either of which may be null, unless they are equal.
void CheckEqual(TestResults& results, const char* expected, const char* actual, const TestDetails& details);

/// Reports the text as a failure of the running test, unless the condition holds. The line is reported as
/// it is given; it need not be that of the check in the source.
void CheckAt(int line, bool condition, const char* text);

/// The same as CheckEqual for the running test.
void CheckEqualAt(int line, const core::string& expected, const core::string& actual);

} // namespace UnitTest
