#include "Runtime/Allocator/LabelledAllocation.h"

#include <algorithm>
#include <array>
#include <new>

namespace
{

std::array<std::size_t, static_cast<std::size_t>(MemoryLabel::Count)> liveBlocks;

std::size_t& LiveBlocks(MemoryLabel label)
{
    return liveBlocks.at(static_cast<std::size_t>(label));
}

} // namespace

void* AllocateLabelled(MemoryLabel label, std::size_t size)
{
    void* const memory = ::operator new(size);
    ++LiveBlocks(label);
    return memory;
}

void* ReallocateLabelled(MemoryLabel label, void* memory, std::size_t oldSize, std::size_t newSize)
{
    void* const resized = AllocateLabelled(label, newSize);
    std::copy_n(static_cast<const char*>(memory), std::min(oldSize, newSize), static_cast<char*>(resized));
    FreeLabelled(label, memory);
    return resized;
}

void FreeLabelled(MemoryLabel label, void* memory)
{
    LiveBlocks(label) -= memory == nullptr ? 0 : 1;
    ::operator delete(memory);
}

std::size_t CountLiveBlocks(MemoryLabel label)
{
    return LiveBlocks(label);
}
