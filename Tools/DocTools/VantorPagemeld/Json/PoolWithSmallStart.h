#pragma once

#include <rapidjson/document.h>

#include <array>
#include <cstddef>

/// The memory of a document: first a small block, and behind it the large ones that the library takes.
///
/// The library begins with a large one, which is more than all that a small module holds, and there may be
/// hundreds of them.
struct PoolWithSmallStart
{
    alignas(std::max_align_t) std::array<char, std::size_t{8} << 10> start;
    rapidjson::Document::AllocatorType allocator{start.data(), start.size()};
};
