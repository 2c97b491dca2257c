#pragma once

#include "Tools/DocTools/PagemeldCheck/Report/Report.h"

#include <string>
#include <vector>

/// Checks one documentation set of all modules: every input, then what a run would make of them together, and
/// the outputs if asked for. runEnds tells whether the run ended in a set before this one. Returns whether it
/// ends there or in this set.
[[nodiscard]] bool CheckSet(DocSet set, const std::vector<std::string>& roots, const CheckOptions& options,
                            bool runEnds, Report& report);
