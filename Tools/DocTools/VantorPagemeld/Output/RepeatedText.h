#pragma once

#include "Tools/DocTools/VantorPagemeld/Output/RenderedText.h"
#include "Tools/DocTools/VantorPagemeld/Output/ScopedFile.h"

/// A text that is written to several files, byte by byte the same.
///
/// On file systems that can, the files share the blocks of the first one, which takes neither time nor disk
/// space. Each is still a file of its own: changing one leaves the others as they are.
class RepeatedText
{
public:
    explicit RepeatedText(RenderedText text);

    /// Writes the text to a file that was opened empty for reading and writing, and closes it. Whether every
    /// byte arrived is deliberately not asked.
    void WriteTo(ScopedFile file);

private:
    [[nodiscard]] bool CloneTo(std::FILE* file) const;

    RenderedText m_text;
    ScopedFile m_original; // the first file that holds all of the text
};
