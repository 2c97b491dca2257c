#pragma once

#include <rapidjson/document.h>

#include <cstddef>
#include <vector>

/// Where something begins in a text.
struct ValuePlace
{
    std::size_t offset = 0; ///< in bytes
    std::size_t line = 1;   ///< lines end at a line feed
    std::size_t column = 1; ///< in bytes, from 1
};

/// Returns the place of the first byte of each value, in the order of values, which may name a value twice.
///
/// text is NUL-terminated and document what ParseJson made of it, unchanged since; each value is the document
/// or somewhere in it. Takes one pass over the document and one over the text, both up to the last of the
/// values, and memory for the values asked for, the open brackets and the longest string.
[[nodiscard]] std::vector<ValuePlace> LocateValues(const char* text, const rapidjson::Value& document,
                                                   const std::vector<const rapidjson::Value*>& values);

/// Returns the place of a byte of the text. Reads all bytes before it, NUL included.
[[nodiscard]] ValuePlace PlaceOfOffset(const char* text, std::size_t offset);
