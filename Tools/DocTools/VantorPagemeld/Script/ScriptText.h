#pragma once

#include "Tools/DocTools/VantorPagemeld/Output/RenderedText.h"

#include <string_view>

/// Appends text with a backslash before every double quote. That is the whole escape rule of the scripts'
/// titles: backslashes, control characters and bytes above 0x7F pass as they are, which is wanted.
void AppendEscapingQuotes(RenderedText& script, std::string_view text);

/// Appends the name of the variable that holds a module's path prefix: "p0", "p1" and so on.
void AppendPrefixVariable(RenderedText& script, int moduleIndex);
