#pragma once

#include "Runtime/Utilities/ConsoleLog.h"

#include <cstdio>
#include <cstdlib>
#include <string>

/// Captures what is printed on the console during its lifetime.
class CapturedConsole
{
public:
    CapturedConsole() { SetConsoleStream(m_stream); }

    ~CapturedConsole()
    {
        SetConsoleStream(nullptr);
        (void)std::fclose(m_stream);
        std::free(m_text);
    }

    CapturedConsole(const CapturedConsole&) = delete;
    CapturedConsole& operator=(const CapturedConsole&) = delete;

    /// Returns what was printed so far.
    [[nodiscard]] std::string GetText() const { return {m_text, m_size}; }

private:
    char* m_text = nullptr;
    std::size_t m_size = 0;
    std::FILE* m_stream = ::open_memstream(&m_text, &m_size);
};
