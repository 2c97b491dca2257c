#pragma once

#include "Tools/DocTools/PagemeldCheck/Report/Report.h"
#include "Tools/DocTools/PagemeldCheck/SetModule.h"

#include <vector>

/// Reports what would keep a run from writing the outputs of a set, in every module, and what the run would
/// do there.
void CheckWritable(std::size_t set, const std::vector<SetModule>& modules, Report& report);

/// Reports outputs of a set that are missing, cut, older than an input or different from the first whole one.
void CheckOutputs(std::size_t set, const std::vector<SetModule>& modules, Report& report);

/// Reports temporary files that are left over.
void CheckLeftovers(std::size_t set, const std::vector<SetModule>& modules, Report& report);
