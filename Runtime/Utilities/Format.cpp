#include "Runtime/Utilities/Format.h"

#include <cstdarg>
#include <cstdio>

core::string Format(const char* format, ...)
{
    std::va_list arguments;
    std::va_list sameArguments;
    va_start(arguments, format);
    va_copy(sameArguments, arguments);
    const int length = std::vsnprintf(nullptr, 0, format, arguments);
    core::string text(length < 0 ? 0 : static_cast<std::size_t>(length), '\0');
    (void)std::vsnprintf(text.data(), text.size() + 1, format, sameArguments);
    va_end(sameArguments);
    va_end(arguments);
    return text;
}
