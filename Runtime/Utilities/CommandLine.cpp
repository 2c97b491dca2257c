#include "Runtime/Utilities/CommandLine.h"

#include "Runtime/Utilities/TextConversion.h"

#include <algorithm>

namespace
{

const char* const* firstArgument = nullptr;
const char* const* argumentsEnd = nullptr;

} // namespace

void SetCommandLine(int argc, const char* const* argv)
{
    firstArgument = argv + std::min(argc, 1); // after the name of the program
    argumentsEnd = argv + argc;
}

bool HasARGV(const char* name)
{
    const core::string oneHyphen = core::string("-") + name;
    const core::string twoHyphens = "-" + oneHyphen;
    return std::any_of(firstArgument, argumentsEnd,
                       [&](const char* argument) {
                           return EqualsIgnoringCase(argument, oneHyphen) ||
                                  EqualsIgnoringCase(argument, twoHyphens);
                       });
}
