#pragma once

#include <rapidjson/document.h>

#include <string_view>

// Strict checks of the scripts' form, and that they say what a combined document holds.
//
// Page paths and the links of tagged nodes stand in the scripts unescaped, and of titles only the quotes are
// escaped. No parser could tell where such a text ends, so these know from the document which texts to see.

/// Whether script is the search-index script of a combined document, without prefix variables.
bool IsIndexScript(std::string_view script, const rapidjson::Value& index);

/// Whether script is the table-of-contents script of a combined document, without prefix variables.
bool IsTocScript(std::string_view script, const rapidjson::Value& toc);
