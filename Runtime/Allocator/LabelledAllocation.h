#pragma once

#include <cstddef>

// Memory that is counted under the label of the part of the program that asked for it, so that a test can see
// whether that part frees all of it. Out of memory ends the process, by std::bad_alloc.

enum class MemoryLabel
{
    Json,
    Count
};

/// Returns size bytes, aligned for every type.
void* AllocateLabelled(MemoryLabel label, std::size_t size);

/// Gives a block of oldSize bytes the new size and returns its new place. The block may be null, with size 0.
void* ReallocateLabelled(MemoryLabel label, void* memory, std::size_t oldSize, std::size_t newSize);

/// Frees a block of that label; null is fine.
void FreeLabelled(MemoryLabel label, void* memory);

/// Returns how many blocks of that label are allocated now.
std::size_t CountLiveBlocks(MemoryLabel label);
