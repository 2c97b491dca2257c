#pragma once

#include "Tools/DocTools/VantorPagemeld/Render/TextBuffer.h"

#include <cstdio>
#include <string>
#include <string_view>
#include <utility>

/// What is special about one kind of output file.
struct OutputKind
{
    /// Reports that the file can't be opened; may end the process.
    void (*reportUnopened)(const char* path);

    /// Whether a file that was cut short, as on a full disk, stays and counts as written.
    bool keepsIncomplete;
};

/// An output whose body is rendered once and written to a file of every module.
///
/// On file systems that can clone, files that hold nothing else share the blocks of an earlier one, which
/// takes neither time nor disk space. Each is still a file of its own: changing one leaves the others as they
/// are.
class SharedOutput
{
public:
    SharedOutput(const OutputKind& kind, TextBuffer body) : m_kind(kind), m_body(std::move(body)) {}

    /// Writes the file at path, created or truncated: head, which only this module has, then the body.
    ///
    /// Returns whether the file counts as written. One that does not is removed.
    bool Write(const char* path, std::string_view head);

    /// Writes the file under a temporary name, path with ".tmp" after it, and renames it into place if it
    /// counts as written. Otherwise what is at path stays as it is. A rename that fails is deliberately not
    /// reported.
    void Replace(const std::string& path, std::string_view head);

private:
    bool WriteTo(std::FILE* file, std::string_view head);
    bool CloneTo(std::FILE* file);

    OutputKind m_kind;
    TextBuffer m_body;
    std::string m_originalPath; ///< of a file that holds the body and nothing else; empty at first
    bool m_canClone = true;     ///< until an attempt shows that the file system can't
};

/// Writes all of text to the stream, block by block. Returns false if not all was written.
bool WriteText(std::FILE* stream, std::string_view text);
