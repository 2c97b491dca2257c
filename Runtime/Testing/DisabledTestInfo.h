#pragma once

#include "Runtime/Core/Containers/String.h"
#include "Runtime/Testing/TestDetails.h"

/// A selected test that was not run, and why.
struct DisabledTestInfo
{
    UnitTest::TestDetails details;
    int kind = 0; ///< 0: by the prefix of a name alone; otherwise 1 above the type of the deciding attribute
    core::string reason;
    int caseNumber = 0;
};
