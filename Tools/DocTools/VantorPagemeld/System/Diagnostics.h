#pragma once

/// The tagged messages of one source file, written to standard error.
///
/// Each message reads "LEVEL: tag:number text". The number is fixed per message and part of the interface, so
/// it is written beside the text at the call and is never the line of the code. Texts carry their own line
/// break. A message is one write, so that those of programs that run side by side do not mix.
class Diagnostics
{
public:
    /// sourceFile is the tag; it must outlive the object, which a literal does.
    explicit constexpr Diagnostics(const char* sourceFile) : m_sourceFile(sourceFile) {}

    /// Reports a skipped input or an unwritten JSON output.
    void Warning(int number, const char* format, ...) const __attribute__((format(printf, 3, 4)));

    /// Reports a parse failure, a usage error, a failed verification or an unwritten contents script.
    void Error(int number, const char* format, ...) const __attribute__((format(printf, 3, 4)));

    /// Reports a failure after which nothing can go on, and ends the process with status 255.
    [[noreturn]] void CriticalAndExit(int number, const char* format, ...) const
        __attribute__((format(printf, 3, 4)));

private:
    const char* m_sourceFile;
};

/// Writes a progress line, which carries neither level nor tag, to standard error.
void ReportProgress(const char* format, ...) __attribute__((format(printf, 1, 2)));

/// Makes it safe to write messages, however the process was started. To be called before any file is opened.
///
/// Opens a placeholder on every closed standard descriptor: otherwise an output file would get that number
/// and receive the messages. Ignores SIGPIPE: when nobody reads standard error any more, messages are lost
/// but outputs are not.
void SecureStandardStreams();
