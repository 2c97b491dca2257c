#pragma once

#include "Runtime/Core/Containers/String.h"

/// Returns what printf would print.
core::string Format(const char* format, ...) __attribute__((format(printf, 1, 2)));
