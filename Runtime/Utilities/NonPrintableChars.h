#pragma once

#include "Runtime/Core/Containers/String.h"

/// Returns the text as it can be shown on one line: printable ASCII and well-formed UTF-8 stay, every other
/// byte becomes a percent sign and two upper-case hexadecimal digits. A percent sign itself stays as it is.
///
/// Well-formed are the shortest forms of 2 to 6 bytes, so characters beyond U+10FFFF count too; of those of 3
/// bytes neither surrogates nor U+FFFE and U+FFFF.
core::string ConvertNonPrintableCharsToHex(const char* text);
