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

/// Writes how two texts differ. At most one of them is null.
void WriteDifference(MemoryOutStream& stream, const char* expected, const char* actual)
{
    if (expected == nullptr)
    {
        stream << "Expected string was null but actual was " << actual;
    }
    else if (actual == nullptr)
    {
        stream << "Expected " << expected << " but was null";
    }
    else
    {
        stream << "Expected " << expected << " but actual was " << actual;
    }
}

} // namespace

void Check(TestResults& results, bool condition, const char* text, const TestDetails& details)
{
    if (!condition)
    {
        results.OnTestFailure(details, text);
    }
}

void CheckEqual(TestResults& results, const char* expected, const char* actual, const TestDetails& details)
{
    if (!AreEqual(expected, actual))
    {
        MemoryOutStream stream(256);
        WriteDifference(stream, expected, actual);
        results.OnTestFailure(details, stream.GetText());
    }
}

void CheckAt(int line, bool condition, const char* text)
{
    Check(*CurrentTest::Results(), condition, text, TestDetails(*CurrentTest::Details(), line));
}

void CheckEqualAt(int line, const core::string& expected, const core::string& actual)
{
    CheckEqual(*CurrentTest::Results(), expected.c_str(), actual.c_str(),
               TestDetails(*CurrentTest::Details(), line));
}

} // namespace UnitTest
