#pragma once

#include <rapidjson/document.h>

#include <cstdint>

/// Arrays and objects inside one another that a text may hold: recursion over an accepted document needs at
/// most this many levels, which fits the usual 8 MiB stack with room to spare.
constexpr std::uint32_t kMaxNestingDepth = 10'000;

/// Length in bytes of the longest string that a text may hold. The JSON library's writers reserve six bytes a
/// character and two quotes in a 32-bit number.
constexpr std::uint32_t kMaxStringBytes = (UINT32_MAX - 2) / 6;

/// Parses NUL-terminated JSON text into the document, by the library's default rules (strict JSON, one root
/// value).
///
/// Refused beyond those rules, each where it stands: a bracket that opens level kMaxNestingDepth + 1 (the
/// offset is the one behind it), a number that overflows a double (at its first character), a string above
/// kMaxStringBytes.
///
/// Returns whether the text was accepted and otherwise the error with its byte offset. The document is null
/// after a failure, whatever it held before, and reports a parse error at the same offset (its code is
/// unspecified: the returned one counts). Strings are copied, so the text may go away.
rapidjson::ParseResult ParseJson(const char* text, rapidjson::Document& document);
