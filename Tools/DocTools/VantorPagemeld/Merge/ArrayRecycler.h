#pragma once

#include <rapidjson/document.h>

#include <array>
#include <cstddef>

/// Joins JSON arrays, and reuses the storage of those that were outgrown or emptied for the next that grow.
///
/// Storage from different documents is mixed: all documents must live as long as this object and any array
/// that it joined.
class ArrayRecycler
{
public:
    using Value = rapidjson::Value;
    using Allocator = rapidjson::Document::AllocatorType;

    /// Moves the elements of input to the end of list, which grows with the allocator if there is nothing to
    /// reuse. input is null afterwards. Throws std::bad_alloc if the list would grow beyond 2^31 elements.
    void MoveElements(Value& list, Value& input, Allocator& allocator);

private:
    [[nodiscard]] Value Take(std::size_t capacity, Allocator& allocator);
    void Keep(Value& list, Allocator& allocator);

    /// By the power of two that their capacity reaches: null, or an array whose only element is the next
    /// array of that kind, or null.
    std::array<Value, 33> m_spares;
};
