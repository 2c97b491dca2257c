#pragma once

#include "Tools/DocTools/PagemeldCheck/Report/Report.h"
#include "Tools/DocTools/PagemeldCheck/SetModule.h"

#include <vector>

/// Reports what would keep a run from writing the outputs of a set, in every module, and what the run would
/// do there.
void CheckWritable(const std::vector<SetModule>& modules, Report& report);
