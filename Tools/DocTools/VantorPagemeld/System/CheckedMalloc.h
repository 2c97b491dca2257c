#pragma once

#include <cstdlib>

// The build includes this header before every source. The JSON library does not check what malloc and realloc
// return, so it would write through null when memory runs out. Therefore our objects call the two functions
// of Memory.cpp in their place. Running out of memory then ends the process as it does everywhere else: by
// the program's handler if it has set one, or by std::bad_alloc, which nobody catches.

#ifndef PAGEMELD_CALLS_REAL_MALLOC
extern "C"
{
    // NOLINTBEGIN(readability-redundant-declaration): they add the labels
    decltype(std::malloc) malloc __asm__("PagemeldMallocOrEnd");
    decltype(std::realloc) realloc __asm__("PagemeldReallocOrEnd");
    // NOLINTEND(readability-redundant-declaration)
}
#endif
