#pragma once

#include <optional>
#include <string>

/// Cuts the negative exponents of a JSON text to nine digits. The JSON library adds longer ones to the number
/// of decimals in 32 bits, which overflows; the numbers are zero either way.
///
/// A run of more than 1,000,000,000 digits, which would overflow the library's count of decimals, ends the
/// text: the parse fails there.
///
/// Returns the changed text, with all offsets as they were and its strings untouched, or nothing when text
/// can be parsed as it stands.
std::optional<std::string> LimitNumbers(const char* text);
