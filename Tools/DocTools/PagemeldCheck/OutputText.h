#pragma once

#include "Tools/DocTools/VantorPagemeld/ModuleLayout.h"

#include <cstddef>
#include <string_view>

// What shows, without merging anything, that the text of an output is whole.

/// Returns where the body begins, which all modules' copies of the output share, or npos if it is not there.
std::size_t FindBody(const OutputRow& output, std::string_view text);

/// Whether a body, which has a NUL after it, is all of one.
bool IsWholeBody(const OutputRow& output, std::string_view body);
