#include <cstddef>
#include <new>

// The JSON library uses what malloc and realloc return without a look, so that it would write through null
// when memory runs out. The linker redirects these two, for our objects only, to the functions here (--wrap),
// and want of memory ends the process there as it does everywhere else: by std::bad_alloc, which nobody
// catches.

extern "C"
{
    void* RealMalloc(std::size_t size) __asm__("__real_malloc");
    void* RealRealloc(void* memory, std::size_t size) __asm__("__real_realloc");
    void* MallocOrEnd(std::size_t size) noexcept __asm__("__wrap_malloc");
    void* ReallocOrEnd(void* memory, std::size_t size) noexcept __asm__("__wrap_realloc");
}

namespace
{

void* EndIfNull(void* memory)
{
    if (memory == nullptr)
    {
        throw std::bad_alloc();
    }
    return memory;
}

} // namespace

void* MallocOrEnd(std::size_t size) noexcept
{
    return EndIfNull(RealMalloc(size));
}

void* ReallocOrEnd(void* memory, std::size_t size) noexcept
{
    return EndIfNull(RealRealloc(memory, size));
}
