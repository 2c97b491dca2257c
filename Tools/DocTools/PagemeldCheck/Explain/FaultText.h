#pragma once

#include "Tools/DocTools/VantorPagemeld/Check/StructureFault.h"

#include <cstddef>
#include <string>

/// Returns a value for people: strings quoted, numbers as they are, "an array of 3", "an object of 2".
std::string DescribeValue(const rapidjson::Value& value, std::size_t quoteSize);

/// Returns what is wrong, with the values in question: "page number 99, but there are 3 pages". value is the
/// faulty one, or the object that lacks a member; document is the whole it is in.
std::string DescribeIndexFault(const StructureFault& fault, const JsonPointer& pointer,
                               const rapidjson::Value& value, const rapidjson::Value& document,
                               std::size_t quoteSize);

/// The same for a table of contents.
std::string DescribeTocFault(const StructureFault& fault, const JsonPointer& pointer,
                             const rapidjson::Value& value, std::size_t quoteSize);
