#pragma once

#include "Runtime/Testing/Test.h"

#include <memory>

namespace UnitTest
{

/// A registered test: how to create it.
struct TestFactory
{
    using Creator = Test* (*)(void* argument);

    constexpr explicit TestFactory(Creator testCreator, void* creatorArgument = nullptr)
        : create(testCreator), argument(creatorArgument)
    {
    }

    Creator create; ///< returns a new test
    void* argument; ///< what create is given
    TestFactory* next = nullptr;
};

/// The tests that a run chooses from: registered factories, and test objects made in another way.
///
/// Both kinds are linked through themselves, so that building the list before main neither allocates nor
/// fails. A factory or test may stand in one list, once.
class TestList
{
public:
    constexpr TestList() = default;

    /// Destroys the test objects. Factories don't belong to the list.
    ~TestList();

    TestList(const TestList&) = delete;
    TestList& operator=(const TestList&) = delete;

    /// Appends a factory, which must outlive the list.
    void AddFactory(TestFactory* factory);

    /// Appends a test made with new, and takes it over.
    void AddProcedurallyGeneratedTest(Test* test);

    /// Calls visit with every test: first the product of each factory, which lives for that call only, then
    /// the test objects.
    template <class Visitor>
    void ForEach(Visitor&& visit) const;

private:
    Test* m_head = nullptr;
    Test* m_tail = nullptr;
    TestFactory* m_factoryHead = nullptr;
    TestFactory* m_factoryTail = nullptr;
};

/// Registers a test: a static object of this type appends a factory to a list.
struct ListAdder
{
    ListAdder(TestList& tests, TestFactory* factory) { tests.AddFactory(factory); }
};

template <class Visitor>
void TestList::ForEach(Visitor&& visit) const
{
    for (const TestFactory* factory = m_factoryHead; factory != nullptr; factory = factory->next)
    {
        const std::unique_ptr<const Test> test(factory->create(factory->argument));
        visit(test.get());
    }
    for (const Test* test = m_head; test != nullptr; test = test->m_nextTest)
    {
        visit(test);
    }
}

} // namespace UnitTest
