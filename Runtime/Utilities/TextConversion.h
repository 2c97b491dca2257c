#pragma once

#include "Runtime/Core/Containers/String.h"

#include <string_view>

// Conversions of text, and comparisons that ignore case. Only the ASCII letters have a case here; all
// other bytes are kept.

/// Returns what printf would print.
core::string Format(const char* format, ...) __attribute__((format(printf, 1, 2)));

/// Returns the text with A to Z replaced by a to z.
core::string ToLower(std::string_view text);

bool EqualsIgnoringCase(std::string_view a, std::string_view b);
bool BeginsWithIgnoringCase(std::string_view text, std::string_view prefix);

/// Returns the text as it can be shown on one line: printable ASCII and well-formed UTF-8 stay, every other
/// byte becomes a percent sign and two upper-case hexadecimal digits. A percent sign itself stays as it is.
///
/// Well-formed are the shortest forms of 2 to 6 bytes, so characters beyond U+10FFFF count too; of the 3-byte
/// forms, surrogates, U+FFFE and U+FFFF are not.
core::string ConvertNonPrintableCharsToHex(const char* text);
