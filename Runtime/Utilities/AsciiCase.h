#pragma once

#include "Runtime/Core/Containers/String.h"

#include <string_view>

// Text without regard to case. Only the ASCII letters have a case here; all other bytes stand for themselves.

/// Returns the text with A to Z replaced by a to z.
core::string ToLower(std::string_view text);

bool EqualsIgnoringCase(std::string_view a, std::string_view b);

bool BeginsWithIgnoringCase(std::string_view text, std::string_view prefix);
