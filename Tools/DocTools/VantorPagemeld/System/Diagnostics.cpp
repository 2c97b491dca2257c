#include "Tools/DocTools/VantorPagemeld/System/Diagnostics.h"

#include <csignal>
#include <cstdarg>
#include <cstdio>
#include <cstdlib>
#include <string>

#include <fcntl.h>
#include <unistd.h>

namespace
{

/// Standard error has no buffer: what is handed over in one piece is written by one call.
__attribute__((format(printf, 2, 0))) void Write(std::string message, const char* format,
                                                 std::va_list arguments)
{
    const std::size_t start = message.size();
    std::va_list sameArguments;
    va_copy(sameArguments, arguments);
    message.resize(start + static_cast<std::size_t>(std::vsnprintf(nullptr, 0, format, arguments)));
    (void)std::vsnprintf(message.data() + start, message.size() - start + 1, format, sameArguments);
    va_end(sameArguments);
    (void)std::fwrite(message.data(), 1, message.size(), stderr);
}

std::string Prefix(const char* level, const char* sourceFile, int number)
{
    return std::string(level) + ": " + sourceFile + ":" + std::to_string(number) + " ";
}

} // namespace

void Diagnostics::Warning(int number, const char* format, ...) const
{
    std::va_list arguments;
    va_start(arguments, format);
    Write(Prefix("WARNING", m_sourceFile, number), format, arguments);
    va_end(arguments);
}

void Diagnostics::Error(int number, const char* format, ...) const
{
    std::va_list arguments;
    va_start(arguments, format);
    Write(Prefix("ERROR", m_sourceFile, number), format, arguments);
    va_end(arguments);
}

void Diagnostics::CriticalAndExit(int number, const char* format, ...) const
{
    std::va_list arguments;
    va_start(arguments, format);
    Write(Prefix("CRITICAL", m_sourceFile, number), format, arguments);
    va_end(arguments);
    std::exit(-1);
}

void ReportProgress(const char* format, ...)
{
    std::va_list arguments;
    va_start(arguments, format);
    Write("", format, arguments);
    va_end(arguments);
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
