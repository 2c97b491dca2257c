#include "Tools/DocTools/VantorPagemeld/Memory/Heap.h"

#include <climits>
#include <cstddef>
#include <cstdint>
#include <new>

#include <malloc.h>
#include <sys/mman.h>
#include <unistd.h>

namespace
{

constexpr int kReserve = 1 << 30;
constexpr int kOrdinaryTopPad = 128 << 10; // what the C library begins with

/// The advice takes whole pages.
void AdviseHugePages(void* memory, std::size_t size)
{
    const auto pageSize = static_cast<std::size_t>(::sysconf(_SC_PAGESIZE));
    const std::size_t offset = -reinterpret_cast<std::uintptr_t>(memory) & (pageSize - 1);
    (void)::madvise(static_cast<char*>(memory) + offset, size - offset, MADV_HUGEPAGE);
}

} // namespace

void PrepareHeap()
{
    (void)::mallopt(M_ARENA_MAX, 1);
    (void)::mallopt(M_MMAP_MAX, 0);
    (void)::mallopt(M_TRIM_THRESHOLD, INT_MAX);

    // A block that the heap has to grow for, and the reserve behind it. The block is free again afterwards;
    // the heap gives nothing back.
    constexpr std::size_t kLargerThanTheHeap = 1 << 20;
    (void)::mallopt(M_TOP_PAD, kReserve);
    void* const block = ::operator new(kLargerThanTheHeap, std::nothrow);
    (void)::mallopt(M_TOP_PAD, kOrdinaryTopPad);
    if (block != nullptr)
    {
        AdviseHugePages(block, kReserve);
        ::operator delete(block);
    }
}
