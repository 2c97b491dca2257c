#pragma once

#include "Runtime/Core/Containers/String.h"

namespace UnitTest
{

/// Puts a text together from texts and numbers.
class MemoryOutStream
{
public:
    /// The capacity, in bytes, is a start; the text may grow beyond it.
    explicit MemoryOutStream(int capacity = 256) { m_text.reserve(static_cast<std::size_t>(capacity)); }

    MemoryOutStream& operator<<(const core::string& text);
    MemoryOutStream& operator<<(int number);
    MemoryOutStream& operator<<(long long number);

    /// Writes an "f" behind the digits, which is wanted: 1.5 shows as 1.500000f.
    MemoryOutStream& operator<<(float number);

    MemoryOutStream& operator<<(double number);

    /// Returns what was written; good until the next write.
    [[nodiscard]] const char* GetText() const { return m_text.c_str(); }

private:
    core::string m_text;
};

} // namespace UnitTest
