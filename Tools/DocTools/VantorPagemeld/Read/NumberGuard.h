#pragma once

#include <cstddef>
#include <optional>
#include <string>

/// The most digits in a row that a JSON text may hold.
constexpr std::size_t kMaxDigits = 1'000'000'000;

/// Protects the JSON library from numbers that would overflow its 32-bit counts.
///
/// Cuts negative exponents of more than nine digits to nine: the numbers are too small for a double either
/// way. A run of more than maxDigits digits, and all text after it, is replaced by a character that is not
/// allowed in JSON, so that the parse fails where the run starts.
///
/// Returns the changed text, with all offsets as they were and its strings untouched, or nothing when text
/// can be parsed as it is.
std::optional<std::string> GuardNumbers(const char* text, std::size_t maxDigits = kMaxDigits);
