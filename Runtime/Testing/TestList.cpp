#include "Runtime/Testing/TestList.h"

namespace UnitTest
{

TestList::~TestList()
{
    while (m_head != nullptr)
    {
        const std::unique_ptr<const Test> test(m_head);
        m_head = test->m_nextTest;
    }
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
