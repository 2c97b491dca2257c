#include "Runtime/Testing/RunNativeTests.h"

#include "Runtime/Testing/NativeTestRun.h"
#include "Runtime/Utilities/AsciiCase.h"

int RunNativeTests(const core::string& filter)
{
    const core::string categoryFilter;
    const core::string& nameFilter = filter;
    return RunNativeTests(categoryFilter, nameFilter);
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
    return RunNativeTests(filter, UnitTest::Test::GetTestList());
}
