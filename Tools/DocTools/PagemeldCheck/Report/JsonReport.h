#pragma once

#include "Tools/DocTools/PagemeldCheck/Report/Finding.h"

#include <string>
#include <vector>

// The form of a report that programs read, one object per line, in ASCII. No line ends in a line feed.

/// Returns a finding with what applies to it. roots are the modules as typed.
std::string JsonLine(const Finding& finding, const std::vector<std::string>& roots);

/// Returns {"summary": ...}.
std::string JsonSummary(const Summary& summary);
