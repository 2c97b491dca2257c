#include "Runtime/Testing/RunNativeTests.h"
#include "Runtime/Utilities/CommandLine.h"
#include "Tools/DocTools/VantorPagemeld/DocumentationSet.h"
#include "Tools/DocTools/VantorPagemeld/ModuleDiscovery.h"
#include "Tools/DocTools/VantorPagemeld/ModuleLayout.h"
#include "Tools/DocTools/VantorPagemeld/System/Diagnostics.h"
#include "Tools/DocTools/VantorPagemeld/System/Memory.h"
#include "Tools/DocTools/VantorPagemeld/Verification.h"

#include <algorithm>
#include <list>
#include <string>
#include <string_view>

namespace
{

constexpr Diagnostics kDiagnostics("./Tools/DocTools/VantorPagemeld/Main");

constexpr int kSuccess = 0;
constexpr int kFailure = 255;

void ReportUsage(int number, const char* program)
{
    kDiagnostics.Error(number, "Usage: %s <path1> <path2> ...\n or %s -autopaths <rootdir>\n", program,
                       program);
}

int RunVerification(const char* rootDocPath)
{
    ReportProgress("rootDocPath = %s\n", rootDocPath);
    if (!VerifyTocAndIndex(rootDocPath))
    {
        kDiagnostics.Error(200, "VerifyTocAndIndex failed\n");
        return kFailure;
    }
    ReportProgress("VerifyTocAndIndex succeeded\n");
    return kSuccess;
}

/// Combines both documentation sets. A set that can't be combined does not keep the other from being
/// combined, nor does it change the exit status.
int RunCombining(const std::list<std::string>& moduleRoots)
{
    for (const auto& set : kDocSets)
    {
        (void)CombineAllTocAndIndex(moduleRoots, set.name);
    }
    return kSuccess;
}

int RunDiscoveryAndCombining(std::string rootDirectory)
{
    std::replace(rootDirectory.begin(), rootDirectory.end(), '\\', '/');
    std::list<std::string> moduleRoots;
    GetPathsOfDocs(rootDirectory, moduleRoots);
    return RunCombining(moduleRoots);
}

} // namespace

/// Chooses the run mode by the first argument alone, and turns its outcome into the exit status.
int main(int argc, char* argv[])
{
    SecureStandardStreams();
    PrepareHeap();
    const char* const program = argc > 0 ? argv[0] : "";
    const std::string_view mode = argc > 1 ? argv[1] : "";
    const char* const argument = argc > 2 ? argv[2] : nullptr;

    if (mode == "-runNativeTests")
    {
        SetCommandLine(argc, argv); // the self-tests look for switches in all of it
        (void)RunNativeTests(argument == nullptr ? "" : argument);
        return kSuccess;
    }
    ReportProgress("executing Pagemeld\n");
    if (argc < 2)
    {
        ReportUsage(173, program);
        return kFailure;
    }
    if (mode == "-verify")
    {
        if (argument == nullptr)
        {
            kDiagnostics.Error(192, "Usage: %s -verify <rootDocPath>\n", program);
            return kFailure;
        }
        return RunVerification(argument);
    }
    if (mode == "-autopaths")
    {
        if (argument == nullptr)
        {
            // Unlike the same message above, this ends with success; it is intentional.
            ReportUsage(212, program);
            return kSuccess;
        }
        return RunDiscoveryAndCombining(argument);
    }
    return RunCombining(std::list<std::string>(argv + 1, argv + argc));
}
