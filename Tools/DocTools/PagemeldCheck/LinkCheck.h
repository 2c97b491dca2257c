#pragma once

#include "Tools/DocTools/PagemeldCheck/Report/Report.h"

#include <string>
#include <vector>

/// Reports roots whose links to others lead to the wrong place.
void CheckLinks(const std::vector<std::string>& roots, Report& report);
