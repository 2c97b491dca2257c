#pragma once

#include "Tools/DocTools/VantorPagemeld/Output/RenderedText.h"
#include "Tools/DocTools/VantorPagemeld/Output/RepeatedText.h"

#include <rapidjson/document.h>

#include <string>

/// Reading JSON text into documents, and writing values as JSON text: the only place that reads or writes
/// JSON files. Failures are reported on standard error; nothing throws but for want of memory.
namespace RapidJsonIoUtil
{

/// Reads the file at path whole and parses it into document, as ParseJson does. Text behind an embedded NUL
/// byte is not seen.
///
/// Returns true when the file was read and parsed. Otherwise one message says why: the document is then left
/// as it was if the file could not be read, and null with a parse error if the text is no JSON.
bool TryGetJsonDocFromFile(const char* path, rapidjson::Document& document);

/// Parses NUL-terminated JSON text into document, as ParseJson does. Returns whether it was accepted; silent.
bool TryGetJsonDocFromString(const char* json, rapidjson::Document& document);

/// Returns the value as compact JSON: no white space between tokens.
std::string OutputJsonValueToString(const rapidjson::Value& value);

/// Returns the value as pretty JSON: four blanks a level, "\n" line ends, none behind the last bracket.
RenderedText RenderPrettyJson(const rapidjson::Value& value);

/// Appends the value as compact JSON to text.
void AppendCompactJson(RenderedText& text, const rapidjson::Value& value);

/// Writes the value as pretty JSON to the file at path, created or truncated.
///
/// Returns false, after a warning, only when the file cannot be opened. A file that was opened counts as
/// written, even if the disk filled up underneath: this is wanted.
bool OutputJsonValueToFile(const rapidjson::Value& value, const char* path);

/// Writes a JSON text that is rendered already; otherwise as OutputJsonValueToFile.
bool OutputJsonTextToFile(RepeatedText& json, const char* path);

} // namespace RapidJsonIoUtil
