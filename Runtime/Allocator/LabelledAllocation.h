#pragma once

#include <cstddef>

/// Memory that is counted by the part of the program that asked for it, so that a leak has a name.

enum class MemoryLabel
{
    Json,
    Count
};

/// Returns size bytes, aligned for every type; null for size 0. Ends the process when there are none.
void* AllocateLabelled(MemoryLabel label, std::size_t size);

/// Gives a block, which may be null, a new size and returns its new place, as AllocateLabelled does. Size 0
/// frees it.
void* ReallocateLabelled(MemoryLabel label, void* memory, std::size_t size);

/// Frees a block of that label; null is fine.
void FreeLabelled(MemoryLabel label, void* memory);

/// Returns how many blocks of that label were allocated and not freed yet.
std::size_t CountLiveBlocks(MemoryLabel label);
