#pragma once

#include <rapidjson/document.h>
#include <rapidjson/stringbuffer.h>

#include <string_view>

/// Text that is composed in memory.
///
/// It is the buffer of the JSON library's writers, so that JSON and script text go into one place without a
/// copy.
using TextBuffer = rapidjson::StringBuffer;

/// The bytes composed so far, valid until the next append.
[[nodiscard]] std::string_view TextOf(const TextBuffer& buffer);

/// Appends text at the end. Bytes are taken as they are, NUL included.
void AppendText(TextBuffer& buffer, std::string_view text);

/// Appends a title as the scripts hold it: in double quotes, with a backslash before every one inside. That
/// is the whole escape rule: backslashes, control characters and bytes above 0x7F pass as they are, on
/// purpose.
void AppendTitleLiteral(TextBuffer& buffer, const char* text);

/// Appends a page path or link as the scripts hold it: in double quotes, deliberately not escaped at all.
void AppendPathLiteral(TextBuffer& buffer, const char* text);

/// Appends the value as compact JSON: no white space between tokens.
void AppendCompactJson(TextBuffer& buffer, const rapidjson::Value& value);

/// Returns the value as pretty JSON: four spaces a level, "\n" line ends, none after the last bracket.
[[nodiscard]] TextBuffer RenderPrettyJson(const rapidjson::Value& value);
