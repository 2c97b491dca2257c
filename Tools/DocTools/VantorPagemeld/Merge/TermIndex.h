#pragma once

#include "Tools/DocTools/VantorPagemeld/Merge/PositionTable.h"

#include <rapidjson/document.h>

#include <cstddef>

/// Memory for the member lists of large objects. It must outlive every use of such an object.
///
/// A pool can grow only its newest block in place. A list that has a pool to itself therefore leaves no
/// outgrown copies, which for a large list would take as much memory as the list itself.
class LargeObjectPool
{
public:
    using Allocator = rapidjson::Document::AllocatorType;

    /// Returns the allocator by which an object of that many members is to grow: this pool's own if there are
    /// many, and otherwise the one given.
    Allocator& AllocatorFor(rapidjson::SizeType memberCount, Allocator& allocator);

private:
    /// Two million members have room in a block; memory is taken as it is used.
    Allocator m_allocator{std::size_t{1} << 26};
};

/// Finds the members of one growing JSON object by name in expected constant time. Like a linear search, it
/// finds the first member whose name has the same bytes.
///
/// The object must live as long as the index, and nobody else may change it meanwhile.
class TermIndex
{
public:
    using Allocator = rapidjson::Document::AllocatorType;

    /// Walks over the members that the object has already.
    TermIndex(rapidjson::Value& object, LargeObjectPool& pool);

    /// Returns the value of the first member that has member's name, valid until the next call. If there is
    /// none, moves member to the end of the object, which grows with the allocator until it is large, and
    /// returns null.
    rapidjson::Value* FindOrAppend(rapidjson::Value::Member& member, Allocator& allocator);

private:
    [[nodiscard]] std::uint32_t PositionOf(const rapidjson::Value& name, std::uint64_t hash) const;

    rapidjson::Value& m_object;
    LargeObjectPool& m_pool;
    PositionTable m_positions;
};
