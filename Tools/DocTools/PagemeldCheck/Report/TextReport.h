#pragma once

#include "Tools/DocTools/PagemeldCheck/Report/Finding.h"

#include <string>

// The form of a report that people and editors read. No line ends in a line feed.

/// Returns "file:line:column: level: message [rule] pointer". What the finding does not have is left out, and
/// a long pointer is cut.
std::string TextLine(const Finding& finding, bool isColored);

/// Returns "3 modules, 3 errors, 0 warnings", and the names of modules that are missing.
std::string TextSummary(const Summary& summary);
