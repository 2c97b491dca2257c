#pragma once

#include "Tools/DocTools/PagemeldCheck/Report/Report.h"

#include <string>
#include <vector>

/// Returns the module roots that pagemeld -autopaths takes below a directory. Reports if there are none, and
/// what looks like a module but is not taken.
[[nodiscard]] std::vector<std::string> DiscoverRoots(const std::string& directory, Report& report);
