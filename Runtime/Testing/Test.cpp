#include "Runtime/Testing/Test.h"

#include "Runtime/Testing/CurrentTest.h"
#include "Runtime/Testing/TestList.h"

namespace UnitTest
{

Test::Test(const TestDetails& details)
    : m_details(details.testName, details.suiteName, details.category, details.filename, details.lineNumber,
                &m_attributes)
{
}

void Test::Run() const
{
    CurrentTest::Details() = &m_details;
    RunImpl();
}

TestList& Test::GetTestList()
{
    static TestList tests;
    return tests;
}

} // namespace UnitTest
