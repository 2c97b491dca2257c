#include "Runtime/Testing/RunNativeTests.h"

#include "Runtime/Testing/AutomationTestReporter.h"
#include "Runtime/Testing/Checks.h"
#include "Runtime/Testing/ConsoleTestReporter.h"
#include "Runtime/Testing/TestFilter.h"
#include "Runtime/Testing/TestRunner.h"
#include "Runtime/Utilities/CommandLine.h"
#include "tests/support/CapturedConsole.h"
#include "tests/support/DescribedTests.h"
#include "tests/support/Placeholders.h"

#include <gtest/gtest.h>

#include <stdexcept>
#include <utility>

#include <unistd.h>

using UnitTest::TestAttribute;

namespace
{

constexpr const char* kNoCategoryFailure =
    "\tCHECK FAILURE: DOES NOT HAVE AN ASSOCIATED SUITE, PLEASE USE A SPECIFIC SUITE e.g. UNIT_TEST_SUITE, "
    "INTEGRATION_TEST_SUITE, etc. (file:7)\n";

/// Returns what a run prints, and the number that it returns.
template <class... Arguments>
std::string RunWithPlaceholders(Arguments&&... arguments)
{
    const CapturedConsole console;
    const int failedTestCount = RunNativeTests(arguments...);
    return WithoutNumbers(console.GetText()) + "returned " + std::to_string(failedTestCount);
}

void PrintAndLog()
{
    EXPECT_NE(nullptr, Testing::g_TestReporter);
    EXPECT_FALSE(IsNativeTestExpectingAssertionFailure("any text"));
    EXPECT_EQ(1, std::exchange(Testing::g_AssertCountBeforeTests, 0));
    printf_console("swallowed\n");
    DebugStringToFile({"swallowed too", LogType::Error, "file", 1});
}

void FailInManyPlaces()
{
    for (int round = 0; round < 3; ++round)
    {
        UnitTest::CheckAt(11, false, "in a loop");
    }
    UnitTest::CheckAt(12, true, "holds");
    UnitTest::CheckEqualAt(13, "this", "that");
    UnitTest::CheckEqualAt(14, "same", "same");
    UnitTest::TestResults& results = *UnitTest::CurrentTest::Results();
    const UnitTest::TestDetails& details = *UnitTest::CurrentTest::Details();
    UnitTest::CheckEqual(results, nullptr, "text", details);
    UnitTest::CheckEqual(results, "text", nullptr, details);
    UnitTest::CheckEqual(results, nullptr, nullptr, details);
    EXPECT_EQ(6, results.failureCount);
}

} // namespace

TEST(RunNativeTests, ReportsFailedIgnoredAndUngroupedTests)
{
    const TestAttribute condition{2, 0, "not here", [] { return true; }};
    const auto fail = [] { FAIL() << "must not run"; };
    DescribedTests tests({{"Own", "Passes", "Unit", PrintAndLog},
                          {"Own", "Fails", "Performance", FailInManyPlaces},
                          {"Own", "HasNoCategory", nullptr, fail},
                          {"Own", "DISABLED_X", nullptr, fail}, // its substitute is ignored too
                          {"OwnOther", "Conditional", "", fail, {&condition}}});
    TestFilter filter;
    EXPECT_EQ(std::string("[Own]       Passes         PASS(Nms)\n"
                          "[Own]       Fails          FAIL!!!!\n"
                          "\tCHECK FAILURE: in a loop (file:11)\n"
                          "\tCHECK FAILURE: Expected this but actual was that (file:13)\n"
                          "\tCHECK FAILURE: Expected string was null but actual was text (file:7)\n"
                          "\tCHECK FAILURE: Expected text but was null (file:7)\n"
                          "[Own]       HasNoCategory  FAIL!!!!\n") +
                  kNoCategoryFailure + "[OwnOther]  Conditional    FAIL!!!!\n" + kNoCategoryFailure +
                  "Ran 4 tests with 3 failures in N seconds\n"
                  "\tFAILED: Fails [Own]\n"
                  "\tFAILED: HasNoCategory [Own]\n"
                  "\tFAILED: Conditional [OwnOther]\n"
                  "\n3 tests were IGNORED!\n"
                  "[OwnOther] Conditional: not here \n"
                  "[Own] DISABLED_X: No reason given\n"
                  "[Own] DISABLED_X: No reason given\n"
                  "returned 3",
              RunWithPlaceholders(filter, tests));
    EXPECT_TRUE(Testing::g_IsRunningNativeTests);
    EXPECT_EQ(nullptr, Testing::g_TestReporter);
}

TEST(RunNativeTests, ForgetsTheReporterWhenATestThrows)
{
    DescribedTests tests({{"S", "T", "Unit", [] { throw std::runtime_error("of a test"); }}});
    const CapturedConsole console;
    TestFilter filter;
    EXPECT_THROW((void)RunNativeTests(filter, tests), std::runtime_error);
    EXPECT_EQ(nullptr, Testing::g_TestReporter);
}

TEST(RunNativeTests, FindsTheSubstitutesOfAnEarlierRunInTheList)
{
    DescribedTests tests({{"S", "T", nullptr}});
    const CapturedConsole console;
    for (const int failedTestCount : {1, 2})
    {
        TestFilter filter;
        EXPECT_EQ(failedTestCount, RunNativeTests(filter, tests));
    }
}

