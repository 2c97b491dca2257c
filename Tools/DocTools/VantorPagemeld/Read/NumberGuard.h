#pragma once

#include <cstddef>
#include <optional>
#include <string>

/// The most digits in a row that a JSON text may hold.
constexpr std::size_t kMaxDigits = 1'000'000'000;

/// Keeps from the JSON library the numbers that would overflow its 32-bit counts.
///
/// Cuts negative exponents of more than nine digits to nine: the numbers are zero either way. A run of more
/// than maxDigits digits ends the text, so that the parse fails there; what follows it is not seen.
///
/// Returns the changed text, with all offsets as they were and its strings untouched, or nothing when text
/// can be parsed as it is.
std::optional<std::string> GuardNumbers(const char* text, std::size_t maxDigits = kMaxDigits);
