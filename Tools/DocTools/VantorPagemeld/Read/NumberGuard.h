#pragma once

#include <cstddef>
#include <optional>
#include <string>

/// The most digits in a row that a JSON text may hold.
constexpr std::size_t kMaxDigits = 1'000'000'000;

/// Keeps from the JSON library the numbers that would overflow its 32-bit counts.
///
/// Cuts negative exponents of more than nine digits to nine: the numbers are too small for a double either
/// way. A run of more than maxDigits digits ends the text there, with a character in its place that no JSON
/// allows, so that the parse fails at its start; what follows is not seen.
///
/// Returns the changed text, with all offsets as they were and its strings untouched, or nothing when text
/// can be parsed as it is.
std::optional<std::string> GuardNumbers(const char* text, std::size_t maxDigits = kMaxDigits);
