#pragma once

#include <rapidjson/error/error.h>

#include <cstddef>
#include <string>
#include <string_view>

/// Returns why a text was refused, and what usually causes it where that can be told: a byte order mark, a
/// comma before a bracket, a comment and the like. text is what was read up to its first NUL; size is the
/// number of bytes of the whole file.
std::string DescribeParseFailure(std::string_view text, std::size_t size,
                                 const rapidjson::ParseResult& failure);
