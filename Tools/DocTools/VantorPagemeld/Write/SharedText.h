#pragma once

#include "Tools/DocTools/VantorPagemeld/Render/TextBuffer.h"
#include "Tools/DocTools/VantorPagemeld/System/ScopedFile.h"

#include <cstdio>
#include <string>
#include <string_view>

/// A text that is rendered once and written to a file of every module.
///
/// On file systems that can clone, files that hold nothing else share the blocks of an earlier one, which
/// takes neither time nor disk space. Each is still a file of its own: changing one leaves the others as they
/// are.
class SharedText
{
public:
    explicit SharedText(TextBuffer text);

    /// Writes head and then the text to a file that was opened empty for writing, and closes it.
    ///
    /// Returns whether every byte reached the file. The result of the close itself is not examined.
    bool WriteTo(ScopedFile file, std::string_view head);

    /// Lets later files be clones of the one at path, which holds the text and nothing else.
    void SetOriginal(const std::string& path) { m_originalPath = path; }

private:
    [[nodiscard]] bool CloneTo(std::FILE* file) const;

    TextBuffer m_text;
    std::string m_originalPath; // empty at first; no file is kept open: one is closed before it is renamed
};

/// Writes all of text to the stream, block by block. Returns false if not all was written.
bool WriteText(std::FILE* stream, std::string_view text);
