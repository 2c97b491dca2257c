#pragma once

#include "Runtime/Testing/TestFilter.h"
#include "Runtime/Testing/TestList.h"

/// Runs the tests of a list that the filter selects, and reports them on the console: for people, or in
/// status lines if the command line has the switch "automated". Returns the number of tests that failed.
///
/// The filter is left with the ignored tests, the list with substitutes for tests without a category, and the
/// log handler for tests stays installed.
int RunNativeTests(TestFilter& filter, UnitTest::TestList& tests);

/// Updates two column widths, which start at 0, by every test that it is called with and the filter selects.
/// A name counts for at most 64, so a longer one runs over its column.
struct GetLengthsOfLongestSuiteAndTestNamesState
{
    void operator()(const UnitTest::Test* test);

    const TestFilter& filter;
    int longestSuiteNameLength = 0;
    int longestTestNameLength = 0;
};
