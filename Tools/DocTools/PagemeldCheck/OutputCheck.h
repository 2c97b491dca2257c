#pragma once

#include "Tools/DocTools/PagemeldCheck/Report/Report.h"
#include "Tools/DocTools/PagemeldCheck/SetModule.h"

#include <vector>

/// Reports outputs of a set that are missing, cut, older than an input or different from the first whole one.
void CheckOutputs(const std::vector<SetModule>& modules, Report& report);

/// Reports temporary files that are left over.
void CheckLeftovers(const std::vector<SetModule>& modules, Report& report);
