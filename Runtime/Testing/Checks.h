#pragma once

#include "Runtime/Core/Containers/String.h"
#include "Runtime/Testing/TestDetails.h"

// The checks that test bodies call. One that fails reports a failure; the test goes on.

namespace UnitTest
{

class TestResults;

/// Reports the text as a failure at these details, unless the condition holds.
void Check(TestResults& results, bool condition, const char* text, const TestDetails& details);

/// Reports a failure that shows both texts, either of which may be null, unless they are equal.
void CheckEqual(TestResults& results, const char* expected, const char* actual, const TestDetails& details);

/// The same for the running test. The line is the one that the check declares, which need not be its line in
/// the source.
void CheckAt(int line, bool condition, const char* text);
void CheckEqualAt(int line, const core::string& expected, const core::string& actual);

} // namespace UnitTest
