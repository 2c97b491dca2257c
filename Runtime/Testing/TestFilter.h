#pragma once

#include "Runtime/Core/Containers/String.h"
#include "Runtime/Testing/DisabledTestInfo.h"
#include "Runtime/Testing/Test.h"

#include <vector>

/// Chooses the tests of a run, and notes those that are ignored.
class TestFilter
{
public:
    /// Returns whether the test is run. One that is selected but ignored is appended to ignoredTests; one
    /// without a category is never run itself, a NoCategoryTest stands in for it.
    bool operator()(const UnitTest::Test* test);

    /// Returns whether the category and the names select the test, which may still be ignored.
    bool Filter(const UnitTest::Test* test) const;

    /// Returns whether an attribute or the prefix "DISABLED_" of one of its names keeps the test from
    /// running.
    static bool IsIgnored(const UnitTest::Test* test);

    /// Lower-case beginnings of categories; none means every category. A test without one counts as "Unit".
    std::vector<core::string> categoryPrefixes;

    /// Lower-case filters, of which one must match; none means every name. Without a full stop a filter is
    /// sought in the suite's and in the test's name. Otherwise what stands before the first full stop is
    /// sought in the suite's name, and what stands behind it in the test's; an empty part matches.
    std::vector<core::string> nameFilters;

    /// Whether to select only tests with the prefix "RUN_" before one of their names.
    bool runOnlyPrefixedTests = false;

    std::vector<DisabledTestInfo> ignoredTests;
};
