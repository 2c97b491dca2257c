#include "Runtime/Testing/TestDetails.h"

#include "Runtime/Utilities/TextConversion.h"

#include <algorithm>

namespace UnitTest
{

TestDetails::TestDetails(const char* test, const char* suite, const char* testCategory, const char* file,
                         int line, const TestAttributes* testAttributes)
    : suiteName(suite),
      testName(test),
      filename(file),
      category(testCategory),
      lineNumber(line),
      attributes(testAttributes)
{
}

bool HasCategory(const TestDetails& details)
{
    return details.category != nullptr && *details.category != '\0';
}

const TestAttribute* FindAttribute(const TestDetails& details, int type)
{
    if (details.attributes == nullptr)
    {
        return nullptr;
    }
    const auto found =
        std::find_if(details.attributes->begin(), details.attributes->end(),
                     [type](const TestAttribute* attribute) { return attribute->type == type; });
    return found == details.attributes->end() ? nullptr : *found;
}

core::string GetDisplayedTestName(const TestDetails& details)
{
    return ConvertNonPrintableCharsToHex(details.testName);
}

core::string GetTestName(const TestDetails& details)
{
    return core::string(details.suiteName) + "." + GetDisplayedTestName(details);
}

} // namespace UnitTest
