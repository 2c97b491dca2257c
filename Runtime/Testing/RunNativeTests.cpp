#include "Runtime/Testing/RunNativeTests.h"

#include "Runtime/Testing/AutomationTestReporter.h"
#include "Runtime/Testing/ConsoleTestReporter.h"
#include "Runtime/Testing/TestFilter.h"
#include "Runtime/Testing/TestRunner.h"
#include "Runtime/Utilities/CommandLine.h"
#include "Runtime/Utilities/TextConversion.h"

#include <algorithm>
#include <memory>
#include <mutex>

bool Testing::g_IsRunningNativeTests = false;
NativeTestReporter* Testing::g_TestReporter = nullptr;
int Testing::g_AssertCountBeforeTests = 0;

namespace
{

int WidenColumn(int width, const core::string& name)
{
    constexpr std::size_t kWidestColumn = 64;
    return std::max(width, static_cast<int>(std::min(name.size(), kWidestColumn)));
}

/// Widens two columns for every test that the filter selects. A name counts for at most 64 bytes, so a longer
/// one extends beyond its column.
struct GetLengthsOfLongestSuiteAndTestNamesState
{
    void operator()(const UnitTest::Test* test)
    {
        if (filter.Filter(test))
        {
            longestSuiteNameLength = WidenColumn(longestSuiteNameLength, test->m_details.suiteName);
            longestTestNameLength = WidenColumn(longestTestNameLength, GetDisplayedTestName(test->m_details));
        }
    }

    const TestFilter& filter;
    int longestSuiteNameLength = 0;
    int longestTestNameLength = 0;
};

std::unique_ptr<NativeTestReporter> CreateReporter(const TestFilter& filter)
{
    if (!HasARGV("automated"))
    {
        return std::make_unique<ConsoleTestReporter>();
    }
    auto reporter = std::make_unique<AutomationTestReporter>();
    reporter->reportPerformanceData =
        !HasARGV("dontReportPerformanceData") && filter.SelectsCategory(Testing::kPerformanceTestCategory);
    return reporter;
}

/// Clears g_TestReporter when the run ends, even by an exception from a test.
struct KnownReporter
{
    ~KnownReporter() { Testing::g_TestReporter = nullptr; }
};

/// There is nothing to do between tests on this platform.
void PlatformSpecificIntraTestHandler(const UnitTest::TestDetails& /*details*/, float /*seconds*/) {}

} // namespace

int RunNativeTests(const core::string& filter)
{
    return RunNativeTests("", filter);
}

int RunNativeTests(const core::string& categoryFilter, const core::string& nameFilter)
{
    TestFilter filter;
    if (!nameFilter.empty())
    {
        filter.nameFilters.push_back(ToLower(nameFilter));
    }
    if (!categoryFilter.empty())
    {
        filter.categoryPrefixes.push_back(ToLower(categoryFilter));
    }
    return RunNativeTests(filter);
}

int RunNativeTests(TestFilter& filter)
{
    return RunNativeTests(filter, UnitTest::Test::GetTestList());
}

int RunNativeTests(TestFilter& filter, UnitTest::TestList& tests)
{
    Testing::g_IsRunningNativeTests = true;
    SetLogEntryHandler(LogEntryHandlerForTests);
    GetLengthsOfLongestSuiteAndTestNamesState longest{filter};
    tests.ForEach(longest);

    const std::unique_ptr<NativeTestReporter> reporter = CreateReporter(filter);
    const KnownReporter known;
    Testing::g_TestReporter = reporter.get();
    reporter->longestSuiteNameLength = longest.longestSuiteNameLength;
    reporter->longestTestNameLength = longest.longestTestNameLength;
    reporter->intraTestHandler = PlatformSpecificIntraTestHandler;

    const UnitTest::TestRunner runner(*reporter);
    AddNoCategoryTests(tests, filter);
    (void)runner.RunTestsIf(tests, nullptr, filter); // counts failures, of which a test can have several
    const auto failedTestCount = static_cast<int>(reporter->failedTests.size());
    reporter->ReportIgnoredTests(filter.ignoredTests);
    return failedTestCount;
}

bool LogEntryHandlerForTests(LogType /*type*/, const char* /*format*/, std::va_list /*arguments*/)
{
    static std::mutex mutex;
    const std::lock_guard<std::mutex> lock(mutex);
    const NativeTestReporter* const reporter = Testing::g_TestReporter;
    return reporter == nullptr || !reporter->testInProgress || !reporter->testStarted;
}

bool IsNativeTestExpectingAssertionFailure(const char* /*text*/)
{
    ++Testing::g_AssertCountBeforeTests;
    return false;
}
