#pragma once

#include "Tools/DocTools/VantorPagemeld/Lookup/PositionTable.h"

#include <rapidjson/document.h>

#include <cstddef>

/// Finds the members of one growing JSON object by name in constant time: what a linear search over the
/// object finds, the first member whose name has the same bytes.
///
/// The list of members of a large object is kept in memory of this class, which must outlive every use of the
/// object.
class TermIndex
{
public:
    using Allocator = rapidjson::Document::AllocatorType;

    /// Makes this the index of the object. Costs nothing if the object is as the index left it, and a walk
    /// over its members otherwise.
    void Follow(rapidjson::Value& object);

    /// Returns the value of the first member that has member's name, valid until the next call. If there is
    /// none, moves member to the end of the object, which grows with the allocator until it is large, and
    /// returns null.
    rapidjson::Value* FindOrAppend(rapidjson::Value::Member& member, Allocator& allocator);

private:
    [[nodiscard]] std::uint32_t PositionOf(const rapidjson::Value& name, std::uint64_t hash) const;
    Allocator& AllocatorForGrowth(Allocator& allocator);
    void NoteStorage();

    rapidjson::Value* m_object = nullptr;
    rapidjson::Value::Member* m_members = nullptr;
    rapidjson::SizeType m_memberCount = 0;
    PositionTable m_positions;

    /// Holds nothing but the members of a large object. What a pool gave out last it grows in place, so that
    /// the object leaves no smaller selves behind. Two million members have room; memory is taken as it is
    /// used.
    Allocator m_largeObjectAllocator{std::size_t{1} << 26};
};