TEST(RunNativeTests, WidensColumnsUpTo64)
{
    const std::string longName(70, 'n');
    DescribedTests tests({{"S", "Li\nne"}, {longName.c_str(), longName.c_str()}});
    TestFilter filter;
    EXPECT_EQ("[S]  " + std::string(63, ' ') + "Li%0Ane  " + std::string(57, ' ') + "PASS(Nms)\n[" +
                  longName + "]  " + longName +
                  "  PASS(Nms)\nRan 2 tests with 0 failures in N seconds\nreturned 0",
              RunWithPlaceholders(filter, tests));
}

TEST(RunNativeTests, RunsTheCompiledInTestsThatCategoryAndNameSelect)
{
    const std::string end = " tests with 0 failures in N seconds\nreturned 0";
    EXPECT_EQ("[IndexCombiner]  AppendJsonDocument_TwoValidJsons_ProducesCombinedJson  PASS(Nms)\nRan 1" +
                  end,
              RunWithPlaceholders("UN", "INDEX.two"));
    EXPECT_EQ("Ran 0" + end, RunWithPlaceholders("Perf", ""));
    TestFilter filter;
    filter.nameFilters = {".trivial"};
    EXPECT_EQ("[TocCombiner]  AppendJsonDocument_TrivialAndSimpleJson_ProducesSimpleJson  PASS(Nms)\nRan 1" +
                  end,
              RunWithPlaceholders(filter));
}

TEST(RunNativeTests, ReportsPerformanceDataUnlessASwitchOrTheCategoriesForbidIt)
{
    static bool reports;
    const auto note = [] {
        reports = dynamic_cast<const AutomationTestReporter&>(*Testing::g_TestReporter).reportPerformanceData;
    };
    const struct
    {
        const char* argument;
        std::vector<std::string> categoryPrefixes;
        bool expected;
    } cases[] = {{"dontReportPerformanceData", {}, true},
                 {"--DontReportPerformanceData", {}, false},
                 {"", {"un", "perf"}, true},
                 {"", {"performances"}, false}};
    for (const auto& c : cases)
    {
        const char* const arguments[] = {"program", c.argument, "--AutoMated"};
        SetCommandLine(3, arguments);
        DescribedTests tests({{"S", "T", "Performances", note}});
        TestFilter filter;
        filter.categoryPrefixes = c.categoryPrefixes;
        reports = !c.expected;
        (void)RunWithPlaceholders(filter, tests);
        EXPECT_EQ(c.expected, reports) << "case " << &c - cases;
    }
    SetCommandLine(0, nullptr);
}

TEST(TestList, VisitsFactoriesThenObjectsAndOwnsNeither)
{
    char product[] = "product";
    static DescribedTest fixed({"", "static"});
    DescribedTest local({"", "local"});
    UnitTest::TestFactory factory(
        [](void* name) -> UnitTest::Test* {
            return new DescribedTest({"", static_cast<char*>(name)});
        },
        product);
    std::string names;
    UnitTest::TestList tests;
    tests.AddProcedurallyGeneratedTest(&fixed);
    tests.AddProcedurallyGeneratedTest(&local);
    tests.AddFactory(&factory);
    tests.ForEach([&](const UnitTest::Test* test) { names += GetTestName(test->m_details); });
    EXPECT_EQ(".product.static.local", names);
}

TEST(TestRunner, RunsTheSelectedTestsOfASuiteAndReturnsTheFailures)
{
    const auto failTwice = []
    {
        UnitTest::CheckAt(1, false, "wrong");
        UnitTest::CheckAt(1, false, "wrong");
        (void)::usleep(20'000);
    };
    const DescribedTests tests({{"Own", "Fails", "Unit", failTwice}, {"Own", ""}, {"OwnOther", "Passes"}});
    const auto hasName = [](const UnitTest::Test* test) { return *test->m_details.testName != '\0'; };
    const CapturedConsole console;
    ConsoleTestReporter reporter;
    static float reportedSeconds;
    reporter.intraTestHandler = [](const UnitTest::TestDetails&, float seconds)
    { reportedSeconds = seconds; };
    EXPECT_EQ(2, UnitTest::TestRunner(reporter).RunTestsIf(tests, "Own", hasName));
    EXPECT_EQ("[Own]  Fails  FAIL!!!!\n\tCHECK FAILURE: wrong (file:1)\n"
              "Ran 1 tests with 1 failures in N seconds\n\tFAILED: Fails [Own]\n",
              WithoutNumbers(console.GetText()));
    EXPECT_LE(0.019F, reportedSeconds);
    EXPECT_GT(15.0F, reportedSeconds);
}

TEST(TestResults, CountEvenWithoutAReporter)
{
    UnitTest::TestResults results(nullptr);
    for (const int earlierTests : {0, 1})
    {
        results.OnTestStart({});
        EXPECT_FALSE(results.currentTestFailed);
        results.OnTestFailure({}, "wrong");
        results.OnTestFailure({}, "wrong again");
        results.OnTestFinish({}, 0);
        EXPECT_EQ(earlierTests + 1, results.totalTestCount);
        EXPECT_EQ(earlierTests + 1, results.failedTestCount);
        EXPECT_EQ(earlierTests * 2 + 2, results.failureCount);
    }
}
