#pragma once

#include "Runtime/Core/Containers/String.h"

/// A growing buffer that the JSON library's writers write to.
class TempBufferWriter
{
public:
    using Ch = char;

    void Put(char character) { m_text += character; }
    void Flush() {}

    [[nodiscard]] const core::string& GetText() const { return m_text; }

private:
    core::string m_text;
};
