#pragma once

#include "Runtime/Testing/TestList.h"

#include <vector>

/// Chooses the tests of a run, and records those that are ignored.
class TestFilter
{
public:
    /// Returns whether to run the test. One that is selected but ignored is appended to ignoredTests. One
    /// without a category is never run itself; a NoCategoryTest runs in its place.
    bool operator()(const UnitTest::Test* test);

    /// Returns whether the category and the names select the test, which may still be ignored.
    bool Filter(const UnitTest::Test* test) const;

    [[nodiscard]] bool SelectsCategory(const char* category) const;

    /// Returns whether an attribute or the prefix "DISABLED_" of one of its names keeps the test from
    /// running.
    static bool IsIgnored(const UnitTest::Test* test);

    /// Lower-case prefixes of categories; none selects every category. A test without one counts as "Unit".
    std::vector<core::string> categoryPrefixes;

    /// Lower-case filters, of which one must match; none selects every name. Without a full stop, a filter
    /// matches if the suite's or the test's name contains it. Otherwise the suite's name must contain what
    /// precedes the first full stop, and the test's name what follows it; an empty part matches.
    std::vector<core::string> nameFilters;

    /// Whether to select only tests whose own or suite's name begins with "RUN_".
    bool runOnlyPrefixedTests = false;

    std::vector<DisabledTestInfo> ignoredTests;
};

/// Replaces a test that was registered without a category: fails under its name, with a message that says so.
class NoCategoryTest : public UnitTest::Test
{
public:
    /// Takes name, suite, file and line of the test that it replaces; its own category is "Unit".
    explicit NoCategoryTest(const UnitTest::TestDetails& details);

    void RunImpl() const override;
};

/// Appends a NoCategoryTest to the list for every test in it that the filter selects and that has no
/// category.
///
/// They stay in the list, so a later run over it finds them there again, and exist until the process ends.
void AddNoCategoryTests(UnitTest::TestList& tests, const TestFilter& filter);
