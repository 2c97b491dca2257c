#pragma once

#include "Runtime/Testing/TestDetails.h"

namespace UnitTest
{

class TestList;

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
    Test* m_nextTest = nullptr;  ///< for the list that owns this test

protected:
    /// For the constructors of derived classes. The attribute must outlive the test.
    void AddAttribute(const TestAttribute& attribute) { m_attributes.push_back(&attribute); }

private:
    TestAttributes m_attributes;
};

} // namespace UnitTest
