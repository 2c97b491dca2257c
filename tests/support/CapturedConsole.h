#pragma once

#include "Runtime/Utilities/ConsoleLog.h"

#include <cstdio>
#include <cstdlib>
#include <initializer_list>
#include <string>

/// Makes memory the console for as long as it lives, with no log handler at first and at last.
class CapturedConsole
{
public:
    CapturedConsole() : m_stream(::open_memstream(&m_text, &m_size))
    {
        SetLogEntryHandler(nullptr);
        SetConsoleStream(m_stream);
    }

    ~CapturedConsole()
    {
        SetConsoleStream(nullptr);
        SetLogEntryHandler(nullptr);
        (void)std::fclose(m_stream);
        std::free(m_text);
    }

    CapturedConsole(const CapturedConsole&) = delete;
    CapturedConsole& operator=(const CapturedConsole&) = delete;

    /// Returns what was printed so far.
    [[nodiscard]] std::string GetText() const { return {m_text, m_size}; }

    /// Returns the same with the number behind every occurrence of these labels, such as a time, as N.
    [[nodiscard]] std::string GetTextWithoutNumbers(std::initializer_list<const char*> labels) const
    {
        std::string text = GetText();
        for (const std::string label : labels)
        {
            for (std::size_t at = text.find(label); at != std::string::npos; at = text.find(label, at + 1))
            {
                const std::size_t start = at + label.size();
                text.replace(start, text.find_first_not_of("0123456789.", start) - start, "N");
            }
        }
        return text;
    }

private:
    char* m_text = nullptr;
    std::size_t m_size = 0;
    std::FILE* m_stream;
};
