#include "Runtime/Testing/AutomationTestReporter.h"
#include "Runtime/Testing/ConsoleTestReporter.h"
#include "Runtime/Testing/IgnoredTests.h"
#include "Runtime/Utilities/NonPrintableChars.h"
#include "tests/support/CapturedConsole.h"
#include "tests/support/NeutralText.h"

#include <gtest/gtest.h>

using UnitTest::TestDetails;
using UnitTest::TestProperty;

namespace
{

const TestDetails kPlain("Test", "Suite", "Unit", "file", 7);
const TestDetails kOdd("Li\nne", "LongerSuite", "Unit", "odd", 8);

/// Two tests that pass, one with failures, one with a negative time; then the end of the run.
void ReportInventedEvents(NativeTestReporter& reporter)
{
    reporter.ReportTestStart(kPlain);
    reporter.ReportTestProperty(kPlain, "a", TestProperty(1));
    reporter.ReportTestProperty(kPlain, "Z", TestProperty(-5'000'000'000LL));
    reporter.ReportTestProperty(kPlain, "b", TestProperty(1.5F));
    reporter.ReportTestProperty(kPlain, "c", TestProperty(0.25));
    reporter.ReportTestProperty(kPlain, "a", TestProperty("te\txt"));
    reporter.ReportTestFinish(kPlain, 0.015F); // 14.99... in double precision

    reporter.ReportTestStart(kPlain);
    reporter.ReportTestFinish(kPlain, 0.0009F);

    reporter.ReportTestStart(kOdd);
    reporter.ReportFailure(TestDetails(kOdd, 31), "100% \"wrong\"");
    reporter.ReportFailure(TestDetails(kOdd, 31), "100% \"wrong\"");
    reporter.ReportFailure(TestDetails(kOdd, 32), "100% \"wrong\"");
    reporter.ReportFailure(TestDetails(kOdd, 33), "");
    reporter.ReportTestFinish(kOdd, 2);

    reporter.ReportTestStart(kPlain);
    reporter.ReportTestFinish(kPlain, -0.5F);
    reporter.ReportSummary(4, 17, 18, 2.345F);
}

DisabledTestInfo Ignored(const char* testName, const char* reason, int caseNumber)
{
    return {TestDetails(testName, "S", "Unit", "file", 7), 1, reason, caseNumber};
}

} // namespace

TEST(ConsoleTestReporter, PrintsAlignedLinesAndASummary)
{
    const CapturedConsole console;
    ConsoleTestReporter reporter;
    reporter.longestSuiteNameLength = 8;
    reporter.longestTestNameLength = 7;
    ::testing::internal::CaptureStderr();
    ReportInventedEvents(reporter);
    EXPECT_EQ("Test Test reported negative time: -500.000000ms. Time output clamped to 0ms.\n",
              ::testing::internal::GetCapturedStderr());
    EXPECT_EQ("[Suite]     Test     PASS(15ms, Z: -5000000000, a: te\txt, b: 1.500000f, c: 0.250000)\n"
              "[Suite]     Test     PASS(0ms)\n"
              "[LongerSuite]  Li%0Ane  FAIL!!!!\n"
              "\tCHECK FAILURE: 100% \"wrong\" (odd:31)\n"
              "\tCHECK FAILURE: 100% \"wrong\" (odd:32)\n"
              "\tCHECK FAILURE: (odd:33)\n"
              "[Suite]     Test     PASS(0ms)\n"
              "Ran 4 tests with 1 failures in 2.35 seconds\n"
              "\tFAILED: Li%0Ane [LongerSuite]\n",
              console.GetText());
}

TEST(ConsoleTestReporter, SuppressesNamesAndStatusesTogether)
{
    const CapturedConsole console;
    ConsoleTestReporter reporter;
    reporter.suppressNameOutput = true;
    static int handledCount;
    handledCount = 0;
    reporter.intraTestHandler = [](const TestDetails&, float) { ++handledCount; };
    ReportInventedEvents(reporter);
    EXPECT_EQ(4, handledCount);
    EXPECT_EQ("Ran 4 tests with 1 failures in 2.35 seconds\n\tFAILED: Li%0Ane [LongerSuite]\n",
              console.GetText());
}

TEST(AutomationTestReporter, LogsStatusLinesWithTheFailuresBetween)
{
    const CapturedConsole console;
    AutomationTestReporter reporter(true);
    ReportInventedEvents(reporter);
    std::vector<DisabledTestInfo> ignored{Ignored("Test", "reason", 1)};
    reporter.ReportIgnoredTests(ignored);

    EXPECT_EQ(
        R"text(##qzm:{"type":"TestStatus","version":2,"phase":"Begin","time":N,"processId":N,"name":"Suite.Test","state":0}
##qzm:{"type":"TestStatus","version":2,"phase":"End","time":N,"processId":N,"name":"Suite.Test","state":4,"message":"","fileName":"file","lineNumber":7,"durationMicroseconds":15000,"duration":15}
##qzm:{"type":"TestStatus","version":2,"phase":"Begin","time":N,"processId":N,"name":"Suite.Test","state":0}
##qzm:{"type":"TestStatus","version":2,"phase":"End","time":N,"processId":N,"name":"Suite.Test","state":4,"message":"","fileName":"file","lineNumber":7,"durationMicroseconds":900,"duration":0}
##qzm:{"type":"TestStatus","version":2,"phase":"Begin","time":N,"processId":N,"name":"LongerSuite.Li%0Ane","state":0}
CHECK FAILURE: 100% "wrong"
	(odd:31)
CHECK FAILURE: 100% "wrong"
	(odd:32)
CHECK FAILURE: 
	(odd:33)
##qzm:{"type":"TestStatus","version":2,"phase":"End","time":N,"processId":N,"name":"LongerSuite.Li%0Ane","state":5,"message":"CHECK FAILURE: 100% \"wrong\"\n\t(odd:31)\nCHECK FAILURE: 100% \"wrong\"\n\t(odd:32)\nCHECK FAILURE: \n\t(odd:33)\n","fileName":"odd","lineNumber":8,"durationMicroseconds":2000000,"duration":2000}
##qzm:{"type":"TestStatus","version":2,"phase":"Begin","time":N,"processId":N,"name":"Suite.Test","state":0}
##qzm:{"type":"TestStatus","version":2,"phase":"End","time":N,"processId":N,"name":"Suite.Test","state":4,"message":"","fileName":"file","lineNumber":7,"durationMicroseconds":18446744073709051616,"duration":18446744073709051}
)text",
        WithoutNumbers(console.GetText(), {R"("time":)", R"("processId":)"}));
}

TEST(IgnoredTests, AreSortedAndGroupedByCaseAndReason)
{
    const struct
    {
        std::vector<DisabledTestInfo> ignored;
        const char* expected;
    } cases[] = {
        {{}, ""},
        {{Ignored("Only\n", "", 0)}, "\n1 test was IGNORED!\n[S] Only%0A: No reason given\n"},
        {{Ignored("One", "", 0), Ignored("Fifth", "", 0), Ignored("Four", "", 0)},
         "\n3 tests were IGNORED!\n[S] One: No reason given\n[S] Four: No reason given\n"
         "[S] Fifth: No reason given\n"},
        {{Ignored("Second", "slow", 12), Ignored("First", "slow", 12)},
         "\n2 tests were IGNORED!\n[S] First and 1 other test was ignored: slow (case 12)\n"},
        {{Ignored("A", "", 3), Ignored("A", "b", 0), Ignored("A", "", 3), Ignored("BB", "b", 0),
          Ignored("CCC", "b", 0), Ignored("A", "ba", 0), Ignored("A", "\xC3\xA4", 0), Ignored("A", "b", -1)},
         "\n8 tests were IGNORED!\n[S] A: (case 3)\n[S] A: (case 3)\n[S] A: \xC3\xA4 \n[S] A: ba \n"
         "[S] A and 2 other tests were ignored: b \n[S] A: b (case -1)\n"},
        // A control byte shows as three characters, and so counts as three.
        {{Ignored("\n\n", "b", 1), Ignored("12345", "b", 1)},
         "\n2 tests were IGNORED!\n[S] 12345 and 1 other test was ignored: b (case 1)\n"},
    };
    for (const auto& c : cases)
    {
        const CapturedConsole console;
        std::vector<DisabledTestInfo> ignored = c.ignored;
        ConsoleTestReporter().ReportIgnoredTests(ignored);
        EXPECT_EQ(c.expected, console.GetText());
    }
}

TEST(ConvertNonPrintableCharsToHex, KeepsPrintableAsciiAndWellFormedSequences)
{
    const struct
    {
        const char* text;
        const char* expected;
    } cases[] = {
        {"", ""},
        {" ~%", " ~%"},
        {"a\n\x1F\x7F-\x01", "a%0A%1F%7F-%01"},
        {"\x80\xBFz", "%80%BFz"},
        {"\xC2\x80\xDF\xBF", "\xC2\x80\xDF\xBF"},
        {"\xC0\x80\xC1\xBF", "%C0%80%C1%BF"},
        {"\xE0\xA0\x80\xEF\xBF\xBD", "\xE0\xA0\x80\xEF\xBF\xBD"},
        {"\xE0\x9F\xBF", "%E0%9F%BF"},
        {"\xED\x9F\xBF\xEE\x80\x80", "\xED\x9F\xBF\xEE\x80\x80"},
        {"\xED\xA0\x80\xED\xBF\xBF", "%ED%A0%80%ED%BF%BF"},
        {"\xEF\xBF\xBE\xEF\xBF\xBF", "%EF%BF%BE%EF%BF%BF"},
        {"\xF0\x90\x80\x80\xF7\xBF\xBF\xBF", "\xF0\x90\x80\x80\xF7\xBF\xBF\xBF"},
        {"\xF0\x8F\xBF\xBF", "%F0%8F%BF%BF"},
        {"\xF8\x88\x80\x80\x80", "\xF8\x88\x80\x80\x80"},
        {"\xF8\x87\xBF\xBF\xBF", "%F8%87%BF%BF%BF"},
        {"\xFC\x84\x80\x80\x80\x80", "\xFC\x84\x80\x80\x80\x80"},
        {"\xFC\x83\xBF\xBF\xBF\xBF", "%FC%83%BF%BF%BF%BF"},
        {"\xFE\xFF", "%FE%FF"},
        {"\xE2\x82", "%E2%82"},                          // ends too early
        {"\xE2\x82-\xC3\xC3\xA4", "%E2%82-%C3\xC3\xA4"}, // the walk goes on with the next byte
    };
    for (const auto& c : cases)
    {
        EXPECT_EQ(c.expected, ConvertNonPrintableCharsToHex(c.text));
    }
}
