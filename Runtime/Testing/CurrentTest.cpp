#include "Runtime/Testing/CurrentTest.h"

namespace UnitTest::CurrentTest
{

TestResults*& Results()
{
    static TestResults* results = nullptr;
    return results;
}

const TestDetails*& Details()
{
    static const TestDetails* details = nullptr;
    return details;
}

} // namespace UnitTest::CurrentTest
