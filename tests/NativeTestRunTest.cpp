#include "Runtime/Testing/NativeTestRun.h"

#include "Runtime/Testing/AutomationTestReporter.h"
#include "Runtime/Testing/Checks.h"
#include "Runtime/Testing/ConsoleTestReporter.h"
#include "Runtime/Testing/CurrentTest.h"
#include "Runtime/Testing/RunNativeTests.h"
#include "Runtime/Testing/TestResults.h"
#include "Runtime/Testing/TestRunner.h"
#include "Runtime/Testing/TestingGlobals.h"
#include "Runtime/Testing/TimerImplPosix.h"
#include "Runtime/Utilities/CommandLine.h"
#include "tests/support/CapturedConsole.h"
#include "tests/support/DescribedTests.h"
#include "tests/support/NeutralText.h"

#include <gtest/gtest.h>

#include <unistd.h>

using UnitTest::CheckAt;
using UnitTest::CheckEqual;
using UnitTest::CheckEqualAt;
using UnitTest::TestAttribute;

namespace
{

constexpr const char* kNoCategoryText =
    "DOES NOT HAVE AN ASSOCIATED SUITE, PLEASE USE A SPECIFIC SUITE e.g. UNIT_TEST_SUITE, "
    "INTEGRATION_TEST_SUITE, etc.";

/// Makes texts the arguments behind the program's name for as long as it lives.
class Arguments
{
public:
    explicit Arguments(std::vector<const char*> arguments) : m_commandLine(std::move(arguments))
    {
        m_commandLine.insert(m_commandLine.begin(), "-program");
        SetCommandLine(static_cast<int>(m_commandLine.size()), m_commandLine.data());
    }

    ~Arguments() { SetCommandLine(0, nullptr); }

    Arguments(const Arguments&) = delete;
    Arguments& operator=(const Arguments&) = delete;

private:
    std::vector<const char*> m_commandLine;
};

/// What a run returned and printed.
struct Outcome
{
    int failedTestCount;
    std::string text;
};

Outcome RunAndCapture(UnitTest::TestList& tests)
{
    const CapturedConsole console;
    TestFilter filter;
    const int failedTestCount = RunNativeTests(filter, tests);
    return {failedTestCount, WithoutNumbers(console.GetText())};
}

bool Holds()
{
    return true;
}

void PrintAndLog()
{
    EXPECT_NE(nullptr, Testing::g_TestReporter);
    printf_console("swallowed\n");
    DebugStringToFile({"swallowed too", LogType::Error, "file", 1});
}

void FailInManyPlaces()
{
    for (int round = 0; round < 3; ++round)
    {
        CheckAt(11, false, "in a loop");
    }
    CheckAt(12, true, "holds");
    CheckEqualAt(13, "this", "that");
    CheckEqualAt(14, "same", "same");
    UnitTest::TestResults& results = *UnitTest::CurrentTest::Results();
    const UnitTest::TestDetails& details = *UnitTest::CurrentTest::Details();
    CheckEqual(results, nullptr, "text", details);
    CheckEqual(results, "text", nullptr, details);
    CheckEqual(results, nullptr, nullptr, details);
    EXPECT_EQ(6, results.GetFailureCount());
    EXPECT_EQ(1, results.GetFailedTestCount());
}

const TestAttribute kBroken{0, 12, "broken", nullptr};
const TestAttribute kCondition{2, 0, "not here", Holds};

std::vector<TestDescription> MakeDescriptions()
{
    return {{"Own", "Passes", "Unit", PrintAndLog},
            {"Own", "Fails", "Performance", FailInManyPlaces},
            {"Own", "HasNoCategory", nullptr, [] { FAIL() << "only the substitute may run"; }},
            {"Own", "DISABLED_ByName"},
            {"Own", "DISABLED_X", nullptr}, // and so is its substitute
            {"Own", "Broken", "Unit", [] { FAIL(); }, {&kBroken}},
            {"Own", "BrokenToo", "Unit", [] { FAIL(); }, {&kBroken}},
            {"OwnOther", "Conditional", "", [] { FAIL(); }, {&kCondition}}};
}

} // namespace

