#pragma once

#include <map>
#include <string>

/// Returns all bytes of a file; a text that says so if it can't be opened, so that a comparison shows it.
std::string ReadWholeFile(const std::string& path);

/// Writes a file, and the folders above it that are missing.
void WriteWholeFile(const std::string& path, const std::string& bytes);

/// Returns the content of every regular file below a folder, by its path relative to the folder.
std::map<std::string, std::string> ReadTree(const std::string& folder);
