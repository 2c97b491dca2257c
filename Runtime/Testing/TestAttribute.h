#pragma once

namespace UnitTest
{

/// A mark that a test may carry. Only the types below have a meaning.
struct TestAttribute
{
    // The first three make a test ignored: always (with a case number), always, if the predicate holds.
    static constexpr int kIgnored = 0;
    static constexpr int kIgnoredAlways = 1;
    static constexpr int kIgnoredIf = 2;

    int type;
    int caseNumber;
    const char* text;    ///< the reason; may be null
    bool (*predicate)(); ///< may be null
};

} // namespace UnitTest
