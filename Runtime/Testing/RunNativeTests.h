#pragma once

#include "Runtime/Core/Containers/String.h"

/// Runs the self-tests compiled into the program, in all categories. Returns the number of failed tests.
///
/// The filter, in which case doesn't count, selects by names: without a full stop it is sought in suite and
/// test names; otherwise its parts before and behind the first full stop are sought in one of them each. An
/// empty filter selects all. The switches "automated" and "dontReportPerformanceData" are looked for on the
/// command line that SetCommandLine was given.
int RunNativeTests(const core::string& filter);

/// The same for the categories that begin with categoryFilter; an empty one selects all.
int RunNativeTests(const core::string& categoryFilter, const core::string& nameFilter);
