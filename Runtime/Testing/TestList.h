#pragma once

#include "Runtime/Testing/TestDetails.h"

#include <memory>

namespace UnitTest
{

class TestList;
class TestResults;

/// One test. A derived class gives its details and its body.
class Test
{
public:
    explicit Test(const TestDetails& details);
    virtual ~Test() = default;

    Test(const Test&) = delete;
    Test& operator=(const Test&) = delete;

    /// Runs the body with CurrentTest::Details() referring to this test.
    void Run() const;

    /// The body, which does nothing here.
    virtual void RunImpl() const {}

    /// Returns the one list of the process.
    static TestList& GetTestList();

    const TestDetails m_details; ///< its attributes are this test's own
    Test* m_nextTest = nullptr;  ///< in the list that this test was added to

protected:
    /// For the constructors of derived classes. The attribute must outlive the test.
    void AddAttribute(const TestAttribute& attribute) { m_attributes.push_back(&attribute); }

private:
    TestAttributes m_attributes;
};

/// Lets a test body, which has no arguments, reach the results and the details of its test. Both pointers are
/// valid only while a body runs.
namespace CurrentTest
{

TestResults*& Results();
const TestDetails*& Details();

} // namespace CurrentTest

/// A registered test: how to create it.
struct TestFactory
{
    using Creator = Test* (*)(void* argument);

    constexpr explicit TestFactory(Creator testCreator, void* creatorArgument = nullptr)
        : create(testCreator), argument(creatorArgument)
    {
    }

    Creator create; ///< returns a new test, which the caller deletes
    void* argument; ///< passed to create
    TestFactory* next = nullptr;
};

/// The tests that a run chooses from: registered factories, and test objects made in another way. Owns
/// neither.
///
/// Both kinds hold the link to their successor themselves, so that building the list before main neither
/// allocates nor fails. So a factory or test can be in one list only, and only once.
class TestList
{
public:
    constexpr TestList() = default;

    TestList(const TestList&) = delete;
    TestList& operator=(const TestList&) = delete;

    /// Appends a factory, which must live as long as the list is used.
    void AddFactory(TestFactory* factory);

    /// Appends a test object, which must live as long as the list is used.
    void AddProcedurallyGeneratedTest(Test* test);

    /// Calls visit with every test: first the product of each factory, which lives for that call only, then
    /// the test objects.
    template <class Visitor>
    void ForEach(Visitor&& visit) const
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

} // namespace UnitTest
