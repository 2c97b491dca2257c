#include "Tools/DocTools/VantorPagemeld/Output/Diagnostics.h"

#include <cstdarg>
#include <cstdio>
#include <cstdlib>

namespace
{

__attribute__((format(printf, 4, 0))) void Report(const char* level, const char* sourceFile, int number,
                                                  const char* format, std::va_list arguments)
{
    std::fprintf(stderr, "%s: %s:%d ", level, sourceFile, number);
    std::vfprintf(stderr, format, arguments);
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
    std::va_list arguments;
    va_start(arguments, format);
    std::vfprintf(stderr, format, arguments);
    va_end(arguments);
}
