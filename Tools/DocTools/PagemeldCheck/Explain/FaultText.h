#pragma once

#include "Tools/DocTools/VantorPagemeld/Check/StructureFault.h"

#include <cstddef>
#include <string>

/// Returns a value for people: strings quoted, numbers as they are, "an array of 3", "an object of 2".
std::string DescribeValue(const rapidjson::Value& value, std::size_t quoteSize);

/// Returns what is wrong, with the values in question: "page number 99, but there are 3 pages, numbered from
/// 0". document is
/// the whole that the fault was found in.
std::string DescribeFault(const FoundFault& found, const rapidjson::Value& document, std::size_t quoteSize);
