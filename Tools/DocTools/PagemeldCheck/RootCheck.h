#pragma once

#include "Tools/DocTools/PagemeldCheck/Report/Report.h"

#include <string>
#include <vector>

/// Appends the modules that "pagemeld -autopaths DIRECTORY" would take to roots, and reports what it passes
/// over, or that there are none.
void DiscoverRoots(const std::string& directory, std::vector<std::string>& roots, Report& report);

/// Reports if none of the roots is a module, roots that are the same directory, and roots whose links to
/// others lead to the wrong place.
void CheckRoots(const std::vector<std::string>& roots, Report& report);
