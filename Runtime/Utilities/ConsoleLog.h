#pragma once

#include <cstdarg>
#include <cstdio>

// The program's console: one stream that all of the runtime prints to, and a handler that is called with
// every message first. For use by one thread.

enum class LogType
{
    Error,
    Log,
    Console = 5 ///< printed by printf_console
};

/// Is called with a message before it is printed; returns whether to print it.
using LogEntryHandler = bool (*)(LogType type, const char* format, std::va_list arguments);

/// Replaces the handler; null accepts every message.
void SetLogEntryHandler(LogEntryHandler handler);

/// Makes the stream the console; null means standard output, which is the console at first. The caller
/// owns the stream, and must set another before closing it.
void SetConsoleStream(std::FILE* stream);

/// Prints and flushes the message, unless the handler refuses it.
void printf_console(const char* format, ...) __attribute__((format(printf, 1, 2)));

/// A message with the place in the source that it comes from.
struct LogEntry
{
    const char* message;
    LogType type;
    const char* file;
    int line;
};

/// Prints an entry with one call of printf_console. Adds a line break unless the message ends in one. A plain
/// log entry shows the message alone; an error shows its origin too.
void DebugStringToFile(const LogEntry& entry);
