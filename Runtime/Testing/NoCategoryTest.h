#pragma once

#include "Runtime/Testing/TestFilter.h"
#include "Runtime/Testing/TestList.h"

/// Stands in for a test that was registered without a category, and fails in its name to say so.
class NoCategoryTest : public UnitTest::Test
{
public:
    /// Takes name, suite, file and line of the test that it stands in for; its own category is "Unit".
    explicit NoCategoryTest(const UnitTest::TestDetails& details);

    void RunImpl() const override;
};

/// Appends a NoCategoryTest to the list for every test in it that the filter selects and that has no
/// category. They stay in the list, so another run over it would find them there again.
void AddNoCategoryTests(UnitTest::TestList& tests, const TestFilter& filter);
