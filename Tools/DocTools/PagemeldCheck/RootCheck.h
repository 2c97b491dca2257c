#pragma once

#include "Tools/DocTools/PagemeldCheck/Report/Report.h"

#include <string>
#include <vector>

/// Appends the modules that "pagemeld -autopaths DIRECTORY" would take to roots, and reports what it passes
/// over, or that there are none.
void DiscoverRoots(const std::string& directory, std::vector<std::string>& roots, Report& report);

/// Reports if none of the roots is a module, and roots that are the same directory.
void CheckRoots(const std::vector<std::string>& roots, Report& report);
