#pragma once

#include "Tools/DocTools/VantorPagemeld/Structure/JsonPlace.h"

#include <functional>

/// One way in which an input document breaks its format.
struct StructureFault
{
    int number;       ///< the fixed number of its message
    const char* text; ///< its message without a line break; null for the one that is not spoken of
};

/// Takes each fault that a structure check finds, with its place, in document order. Returns whether to go
/// on.
using FaultHandler = std::function<bool(const StructureFault& fault, const JsonPlace& place)>;
