#include "Runtime/Utilities/CommandLine.h"
#include "Runtime/Utilities/TextConversion.h"
#include "Runtime/Utilities/WallClock.h"

#include <gtest/gtest.h>

#include <chrono>

TEST(HasARGV, FindsASwitchAnywhereWithOneHyphenOrTwo)
{
    const char* const arguments[] = {"-program", "-first",    "filter",  "--SECOND",
                                     "third",    "---fourth", "-fifth=1"};
    SetCommandLine(7, arguments);
    for (const char* name : {"first", "second", "Second"})
    {
        EXPECT_TRUE(HasARGV(name)) << name;
    }
    for (const char* name : {"third", "fourth", "fifth", "fir", "program", "-first"})
    {
        EXPECT_FALSE(HasARGV(name)) << name;
    }
    SetCommandLine(0, nullptr);
}

TEST(ToLower, ChangesAsciiLettersOnly)
{
    EXPECT_EQ("@az[`az{\xC3\x84", ToLower("@AZ[`az{\xC3\x84"));
}

TEST(ConvertNonPrintableCharsToHex, KeepsPrintableAsciiAndWellFormedSequences)
{
    const struct
    {
        const char* text;
        const char* expected;
    } cases[] = {
        {"a \n~\x1F\x7F%\x01", "a %0A~%1F%7F%%01"},
        {"\x80\xBFz", "%80%BFz"},
        {"\xC2\x80\xDF\xBF", "\xC2\x80\xDF\xBF"},
        {"\xC0\x80\xC1\xBF", "%C0%80%C1%BF"},
        {"\xE0\xA0\x80\xED\x9F\xBF", "\xE0\xA0\x80\xED\x9F\xBF"},
        {"\xEE\x80\x80\xEF\xBF\xBD", "\xEE\x80\x80\xEF\xBF\xBD"},
        {"\xE0\x9F\xBF", "%E0%9F%BF"},
        {"\xED\xA0\x80\xED\xBF\xBF", "%ED%A0%80%ED%BF%BF"}, // surrogates
        {"\xEF\xBF\xBE\xEF\xBF\xBF", "%EF%BF%BE%EF%BF%BF"},
        {"\xF0\x90\x80\x80\xF7\xBF\xBF\xBF", "\xF0\x90\x80\x80\xF7\xBF\xBF\xBF"},
        {"\xF0\x8F\xBF\xBF", "%F0%8F%BF%BF"},
        {"\xF8\x88\x80\x80\x80", "\xF8\x88\x80\x80\x80"},
        {"\xF8\x87\xBF\xBF\xBF", "%F8%87%BF%BF%BF"},
        {"\xFC\x84\x80\x80\x80\x80", "\xFC\x84\x80\x80\x80\x80"},
        {"\xFC\x83\xBF\xBF\xBF\xBF\xFE\xFF", "%FC%83%BF%BF%BF%BF%FE%FF"},
        {"\xE2\x82", "%E2%82"},                          // ends too early
        {"\xE2\x82-\xC3\xC3\xA4", "%E2%82-%C3\xC3\xA4"}, // goes on with the next byte
    };
    for (const auto& c : cases)
    {
        EXPECT_EQ(c.expected, ConvertNonPrintableCharsToHex(c.text));
    }
}

TEST(GetCurrentTimeAsDateTime, CountsTenthsOfMicrosecondsSinceTheYear1)
{
    using std::chrono::microseconds;
    const std::int64_t time = GetCurrentTimeAsDateTime() - 621'355'968'000'000'000;
    const auto now = std::chrono::system_clock::now().time_since_epoch();
    EXPECT_LE(microseconds(time / 10), now);
    EXPECT_GT(microseconds(time / 10) + std::chrono::milliseconds(100), now);
}

TEST(TimerImplPosix, SubtractsSecondsAndMicrosecondsSeparately)
{
    using UnitTest::TimerImplPosix;
    EXPECT_EQ(0, TimerImplPosix::MillisecondsBetween({5, 1}, {5, 1000}));
    EXPECT_EQ(1, TimerImplPosix::MillisecondsBetween({4, 999'999}, {5, 0})); // a microsecond
    EXPECT_EQ(-1500, TimerImplPosix::MillisecondsBetween({5, 500'999}, {4, 0}));
}
