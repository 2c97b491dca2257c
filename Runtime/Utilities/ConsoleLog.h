#pragma once

#include <cstdarg>
#include <cstdio>

/// The program's console: one stream that all of the runtime prints to, with a handler that sees every
/// message first. Used by one thread.

enum class LogType
{
    Error = 0,
    Log = 3,
    Console = 5 ///< printed by printf_console
};

/// Sees a message before it is printed; returns whether to print it.
using LogEntryHandler = bool (*)(LogType type, const char* format, std::va_list arguments);

/// Puts a handler in the place of the one before; null lets every message through.
void SetLogEntryHandler(LogEntryHandler handler);

/// Makes a stream the console, instead of standard output, to which null goes back. The caller keeps the
/// stream and must set another before closing it.
void SetConsoleStream(std::FILE* stream);

/// Offers the message to the handler and, unless that refuses it, prints and flushes it.
void printf_console(const char* format, ...) __attribute__((format(printf, 1, 2)));

/// A message with the place in the source that it comes from.
struct LogEntry
{
    const char* message;
    LogType type;
    const char* file;
    int line;
};

/// Prints an entry whole on lines of its own, through printf_console; the line break at the end may be left
/// out of the message. A plain log entry shows the message alone, an error its origin too.
void DebugStringToFile(const LogEntry& entry);
