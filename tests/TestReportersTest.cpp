#include "Runtime/Testing/AutomationTestReporter.h"
#include "Runtime/Testing/ConsoleTestReporter.h"
#include "tests/support/CapturedConsole.h"
#include "tests/support/CapturedStderr.h"
#include "tests/support/Placeholders.h"

#include <gtest/gtest.h>

#include <ctime>

#include <unistd.h>

using UnitTest::TestDetails;
using UnitTest::TestProperty;

namespace
{

const TestDetails kPlain("Test", "Suite", "Unit", "file", 7);
const TestDetails kOdd("Li\nne", "Longer\"Suite", "Unit", "odd", 8);

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

/// Returns a status line of this process with N for the time.
std::string StatusLine(const std::string& phase, const std::string& nameAndRest)
{
    return R"(##qzm:{"type":"TestStatus","version":2,"phase":")" + phase + R"(","time":N,"processId":)" +
           std::to_string(::getpid()) + R"(,"name":)" + nameAndRest + "}\n";
}

} // namespace

TEST(NativeTestReporter, KeepsTheStateOfTheRunningTest)
{
    const UnitTest::TestAttribute third{3, 0, nullptr, nullptr};
    const UnitTest::TestAttribute eighth{8, 0, nullptr, nullptr};
    const UnitTest::TestAttributes attributes{&third, &eighth};
    const TestDetails details("Test", "Suite", "Unit", "file", 7, &attributes);
    const CapturedConsole console;
    ConsoleTestReporter reporter;
    reporter.suppressNameOutput = true;
    EXPECT_FALSE(reporter.testStarted || reporter.testInProgress || reporter.currentTestFailed);

    reporter.ReportTestStart(details);
    EXPECT_TRUE(reporter.testStarted && reporter.testInProgress && !reporter.currentTestFailed);
    EXPECT_TRUE(reporter.hasAttributeOfType3 && reporter.hasAttributeOfType8);
    EXPECT_FALSE(reporter.hasAttributeOfType7);
    reporter.ReportTestProperty(details, "name", TestProperty(5LL));
    reporter.MarkCurrentTestAsFailure();
    reporter.ReportFailure(details, "wrong");
    EXPECT_STREQ("Test", reporter.currentTest.testName);
    EXPECT_EQ(1, reporter.properties.at("name").GetType());

    reporter.ReportTestFinish(details, 0);
    EXPECT_FALSE(reporter.testInProgress);
    EXPECT_EQ(nullptr, reporter.currentTest.testName);
    EXPECT_TRUE(reporter.properties.empty() && reporter.failures.empty());
    EXPECT_EQ(1U, reporter.failedTests.size());
    EXPECT_EQ("", console.GetText());
    reporter.ReportTestNameOnTestStart(details);
    reporter.ReportTestStatusOnFinish(details, 0);
    EXPECT_EQ("[Suite]  Test  FAIL!!!!\n", console.GetText());
}

TEST(MemoryOutStream, TakesAllSignedIntegers)
{
    UnitTest::MemoryOutStream stream;
    stream << -1 << " " << -5'000'000'000L << " " << -6'000'000'000LL;
    EXPECT_STREQ("-1 -5000000000 -6000000000", stream.GetText());
}

TEST(ConsoleTestReporter, PrintsAlignedLinesAndASummary)
{
    const CapturedConsole console;
    ConsoleTestReporter reporter;
    reporter.longestSuiteNameLength = 8;
    reporter.longestTestNameLength = 7;
    CapturedStderr standardError;
    ReportInventedEvents(reporter);
    EXPECT_EQ("Test Test reported negative time: -500.000000ms. Time output clamped to 0ms.\n",
              standardError.Text());
    EXPECT_EQ("[Suite]     Test     PASS(15ms, Z: -5000000000, a: te\txt, b: 1.500000f, c: 0.250000)\n"
              "[Suite]     Test     PASS(0ms)\n"
              "[Longer\"Suite]  Li%0Ane  FAIL!!!!\n"
              "\tCHECK FAILURE: 100% \"wrong\" (odd:31)\n"
              "\tCHECK FAILURE: 100% \"wrong\" (odd:32)\n"
              "\tCHECK FAILURE: (odd:33)\n"
              "[Suite]     Test     PASS(0ms)\n"
              "Ran 4 tests with 1 failures in 2.35 seconds\n"
              "\tFAILED: Li%0Ane [Longer\"Suite]\n",
              console.GetText());
}

