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

TestResults*& CurrentTest::Results()
{
    static TestResults* results = nullptr;
    return results;
}

const TestDetails*& CurrentTest::Details()
{
    static const TestDetails* details = nullptr;
    return details;
}

void TestList::AddFactory(TestFactory* factory)
{
    (m_factoryTail == nullptr ? m_factoryHead : m_factoryTail->next) = factory;
    m_factoryTail = factory;
}

void TestList::AddProcedurallyGeneratedTest(Test* test)
{
    (m_tail == nullptr ? m_head : m_tail->m_nextTest) = test;
    m_tail = test;
}

} // namespace UnitTest
