#pragma once

#include "Runtime/Testing/TestList.h"

#include <deque>
#include <vector>

/// A self-test in a table.
struct TestDescription
{
    const char* suiteName;
    const char* testName;
    const char* category = "Unit";
    void (*body)() = [] {};
    UnitTest::TestAttributes attributes = {};
};

/// A self-test that is declared in the file "file" at line 7.
class DescribedTest : public UnitTest::Test
{
public:
    explicit DescribedTest(const TestDescription& description)
        : Test({description.testName, description.suiteName, description.category, "file", 7}),
          m_body(description.body)
    {
        for (const UnitTest::TestAttribute* attribute : description.attributes)
        {
            AddAttribute(*attribute);
        }
    }

    void RunImpl() const override { m_body(); }

private:
    void (*m_body)();
};

/// A list of such tests, which it owns.
class DescribedTests : public UnitTest::TestList
{
public:
    explicit DescribedTests(const std::vector<TestDescription>& descriptions)
    {
        for (const TestDescription& description : descriptions)
        {
            AddProcedurallyGeneratedTest(&m_tests.emplace_back(description));
        }
    }

private:
    std::deque<DescribedTest> m_tests;
};