TEST(NativeTestRun, ReportsFailedIgnoredAndUngroupedTests)
{
    DescribedTests tests(MakeDescriptions());
    const Outcome outcome = RunAndCapture(tests.list);
    EXPECT_EQ(3, outcome.failedTestCount);
    EXPECT_EQ(std::string("[Own]       Passes           PASS(Nms)\n"
                          "[Own]       Fails            FAIL!!!!\n"
                          "\tCHECK FAILURE: in a loop (file:11)\n"
                          "\tCHECK FAILURE: Expected this but actual was that (file:13)\n"
                          "\tCHECK FAILURE: Expected string was null but actual was text (file:7)\n"
                          "\tCHECK FAILURE: Expected text but was null (file:7)\n"
                          "[Own]       HasNoCategory    FAIL!!!!\n"
                          "\tCHECK FAILURE: ") +
                  kNoCategoryText + " (file:7)\n" + "[OwnOther]  Conditional      FAIL!!!!\n" +
                  "\tCHECK FAILURE: " + kNoCategoryText + " (file:7)\n" +
                  "Ran 4 tests with 3 failures in N seconds\n"
                  "\tFAILED: Fails [Own]\n"
                  "\tFAILED: HasNoCategory [Own]\n"
                  "\tFAILED: Conditional [OwnOther]\n"
                  "\n6 tests were IGNORED!\n"
                  "[Own] Broken and 1 other test was ignored: broken (case 12)\n"
                  "[OwnOther] Conditional: not here \n"
                  "[Own] DISABLED_X: No reason given\n"
                  "[Own] DISABLED_X: No reason given\n"
                  "[Own] DISABLED_ByName: No reason given\n",
              outcome.text);
    EXPECT_TRUE(Testing::g_IsRunningNativeTests);
    EXPECT_EQ(nullptr, Testing::g_TestReporter);
}

TEST(NativeTestRun, LeavesTheSubstitutesInTheList)
{
    DescribedTests tests({{"S", "T", nullptr}});
    EXPECT_EQ(1, RunAndCapture(tests.list).failedTestCount);
    EXPECT_EQ(2, RunAndCapture(tests.list).failedTestCount);
}

TEST(NativeTestRun, WritesStatusLinesForTheSwitchAutomated)
{
    const Arguments arguments({"", "--AutoMated"});
    DescribedTests tests({{"S", "T", "Unit", PrintAndLog}, {"S", "DISABLED_T"}});
    EXPECT_EQ(
        R"text(##qzm:{"type":"TestStatus","version":2,"phase":"Begin","time":N,"processId":N,"name":"S.T","state":0}
##qzm:{"type":"TestStatus","version":2,"phase":"End","time":N,"processId":N,"name":"S.T","state":4,"message":"","fileName":"file","lineNumber":7,"durationMicroseconds":N,"duration":N}
)text",
        RunAndCapture(tests.list).text);
}

TEST(NativeTestRun, WantsPerformanceDataUnlessASwitchOrTheCategoriesForbidIt)
{
    static bool isWanted;
    const auto note = []
    {
        isWanted =
            dynamic_cast<const AutomationTestReporter&>(*Testing::g_TestReporter).ReportsPerformanceData();
    };
    const struct
    {
        std::vector<const char*> arguments;
        std::vector<std::string> categoryPrefixes;
        bool expected;
    } cases[] = {
        {{"-automated"}, {}, true},
        {{"--DontReportPerformanceData", "filter", "-automated"}, {}, false},
        {{"dontReportPerformanceData", "-automated"}, {}, true},
        {{"-automated"}, {"un"}, false},
        {{"-automated"}, {"un", "perf"}, true},
        {{"-automated"}, {"performances"}, false},
    };
    for (const auto& c : cases)
    {
        const Arguments arguments(c.arguments);
        const CapturedConsole console;
        DescribedTests tests({{"S", "T", "Unit", note}, {"S", "T", "Performances", note}});
        TestFilter filter;
        filter.categoryPrefixes = c.categoryPrefixes;
        isWanted = !c.expected;
        RunNativeTests(filter, tests.list);
        EXPECT_EQ(c.expected, isWanted) << "case " << &c - cases;
    }
}

TEST(NativeTestRun, WidensItsColumnsUpToTheLongestSelectedNameButNotBeyond64)
{
    const std::string longest(70, 's');
    const DescribedTests tests(
        {{"Suite", "T"}, {longest.c_str(), "Te\nst"}, {"Suite", longest.c_str(), "Other"}});
    const struct
    {
        const char* categoryPrefix;
        const char* nameFilter;
        int longestSuiteNameLength;
        int longestTestNameLength;
    } cases[] = {{"", "", 64, 64}, {"unit", "", 64, 7}, {"", "suite", 5, 64}, {"", "nothing", 0, 0}};
    for (const auto& c : cases)
    {
        TestFilter filter;
        filter.categoryPrefixes = {c.categoryPrefix};
        filter.nameFilters = {c.nameFilter};
        GetLengthsOfLongestSuiteAndTestNamesState state{filter};
        tests.list.ForEach(state);
        EXPECT_EQ(c.longestSuiteNameLength, state.longestSuiteNameLength) << c.categoryPrefix << c.nameFilter;
        EXPECT_EQ(c.longestTestNameLength, state.longestTestNameLength) << c.categoryPrefix << c.nameFilter;
    }
}

