#include "Runtime/Testing/NoCategoryTest.h"

#include "Runtime/Testing/CurrentTest.h"
#include "Runtime/Testing/TestCategories.h"
#include "Runtime/Testing/TestResults.h"

#include <memory>
#include <vector>

using UnitTest::TestDetails;

namespace
{

/// Collects the substitutes first, since the list must not grow while it is looked through.
struct NoCategoryTestCollector
{
    void operator()(const UnitTest::Test* test)
    {
        if (filter.Filter(test) && !HasCategory(test->m_details))
        {
            collected.push_back(std::make_unique<NoCategoryTest>(test->m_details));
        }
    }

    const TestFilter& filter;
    std::vector<std::unique_ptr<NoCategoryTest>> collected;
};

} // namespace

NoCategoryTest::NoCategoryTest(const TestDetails& details)
    : Test(TestDetails(details.testName, details.suiteName, Testing::kUnitTestCategory, details.filename,
                       details.lineNumber))
{
}

void NoCategoryTest::RunImpl() const
{
    UnitTest::CurrentTest::Results()->OnTestFailure(
        m_details, "DOES NOT HAVE AN ASSOCIATED SUITE, PLEASE USE A SPECIFIC SUITE e.g. UNIT_TEST_SUITE, "
                   "INTEGRATION_TEST_SUITE, etc.");
}

void AddNoCategoryTests(UnitTest::TestList& tests, const TestFilter& filter)
{
    NoCategoryTestCollector collector{filter, {}};
    tests.ForEach(collector);
    for (std::unique_ptr<NoCategoryTest>& test : collector.collected)
    {
        tests.AddProcedurallyGeneratedTest(test.release());
    }
}
