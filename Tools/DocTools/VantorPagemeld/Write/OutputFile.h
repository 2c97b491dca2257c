#pragma once

#include "Tools/DocTools/VantorPagemeld/Write/SharedText.h"

#include <string>
#include <string_view>

/// What is special about one kind of output file.
struct OutputKind
{
    /// Reports that the file can't be opened; may end the process.
    void (*reportUnopened)(const char* path);

    /// Whether a file that was cut short, as on a full disk, stays and counts as written.
    bool keepsIncomplete;
};

/// Writes one output of a module to the file at path, created or truncated: head, which only this module has,
/// then the body, which all modules share.
///
/// Returns whether the file counts as written. One that does not is removed.
bool WriteOutput(const char* path, std::string_view head, SharedText& body, const OutputKind& kind);

/// Writes an output under a temporary name, path with ".tmp" after it, and renames it into place if it counts
/// as written. Otherwise what is at path stays as it is. A rename that fails is deliberately not reported.
void ReplaceOutput(const std::string& path, std::string_view head, SharedText& body, const OutputKind& kind);
