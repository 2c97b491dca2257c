#pragma once

#include "Tools/DocTools/VantorPagemeld/Write/SharedOutput.h"

#include <rapidjson/document.h>

#include <string>

/// Reading JSON text into documents, and writing values as JSON text. Failures are reported on standard
/// error; nothing throws unless memory runs out.
namespace RapidJsonIoUtil
{

/// Reads the file at path whole and parses it into document, as ParseJson does. Text after an embedded NUL
/// byte is not seen.
///
/// Returns true when the file was read and parsed. Otherwise one message says why: the document is then left
/// as it was if the file could not be read, and null with a parse error if the text is not JSON.
bool TryGetJsonDocFromFile(const char* path, rapidjson::Document& document);

/// Parses NUL-terminated JSON text into document, as ParseJson does. Returns whether it was accepted. Prints
/// nothing.
bool TryGetJsonDocFromString(const char* json, rapidjson::Document& document);

/// Returns the value as compact JSON, up to the first NUL.
std::string OutputJsonValueToString(const rapidjson::Value& value);

/// Writes the value as pretty JSON to the file at path, created or truncated.
///
/// Returns false, after a warning, only when the file can't be opened. A file that was opened counts as
/// written, even if the disk filled up meanwhile: this is intentional.
bool OutputJsonValueToFile(const rapidjson::Value& value, const char* path);

/// Returns what OutputJsonValueToFile writes, for many files.
SharedOutput JsonOutput(const rapidjson::Value& value);

} // namespace RapidJsonIoUtil
