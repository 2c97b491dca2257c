#pragma once

#include <rapidjson/document.h>

#include <array>
#include <cstddef>

/// Joins JSON arrays, and keeps the storage that they leave behind for the next arrays that grow.
///
/// The documents' pools never free: without this, a list that many modules add to would leave its smaller
/// selves behind, several times what it holds in the end. Storage from different documents is mixed, so all
/// of them must live as long as any of the arrays.
class SpareLists
{
public:
    using Value = rapidjson::Value;
    using Allocator = rapidjson::Document::AllocatorType;

    /// Moves the elements of input behind those of list. input is null afterwards. Throws std::bad_alloc if
    /// the list would have to grow beyond 2^31 elements.
    void MoveElements(Value& list, Value& input, Allocator& allocator);

private:
    [[nodiscard]] Value Take(std::size_t capacity, Allocator& allocator);
    void Keep(Value& list, Allocator& allocator);

    /// By the power of two that their capacity reaches: null, or an array whose only element is the next one
    /// of that kind.
    std::array<Value, 33> m_spares;
};
