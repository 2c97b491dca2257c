#pragma once

#include <optional>
#include <string>

/// Cuts the negative exponents of a JSON text to nine digits. The JSON library adds longer ones to the number
/// of decimals in 32 bits, which overflows; the numbers are zero either way.
///
/// Returns the changed text, with all offsets as they were and its strings untouched, or nothing when text
/// can be parsed as it stands.
std::optional<std::string> LimitExponents(const char* text);
