#include "Runtime/Utilities/ConsoleLog.h"

#include "Runtime/Utilities/TextConversion.h"

namespace
{

std::FILE* consoleStream = nullptr;
LogEntryHandler logEntryHandler = nullptr;

} // namespace

void SetLogEntryHandler(LogEntryHandler handler)
{
    logEntryHandler = handler;
}

void SetConsoleStream(std::FILE* stream)
{
    consoleStream = stream;
}

void printf_console(const char* format, ...)
{
    std::va_list arguments;
    std::va_list sameArguments;
    va_start(arguments, format);
    va_copy(sameArguments, arguments);
    if (logEntryHandler == nullptr || logEntryHandler(LogType::Console, format, arguments))
    {
        std::FILE* const stream = consoleStream == nullptr ? stdout : consoleStream;
        (void)std::vfprintf(stream, format, sameArguments);
        (void)std::fflush(stream);
    }
    va_end(sameArguments);
    va_end(arguments);
}

void DebugStringToFile(const LogEntry& entry)
{
    core::string text = entry.message;
    if (entry.type == LogType::Error)
    {
        text = Format("ERROR: %s:%d ", entry.file, entry.line) + text;
    }
    if (text.empty() || text.back() != '\n')
    {
        text += '\n';
    }
    printf_console("%s", text.c_str());
}
