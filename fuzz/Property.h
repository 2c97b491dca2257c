#pragma once

#include <rapidjson/document.h>

#include <cstddef>
#include <cstdint>
#include <string>
#include <vector>

// What the fuzz targets have in common: inputs made of several texts, and checks that end the process.

/// Ends the process, so that the fuzzer keeps the input, unless the property holds.
void Require(bool holds, const char* property);

/// Whether two values are the same down to the order of members and the type of numbers. The library's own
/// comparison finds an object that has a name twice different from itself.
bool IsSameValue(const rapidjson::Value& a, const rapidjson::Value& b);

/// Requires that the reader accepts a text that was written for the value, and that the text has the value.
///
/// By default the library's reader can be off by a few units in the last place of a double. So the value of
/// the text is read with its exact mode.
void RequireReadsBack(const rapidjson::Value& value, const char* written);

/// Returns the texts that a fuzzer's input holds, each up to a NUL byte. There is always one.
std::vector<std::string> SplitInput(const std::uint8_t* data, std::size_t size);
