#include "Runtime/Testing/Checks.h"

#include "Runtime/Testing/TestReporter.h"
#include "Runtime/Testing/TestRunner.h"

#include <cstring>

namespace UnitTest
{

namespace
{

bool AreEqual(const char* a, const char* b)
{
    return a == b || (a != nullptr && b != nullptr && std::strcmp(a, b) == 0);
}

} // namespace

void CheckEqual(TestResults& results, const char* expected, const char* actual, const TestDetails& details)
{
    if (!AreEqual(expected, actual))
    {
        MemoryOutStream stream(256);
        stream << (expected == nullptr ? "Expected string was null" : core::string("Expected ") + expected)
               << (actual == nullptr ? " but was null" : core::string(" but actual was ") + actual);
        results.OnTestFailure(details, stream.GetText());
    }
}

void CheckAt(int line, bool condition, const char* text)
{
    if (!condition)
    {
        CurrentTest::Results()->OnTestFailure(TestDetails(*CurrentTest::Details(), line), text);
    }
}

void CheckEqualAt(int line, const core::string& expected, const core::string& actual)
{
    CheckEqual(*CurrentTest::Results(), expected.c_str(), actual.c_str(),
               TestDetails(*CurrentTest::Details(), line));
}

} // namespace UnitTest
