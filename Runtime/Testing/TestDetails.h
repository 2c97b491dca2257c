#pragma once

#include "Runtime/Core/Containers/String.h"

#include <vector>

// What is known of a test without running it.

namespace Testing
{

constexpr const char* kUnitTestCategory = "Unit";
constexpr const char* kPerformanceTestCategory = "Performance";

} // namespace Testing

namespace UnitTest
{

/// A mark that a test may carry. Only the three types named here keep a test from running.
struct TestAttribute
{
    static constexpr int kIgnoredForCase = 0; ///< the only type whose case number is reported
    static constexpr int kIgnored = 1;
    static constexpr int kIgnoredIf = 2; ///< ignored if the predicate is set and holds

    int type;
    int caseNumber;
    const char* text;    ///< the reason; may be null
    bool (*predicate)(); ///< may be null
};

using TestAttributes = std::vector<const TestAttribute*>;

/// What identifies a test. Copied by value; the texts are string literals, so nobody owns them.
struct TestDetails
{
    /// An empty record.
    TestDetails() = default;

    /// The test's name comes before the suite's here, but after it among the members. Both orders are
    /// intentional.
    TestDetails(const char* test, const char* suite, const char* testCategory, const char* file, int line,
                const TestAttributes* testAttributes = nullptr);

    /// The same test at another line: that of a failing check.
    TestDetails(const TestDetails& details, int line) : TestDetails(details) { lineNumber = line; }

    const char* suiteName = nullptr;
    const char* testName = nullptr;
    const char* filename = nullptr;
    const char* category = nullptr; ///< may be null or empty
    int lineNumber = -1;

    /// May be null. The test owns them, so they must not be read from a copy that outlives the test.
    const TestAttributes* attributes = nullptr;
};

/// Returns whether the test has a category of its own.
bool HasCategory(const TestDetails& details);

/// Returns the first attribute of that type, or null.
const TestAttribute* FindAttribute(const TestDetails& details, int type);

/// Returns the test's name as it can be shown on one line.
core::string GetDisplayedTestName(const TestDetails& details);

/// Returns the suite's name, a full stop and the displayed test name.
core::string GetTestName(const TestDetails& details);

} // namespace UnitTest

/// A selected test that was not run, and why.
struct DisabledTestInfo
{
    UnitTest::TestDetails details;
    int kind = 0; ///< 0: by the prefix of a name alone; otherwise the type of the deciding attribute plus 1
    core::string reason;
    int caseNumber = 0;
};
