#include "Runtime/Testing/NativeTestRun.h"

#include "Runtime/Testing/AutomationTestReporter.h"
#include "Runtime/Testing/ConsoleTestReporter.h"
#include "Runtime/Testing/LogEntryHandlerForTests.h"
#include "Runtime/Testing/NoCategoryTest.h"
#include "Runtime/Testing/TestCategories.h"
#include "Runtime/Testing/TestRunner.h"
#include "Runtime/Testing/TestingGlobals.h"
#include "Runtime/Utilities/AsciiCase.h"
#include "Runtime/Utilities/CommandLine.h"

#include <algorithm>
#include <memory>

namespace
{

int Widen(int width, const core::string& name)
{
    constexpr std::size_t kWidestColumn = 64;
    return std::max(width, static_cast<int>(std::min(name.size(), kWidestColumn)));
}

bool IsPerformanceDataWanted(const TestFilter& filter)
{
    const std::vector<core::string>& prefixes = filter.categoryPrefixes;
    return !HasARGV("dontReportPerformanceData") &&
           (prefixes.empty() ||
            std::any_of(prefixes.begin(), prefixes.end(),
                        [](const core::string& prefix)
                        { return BeginsWithIgnoringCase(Testing::kPerformanceTestCategory, prefix); }));
}

std::unique_ptr<NativeTestReporter> CreateReporter(const TestFilter& filter)
{
    if (HasARGV("automated"))
    {
        return std::make_unique<AutomationTestReporter>(IsPerformanceDataWanted(filter));
    }
    return std::make_unique<ConsoleTestReporter>();
}

/// Nothing is to be done between tests on this platform.
void PlatformSpecificIntraTestHandler(const UnitTest::TestDetails& /*details*/, float /*seconds*/) {}

} // namespace

int RunNativeTests(TestFilter& filter, UnitTest::TestList& tests)
{
    Testing::g_IsRunningNativeTests = true;
    SetLogEntryHandler(LogEntryHandlerForTests);
    GetLengthsOfLongestSuiteAndTestNamesState longest{filter};
    tests.ForEach(longest);

    const std::unique_ptr<NativeTestReporter> reporter = CreateReporter(filter);
    Testing::g_TestReporter = reporter.get();
    reporter->longestSuiteNameLength = longest.longestSuiteNameLength;
    reporter->longestTestNameLength = longest.longestTestNameLength;
    reporter->intraTestHandler = PlatformSpecificIntraTestHandler;

    const UnitTest::TestRunner runner(*reporter);
    AddNoCategoryTests(tests, filter);
    (void)runner.RunTestsIf(tests, nullptr, filter); // counts failures, of which a test can have several
    const auto failedTestCount = static_cast<int>(reporter->GetFailedTests().size());
    reporter->ReportIgnoredTests(filter.ignoredTests);
    Testing::g_TestReporter = nullptr;
    return failedTestCount;
}

void GetLengthsOfLongestSuiteAndTestNamesState::operator()(const UnitTest::Test* test)
{
    if (filter.Filter(test))
    {
        longestSuiteNameLength = Widen(longestSuiteNameLength, test->m_details.suiteName);
        longestTestNameLength = Widen(longestTestNameLength, GetDisplayedTestName(test->m_details));
    }
}
