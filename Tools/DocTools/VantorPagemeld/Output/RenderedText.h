#pragma once

#include <rapidjson/stringbuffer.h>

#include <cstdio>
#include <string_view>

/// A text that is composed once in memory and then written to many files.
///
/// It is the buffer of the JSON library's writers, so that JSON and script text go into one place without a
/// copy.
using RenderedText = rapidjson::StringBuffer;

/// Appends text at the end. Bytes are taken as they are, NUL included.
void AppendText(RenderedText& destination, std::string_view text);

/// The bytes composed so far, valid until the next append.
[[nodiscard]] std::string_view TextOf(const RenderedText& text);

/// Writes all of text to the stream, block by block. Returns false when the stream took less.
bool WriteText(std::FILE* stream, std::string_view text);