TEST(AutomationTestReporter, LogsStatusLinesWithTheFailuresBetween)
{
    const CapturedConsole console;
    AutomationTestReporter reporter;
    ReportInventedEvents(reporter);
    std::vector<DisabledTestInfo> ignored{Ignored("Test", "reason", 1)};
    reporter.ReportIgnoredTests(ignored);

    const std::string text = console.GetText();
    const std::string plainStart = StatusLine("Begin", R"("Suite.Test","state":0)");
    const std::string plainEnd = R"("Suite.Test","state":4,"message":"","fileName":"file","lineNumber":7,)";
    EXPECT_EQ(
        plainStart + StatusLine("End", plainEnd + R"("durationMicroseconds":15000,"duration":15)") +
            plainStart + StatusLine("End", plainEnd + R"("durationMicroseconds":900,"duration":0)") +
            StatusLine("Begin", R"("Longer\"Suite.Li%0Ane","state":0)") +
            "CHECK FAILURE: 100% \"wrong\"\n\t(odd:31)\n"
            "CHECK FAILURE: 100% \"wrong\"\n\t(odd:32)\n"
            "CHECK FAILURE: \n\t(odd:33)\n" +
            StatusLine("End", R"("Longer\"Suite.Li%0Ane","state":5,"message":")"
                              R"(CHECK FAILURE: 100% \"wrong\"\n\t(odd:31)\n)"
                              R"(CHECK FAILURE: 100% \"wrong\"\n\t(odd:32)\n)"
                              R"(CHECK FAILURE: \n\t(odd:33)\n","fileName":"odd","lineNumber":8,)"
                              R"("durationMicroseconds":2000000,"duration":2000)") +
            plainStart +
            StatusLine("End",
                       plainEnd +
                           R"("durationMicroseconds":18446744073709051616,"duration":18446744073709051)"),
        WithoutNumbers(text, {R"("time":)"}));
    const long long time = std::stoll(text.substr(text.find(R"("time":)") + 7)) / 1000;
    EXPECT_GE(10, std::abs(std::time(nullptr) - time));
}

TEST(ConsoleTestReporter, SortsIgnoredTestsAndGroupsThemByCaseAndReason)
{
    const struct
    {
        std::vector<DisabledTestInfo> ignored;
        const char* expected;
    } cases[] = {
        {{}, ""},
        {{Ignored("Only\n", "", 0)}, "\n1 test was IGNORED!\n[S] Only%0A: No reason given\n"},
        {{Ignored("A", "", 3), Ignored("A", "b", 0), Ignored("A", "", 3), Ignored("BB", "b", 0),
          Ignored("CCC", "b", 0), Ignored("A", "ba", 0), Ignored("A", "\xC3\xA4", 0), Ignored("A", "b", -1)},
         "\n8 tests were IGNORED!\n[S] A: (case 3)\n[S] A: (case 3)\n[S] A: \xC3\xA4 \n[S] A: ba \n"
         "[S] A and 2 other tests were ignored: b \n[S] A: b (case -1)\n"},
        // A control byte shows as three characters, and so counts as three.
        {{Ignored("\n\n", "b", 1), Ignored("12345", "b", 1)},
         "\n2 tests were IGNORED!\n[S] 12345 and 1 other test was ignored: b (case 1)\n"},
    };
    static std::string formats;
    SetLogEntryHandler(
        [](LogType, const char* format, std::va_list)
        {
            formats += "|" + std::string(format);
            return true;
        });
    for (const auto& c : cases)
    {
        const CapturedConsole console;
        std::vector<DisabledTestInfo> ignored = c.ignored;
        formats.clear();
        ConsoleTestReporter().ReportIgnoredTests(ignored);
        EXPECT_EQ(c.expected, console.GetText());
    }
    SetLogEntryHandler(nullptr);
    EXPECT_EQ("|\n%zu %s IGNORED!\n|[%s] %s| and %d other %s ignored|: |%s |(case %i)|\n", formats);
}
