#pragma once

#include <rapidjson/document.h>

#include <array>
#include <cstddef>

/// Joins JSON arrays, and reuses the storage of outgrown and emptied arrays for arrays that grow later.
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

    /// At n, the list of spare arrays with a capacity from 2^n to 2^(n+1) - 1: null, or an array whose only
    /// element is the rest of that list.
    std::array<Value, 33> m_spares;
};
