#pragma once

#include "Tools/DocTools/VantorPagemeld/Render/TextBuffer.h"
#include "Tools/DocTools/VantorPagemeld/System/ScopedFile.h"

#include <cstdio>
#include <string_view>

/// A text that is rendered once and written to a file of every module.
///
/// On file systems that can clone, files that hold nothing else share the blocks of the first one, which
/// takes neither time nor disk space. Each is still a file of its own: changing one leaves the others as they
/// are.
class SharedText
{
public:
    explicit SharedText(TextBuffer text);

    /// Writes head and then the text to a file that was opened empty for reading and writing. Closes it, or
    /// keeps it open, flushed, as the original of later clones.
    ///
    /// Returns whether every byte reached the file. The result of the close itself is not examined.
    bool WriteTo(ScopedFile file, std::string_view head);

private:
    [[nodiscard]] bool CloneTo(std::FILE* file) const;

    TextBuffer m_text;
    ScopedFile m_original; // the first file that holds the text, all of it and nothing else
};

/// Writes all of text to the stream, block by block. Returns false if not all was written.
bool WriteText(std::FILE* stream, std::string_view text);
