#pragma once

#include "Tools/DocTools/PagemeldCheck/Report/Report.h"

#include <cstddef>
#include <string>
#include <vector>

/// Which checks of a set run, and how much is shown.
struct SetChecks
{
    bool checksTargets;
    bool checksOutputs;
    std::size_t limit;     ///< findings shown per rule and file; 0 for all
    std::size_t quoteSize; ///< bytes of a text that a message shows
};

/// Checks one documentation set of all modules: every input, then what a run would make of them together, and
/// the outputs if asked for. set is a position in kSetNames.
void CheckSet(std::size_t set, const std::vector<std::string>& roots, const SetChecks& checks,
              Report& report);
