#pragma once

#include "Tools/DocTools/PagemeldCheck/SetModule.h"

/// Reports outputs of a set that is written: those that are missing, cut, made for other modules or places,
/// different from the first whole one, or older than an input. One finding for each output: the first in this
/// order that holds.
void CheckOutputs(const std::vector<SetModule>& modules, Report& report);

/// Whether any output of the set is there.
[[nodiscard]] bool HasOutputs(const std::vector<SetModule>& modules);

/// Reports temporary files that are left over.
void CheckLeftovers(const std::vector<SetModule>& modules, Report& report);
