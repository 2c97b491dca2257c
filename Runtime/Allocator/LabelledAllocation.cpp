#include "Runtime/Allocator/LabelledAllocation.h"

#include <array>
#include <cstdlib>

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
    return ReallocateLabelled(label, nullptr, size);
}

void* ReallocateLabelled(MemoryLabel label, void* memory, std::size_t size)
{
    if (size == 0)
    {
        FreeLabelled(label, memory);
        return nullptr;
    }
    void* const resized = std::realloc(memory, size);
    if (resized == nullptr)
    {
        std::abort();
    }
    LiveBlocks(label) += memory == nullptr ? 1 : 0;
    return resized;
}

void FreeLabelled(MemoryLabel label, void* memory)
{
    LiveBlocks(label) -= memory == nullptr ? 0 : 1;
    std::free(memory);
}

std::size_t CountLiveBlocks(MemoryLabel label)
{
    return LiveBlocks(label);
}
