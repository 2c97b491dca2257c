#pragma once

#include "Tools/DocTools/VantorPagemeld/JsonCombiner.h"

#include <string>

/// Checks, for the running self-test, what a new combiner makes of two JSON texts that are tagged with their
/// module indices and appended in that order; expected is compact JSON. The texts are not verified first.
void VerifyCombineJsons(JsonCombiner& combiner, const std::string& first, int firstModuleIndex,
                        const std::string& second, int secondModuleIndex, const std::string& expected);
