// Formatting of short texts.

#include "platform/kernel.h"

#include <algorithm>
#include <cstdarg>
#include <cstdio>

int wsprintfA(char* buffer, const char* format, ...) {
    constexpr std::size_t longestResult = 1024; // with its NUL, as on the platform
    std::va_list arguments;
    va_start(arguments, format);
    const int length = std::vsnprintf(buffer, longestResult, format, arguments);
    va_end(arguments);
    return std::min(length, static_cast<int>(longestResult) - 1);
}
