#pragma once

#include "Runtime/Allocator/LabelledAllocation.h"

/// Gives the JSON library's values the runtime's labelled memory. Every value frees its own.
class JSONAllocator
{
public:
    static constexpr bool kNeedFree = true;

    void* Malloc(std::size_t size) { return AllocateLabelled(MemoryLabel::Json, size); }

    void* Realloc(void* memory, std::size_t oldSize, std::size_t newSize)
    {
        return ReallocateLabelled(MemoryLabel::Json, memory, oldSize, newSize);
    }

    static void Free(void* memory) { FreeLabelled(MemoryLabel::Json, memory); }
};
