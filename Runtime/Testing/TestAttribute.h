#pragma once

namespace UnitTest
{

/// A mark that a test may carry. Other types than these don't keep a test from running; reporters look for
/// some of them.
struct TestAttribute
{
    static constexpr int kIgnoredForCase = 0; ///< the only one whose case number is reported
    static constexpr int kIgnored = 1;
    static constexpr int kIgnoredIf = 2; ///< if the predicate is set and holds

    int type;
    int caseNumber;
    const char* text;    ///< the reason; may be null
    bool (*predicate)(); ///< may be null
};

} // namespace UnitTest
