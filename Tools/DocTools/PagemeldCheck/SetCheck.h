#pragma once

#include "Tools/DocTools/PagemeldCheck/Report/Report.h"

#include <string>
#include <vector>

/// Checks one documentation set of all modules: every input, then what a run would make of them together, and
/// the outputs if asked for.
void CheckSet(DocSet set, const std::vector<std::string>& roots, const CheckOptions& options, Report& report);
