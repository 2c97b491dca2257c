#pragma once

#include "Tools/DocTools/PagemeldCheck/Report/Report.h"
#include "Tools/DocTools/PagemeldCheck/SetModule.h"

#include <vector>

/// Reports and marks the modules whose tables of contents are sound, but dropped: their roots differ from the
/// first one.
void CheckContentRoots(std::vector<SetModule>& modules, Report& report);
