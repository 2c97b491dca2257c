#pragma once

#include <rapidjson/document.h>

#include <cstdint>

/// How deep arrays and objects may be nested in a text. Recursion over an accepted document needs at most
/// this many levels, which fits the usual 8 MiB stack with room to spare.
constexpr std::uint32_t kMaxNestingDepth = 10'000;

/// Length in bytes of the longest string that a text may hold. The JSON library's writers reserve six bytes a
/// character and two quotes in a 32-bit number.
constexpr std::uint32_t kMaxStringBytes = (UINT32_MAX - 2) / 6;

/// Parses NUL-terminated JSON text into the document, by the library's default rules (strict JSON, one root
/// value).
///
/// Refused beyond those rules: a bracket that opens level kMaxNestingDepth + 1 (the offset is the one after
/// it), a number that overflows a double (at its first character), a string above kMaxStringBytes, and a run
/// of more than kMaxDigits digits (at the first of them).
///
/// Returns whether the text was accepted and otherwise the error with its byte offset: the library's own, or
/// kParseErrorTermination for one of the limits. After a failure the document is null, whatever it held
/// before, and carries the same error; for a limit only the offset is the same, and the code is unspecified.
/// Strings are copied, so the text may go away.
rapidjson::ParseResult ParseJson(const char* text, rapidjson::Document& document);