TEST(NativeTestRun, RunsTheCompiledInTestsThatCategoryAndNameSelect)
{
    const std::string summary = " tests with 0 failures in N seconds\n";
    const struct
    {
        const char* categoryFilter;
        const char* nameFilter;
        std::string expected;
    } cases[] = {
        {"UN", ".appendJson",
         "[IndexCombiner]  AppendJsonDocument_OneValueJson_ProducesThatJson            PASS(Nms)\n"
         "[IndexCombiner]  AppendJsonDocument_TwoValidJsons_ProducesCombinedJson       PASS(Nms)\n"
         "[TocCombiner]    AppendJsonDocument_OneValueJson_ProducesThatJson            PASS(Nms)\n"
         "[TocCombiner]    AppendJsonDocument_TrivialAndSimpleJson_ProducesSimpleJson  PASS(Nms)\nRan 4" +
             summary},
        {"Perf", "", "Ran 0" + summary},
        {"", "no such test", "Ran 0" + summary},
    };
    for (const auto& c : cases)
    {
        const CapturedConsole console;
        EXPECT_EQ(0, RunNativeTests(c.categoryFilter, c.nameFilter));
        EXPECT_EQ(c.expected, WithoutNumbers(console.GetText())) << c.categoryFilter << "|" << c.nameFilter;
    }
}

TEST(TestRunner, RunsTheWantedTestsOfASuiteAndReturnsTheFailures)
{
    const auto failTwice = []
    {
        CheckAt(1, false, "wrong");
        CheckAt(1, false, "wrong");
    };
    const DescribedTests tests({{"Own", "Fails", "Unit", failTwice}, {"Own", ""}, {"OwnOther", "Passes"}});
    const auto hasName = [](const UnitTest::Test* test) { return *test->m_details.testName != '\0'; };
    const CapturedConsole console;
    ConsoleTestReporter reporter;
    EXPECT_EQ(2, UnitTest::TestRunner(reporter).RunTestsIf(tests.list, "Own", hasName));
    EXPECT_EQ("[Own]  Fails  FAIL!!!!\n\tCHECK FAILURE: wrong (file:1)\n"
              "Ran 1 tests with 1 failures in N seconds\n\tFAILED: Fails [Own]\n",
              WithoutNumbers(console.GetText()));
}

TEST(TestRunner, ReportsTimesInSeconds)
{
    const DescribedTests tests({{"S", "T", "Unit", [] { (void)::usleep(20'000); }}});
    const auto all = [](const UnitTest::Test*) { return true; };
    const CapturedConsole console;
    ConsoleTestReporter reporter;
    static float reported;
    reporter.intraTestHandler = [](const UnitTest::TestDetails&, float seconds) { reported = seconds; };
    UnitTest::TestRunner(reporter).RunTestsIf(tests.list, nullptr, all);
    EXPECT_LE(0.019F, reported);
    EXPECT_GT(15.0F, reported);
}

TEST(TestResults, CountWithoutAReporterToo)
{
    UnitTest::TestResults results(nullptr);
    const UnitTest::TestDetails details;
    for (int test = 0; test < 3; ++test)
    {
        results.OnTestStart(details);
        results.OnTestFailure(details, "wrong");
        results.OnTestFailure(details, "wrong again");
        results.OnTestFinish(details, 0);
    }
    results.OnTestStart(details);
    EXPECT_EQ(4, results.GetTotalTestCount());
    EXPECT_EQ(3, results.GetFailedTestCount());
    EXPECT_EQ(6, results.GetFailureCount());
}

TEST(TestingGlobals, CountQuestionsForExpectedAssertionsAndExpectNone)
{
    const int before = Testing::g_AssertCountBeforeTests;
    EXPECT_FALSE(IsNativeTestExpectingAssertionFailure("any text"));
    EXPECT_EQ(before + 1, Testing::g_AssertCountBeforeTests);
}

TEST(CommandLine, FindsASwitchAnywhereWithOneHyphenOrTwo)
{
    const Arguments arguments({"-first", "filter", "--SECOND", "third", "---fourth", "-fifth=1"});
    const struct
    {
        const char* name;
        bool expected;
    } cases[] = {{"first", true},  {"second", true}, {"Second", true},   {"third", false}, {"fourth", false},
                 {"fifth", false}, {"fir", false},   {"program", false}, {"-first", false}};
    for (const auto& c : cases)
    {
        EXPECT_EQ(c.expected, HasARGV(c.name)) << c.name;
    }
}

TEST(TimerImplPosix, SubtractsSecondsAndMicrosecondsEachOnItsOwn)
{
    using UnitTest::TimerImplPosix;
    EXPECT_EQ(0, TimerImplPosix::MillisecondsBetween({5, 1}, {5, 1000}));
    EXPECT_EQ(1, TimerImplPosix::MillisecondsBetween({4, 999'999}, {5, 0})); // a microsecond
    EXPECT_EQ(-1500, TimerImplPosix::MillisecondsBetween({5, 500'999}, {4, 0}));
}
