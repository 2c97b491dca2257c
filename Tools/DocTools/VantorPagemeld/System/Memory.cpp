#include "Tools/DocTools/VantorPagemeld/System/Memory.h"

#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <new>

#ifdef PAGEMELD_HAVE_HEAP_ADVICE
#include <malloc.h>
#include <sys/mman.h>
#include <sys/resource.h>
#include <unistd.h>

namespace
{

constexpr int kReserve = 1 << 30;
constexpr int kOrdinaryTopPad = 128 << 10; // what the C library begins with
constexpr int kNever = -1;

/// Where the address space is limited, the reserve would take it from the stack.
bool IsAddressSpaceLimited()
{
    rlimit limit = {};
    return ::getrlimit(RLIMIT_AS, &limit) != 0 || limit.rlim_cur != RLIM_INFINITY;
}

/// The advice applies to whole pages.
void AdviseHugePages(void* memory, std::size_t size)
{
    const auto pageSize = static_cast<std::size_t>(::sysconf(_SC_PAGESIZE));
    const std::size_t offset = -reinterpret_cast<std::uintptr_t>(memory) & (pageSize - 1);
    (void)::madvise(static_cast<char*>(memory) + offset, size - offset, MADV_HUGEPAGE);
}

/// Makes the heap grow for a block and for the reserve after it. The block is freed again; the heap gives
/// nothing back.
void AddReserve()
{
    constexpr std::size_t kLargerThanTheHeap = 1 << 20;
    if (::mallopt(M_TOP_PAD, kReserve) == 0)
    {
        return; // a sanitizer's allocator is in place
    }
    void* const block = ::operator new(kLargerThanTheHeap, std::nothrow);
    (void)::mallopt(M_TOP_PAD, kOrdinaryTopPad);
    if (block != nullptr)
    {
        AdviseHugePages(block, kReserve);
        ::operator delete(block);
    }
}

} // namespace

void PrepareHeap()
{
    (void)::mallopt(M_MMAP_MAX, 0);
    (void)::mallopt(M_TRIM_THRESHOLD, kNever);
    if (!IsAddressSpaceLimited())
    {
        AddReserve();
    }
}
#else
void PrepareHeap() {}
#endif

extern "C"
{
    void* MallocOrEnd(std::size_t size) noexcept __asm__("PagemeldMallocOrEnd");
    void* ReallocOrEnd(void* memory, std::size_t size) noexcept __asm__("PagemeldReallocOrEnd");
}

namespace
{

void* EndIfNull(void* memory)
{
    if (memory == nullptr)
    {
        if (const std::new_handler end = std::get_new_handler())
        {
            end();
        }
        throw std::bad_alloc();
    }
    return memory;
}

} // namespace

void* MallocOrEnd(std::size_t size) noexcept
{
    return EndIfNull(std::malloc(size));
}

void* ReallocOrEnd(void* memory, std::size_t size) noexcept
{
    return EndIfNull(std::realloc(memory, size));
}
