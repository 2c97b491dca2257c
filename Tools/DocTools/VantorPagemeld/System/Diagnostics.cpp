#include "Tools/DocTools/VantorPagemeld/System/Diagnostics.h"

#include <csignal>
#include <cstdarg>
#include <cstdio>
#include <cstdlib>
#include <new>

#include <fcntl.h>
#include <unistd.h>

namespace
{

/// A message that is put together in memory, and written to standard error at the end of its life. Standard
/// error has no buffer, so what is handed over in one piece is written by one call.
class Message
{
public:
    Message() : m_stream(::open_memstream(&m_text, &m_size))
    {
        if (m_stream == nullptr)
        {
            throw std::bad_alloc();
        }
    }

    ~Message()
    {
        (void)std::fclose(m_stream);
        (void)std::fwrite(m_text, 1, m_size, stderr);
        std::free(m_text);
    }

    Message(const Message&) = delete;
    Message& operator=(const Message&) = delete;

    [[nodiscard]] std::FILE* Stream() const { return m_stream; }

private:
    char* m_text = nullptr;
    std::size_t m_size = 0;
    std::FILE* m_stream;
};

__attribute__((format(printf, 4, 0))) void Report(const char* level, const char* sourceFile, int number,
                                                  const char* format, std::va_list arguments)
{
    const Message message;
    (void)std::fprintf(message.Stream(), "%s: %s:%d ", level, sourceFile, number);
    (void)std::vfprintf(message.Stream(), format, arguments);
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
    const Message message;
    std::va_list arguments;
    va_start(arguments, format);
    (void)std::vfprintf(message.Stream(), format, arguments);
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
