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
    void (*body)() = nullptr;
    UnitTest::TestAttributes attributes = {};
};

/// A list of self-tests that are registered as those of a program are, all in the file "file" at line 7.
class DescribedTests
{
public:
    explicit DescribedTests(std::vector<TestDescription> descriptions)
        : m_descriptions(std::move(descriptions))
    {
        for (TestDescription& description : m_descriptions)
        {
            UnitTest::ListAdder(list, &m_factories.emplace_back(CreateTest, &description));
        }
    }

private:
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

        void RunImpl() const override
        {
            if (m_body != nullptr)
            {
                m_body();
            }
        }

    private:
        void (*m_body)();
    };

    static UnitTest::Test* CreateTest(void* description)
    {
        return new DescribedTest(*static_cast<const TestDescription*>(description));
    }

    std::vector<TestDescription> m_descriptions;
    std::deque<UnitTest::TestFactory> m_factories;

public:
    UnitTest::TestList list;
};
