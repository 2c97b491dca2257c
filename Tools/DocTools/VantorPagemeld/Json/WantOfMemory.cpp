#include <cstddef>
#include <new>

// The JSON library uses what malloc and realloc return without a look, so that it would write through null
// when memory runs out. The linker redirects these two, for our objects only, to the functions here
// (--wrap), and want of memory ends the process there as it does everywhere else: by std::bad_alloc, which
// nobody catches.

// NOLINTBEGIN(bugprone-reserved-identifier): the linker's names
extern "C"
{
    void* __real_malloc(std::size_t size);
    void* __real_realloc(void* memory, std::size_t size);
    void* __wrap_malloc(std::size_t size) noexcept;
    void* __wrap_realloc(void* memory, std::size_t size) noexcept;
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

void* __wrap_malloc(std::size_t size) noexcept
{
    return EndIfNull(__real_malloc(size));
}

void* __wrap_realloc(void* memory, std::size_t size) noexcept
{
    return EndIfNull(__real_realloc(memory, size));
}
// NOLINTEND(bugprone-reserved-identifier)
