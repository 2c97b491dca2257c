#pragma once

#include <stdexcept>
#include <string>

#include <regex.h>

/// Whether a part of one line of the text matches the extended regular expression.
///
/// The standard library's expressions cause false warnings of uninitialised memory in builds with sanitizers.
inline bool HasMatch(const std::string& text, const std::string& pattern)
{
    regex_t expression = {};
    if (::regcomp(&expression, pattern.c_str(), REG_EXTENDED | REG_NEWLINE | REG_NOSUB) != 0)
    {
        throw std::runtime_error("not a regular expression: " + pattern);
    }
    const bool found = ::regexec(&expression, text.c_str(), 0, nullptr, 0) == 0;
    ::regfree(&expression);
    return found;
}
