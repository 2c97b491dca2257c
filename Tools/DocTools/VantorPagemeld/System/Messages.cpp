#include "Tools/DocTools/VantorPagemeld/System/Messages.h"

#include <csignal>
#include <cstdarg>
#include <cstdio>
#include <cstdlib>
#include <string>

#include <fcntl.h>
#include <unistd.h>

namespace
{

__attribute__((format(printf, 2, 0))) void AppendFormatted(std::string& text, const char* format,
                                                           std::va_list arguments)
{
    std::va_list again;
    va_copy(again, arguments);
    const int length = std::vsnprintf(nullptr, 0, format, again);
    va_end(again);
    if (length > 0)
    {
        const std::size_t start = text.size();
        text.resize(start + static_cast<std::size_t>(length) + 1); // and the NUL, taken off again
        (void)std::vsnprintf(&text[start], static_cast<std::size_t>(length) + 1, format, arguments);
        text.pop_back();
    }
}

/// Standard error has no buffer, so what is handed over in one piece is written by one call.
void Write(const std::string& message)
{
    (void)std::fwrite(message.data(), 1, message.size(), stderr);
}

__attribute__((format(printf, 4, 0))) void Report(const char* level, const char* sourceFile, int number,
                                                  const char* format, std::va_list arguments)
{
    std::string message = std::string(level) + ": " + sourceFile + ":" + std::to_string(number) + " ";
    AppendFormatted(message, format, arguments);
    Write(message);
}

} // namespace

void Diagnostics::Warning(int number, const char* format, ...) const
{
    std::va_list arguments;
    va_start(arguments, format);
    Report("WARNING", m_sourceFile, number, format, arguments);
    va_end(arguments);
}

void Diagnostics::Error(int number, const char* format, ...) const
{
    std::va_list arguments;
    va_start(arguments, format);
    Report("ERROR", m_sourceFile, number, format, arguments);
    va_end(arguments);
}

void Diagnostics::CriticalAndExit(int number, const char* format, ...) const
{
    std::va_list arguments;
    va_start(arguments, format);
    Report("CRITICAL", m_sourceFile, number, format, arguments);
    va_end(arguments);
    std::exit(-1);
}

void ReportProgress(const char* format, ...)
{
    std::string line;
    std::va_list arguments;
    va_start(arguments, format);
    AppendFormatted(line, format, arguments);
    va_end(arguments);
    Write(line);
}

void SecureStandardStreams()
{
    // An open takes the lowest free descriptor. The root directory is always there, and can't be written to.
    int descriptor = STDIN_FILENO;
    while (descriptor >= 0 && descriptor <= STDERR_FILENO)
    {
        descriptor = ::open("/", O_RDONLY | O_DIRECTORY);
    }
    (void)::close(descriptor);
    (void)std::signal(SIGPIPE, SIG_IGN);
}
