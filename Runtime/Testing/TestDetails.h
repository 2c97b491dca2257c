#pragma once

#include "Runtime/Core/Containers/String.h"
#include "Runtime/Testing/TestAttribute.h"

#include <vector>

namespace UnitTest
{

using TestAttributes = std::vector<const TestAttribute*>;

/// What identifies a test. Copied by value; the texts are literals and belong to nobody.
struct TestDetails
{
    /// An empty record.
    TestDetails() = default;

    /// Mind the order: the test's name comes first here, the suite's among the fields.
    TestDetails(const char* test, const char* suite, const char* testCategory, const char* file, int line,
                const TestAttributes* testAttributes = nullptr);

    /// The same test at another line, that of a failing check.
    TestDetails(const TestDetails& details, int line);

    const char* suiteName = nullptr;
    const char* testName = nullptr;
    const char* filename = nullptr;
    const char* category = nullptr; ///< may be null or empty
    int lineNumber = -1;

    /// May be null. They belong to the test, so a copy that outlives it must not look at them.
    const TestAttributes* attributes = nullptr;
};

/// Whether the test has a category of its own.
bool HasCategory(const TestDetails& details);

/// Returns the first attribute of that type, or null.
const TestAttribute* FindAttribute(const TestDetails& details, int type);

/// Returns the test's name as it can be shown on one line.
core::string GetDisplayedTestName(const TestDetails& details);

/// Returns the suite's name, a full stop and the displayed test name.
core::string GetTestName(const TestDetails& details);

} // namespace UnitTest
