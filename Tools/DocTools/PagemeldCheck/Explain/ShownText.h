#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

// Texts of input files and names on disk come from strangers. They are shown so that they can neither change
// the terminal nor pass for something else.

/// Returns the position of the first byte that is not UTF-8, or npos. Surrogates and
/// overlong forms don't count as UTF-8.
std::size_t FindInvalidUtf8(std::string_view text);

/// Returns the position in a JSON text of an escape that makes the second half of a surrogate pair without
/// the first, or npos. The parser takes it, though not a first half alone, and makes bytes of it that are not
/// UTF-8.
std::size_t FindLoneHalf(std::string_view json);

/// Returns text with control characters, marks that reverse the direction of text and bytes that are not
/// UTF-8 as escapes: "\n", "\x1B", "\xE9", "\u202E". So are line and paragraph separators and byte order
/// marks.
std::string Visible(std::string_view text);

/// Returns text in double quotes, visible and with a backslash before quotes and backslashes. One of more
/// than maxBytes ends there, at a character, with "..." after it.
std::string Quoted(std::string_view text, std::size_t maxBytes);

/// Returns the path without the slashes at its end and all before its last name: "docs/charts/" is "charts".
std::string NameOfRoot(std::string_view root);

/// Returns a number and a noun: "1 page", "3 pages".
std::string Counted(std::size_t count, const std::string& noun);

/// Returns the items with commas between them: the first ten, and the number of the others.
std::string Listed(const std::vector<std::string>& items);
