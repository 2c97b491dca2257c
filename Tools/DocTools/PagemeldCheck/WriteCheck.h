#pragma once

#include "Tools/DocTools/PagemeldCheck/SetModule.h"

/// Reports what keeps a run from writing the outputs of a set.
///
/// runEnds tells whether the run ended in a set before this one: then nothing of this set is written. Returns
/// whether it ends there or in this set. Modules whose roots do not exist are not reported, but end the run.
[[nodiscard]] bool CheckWritable(const std::vector<SetModule>& modules, bool runEnds, Report& report);
