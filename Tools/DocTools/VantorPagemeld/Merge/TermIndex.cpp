#include "Tools/DocTools/VantorPagemeld/Merge/TermIndex.h"

#include "Tools/DocTools/VantorPagemeld/Merge/SipHash.h"
#include "Tools/DocTools/VantorPagemeld/Read/JsonDocument.h"

// The JSON library finds a member by a linear search, which makes the merge of n terms take n * n steps. The
// index beside the object costs 16 to 32 bytes a term and one hash of each name; the names stay in the
// object.

LargeObjectPool::Allocator& LargeObjectPool::AllocatorFor(rapidjson::SizeType memberCount,
                                                          Allocator& allocator)
{
    constexpr rapidjson::SizeType kMany = 1 << 16;
    if (memberCount < kMany)
    {
        return allocator;
    }
    if (m_allocator.Capacity() == 0)
    {
        // A pool without memory crashes when it is asked to grow what another one allocated.
        (void)m_allocator.Malloc(1);
    }
    return m_allocator;
}

TermIndex::TermIndex(rapidjson::Value& object, LargeObjectPool& pool) : m_object(object), m_pool(pool)
{
    std::uint32_t position = 0;
    for (const auto& member : object.GetObject())
    {
        const std::uint64_t hash = KeyedHash(BytesOf(member.name));
        if (PositionOf(member.name, hash) == PositionTable::kNotFound)
        {
            m_positions.Add(hash, position);
        }
        ++position;
    }
}

rapidjson::Value* TermIndex::FindOrAppend(rapidjson::Value::Member& member, Allocator& allocator)
{
    const std::uint64_t hash = KeyedHash(BytesOf(member.name));
    const std::uint32_t position = PositionOf(member.name, hash);
    if (position != PositionTable::kNotFound)
    {
        return &m_object.MemberBegin()[position].value;
    }
    const rapidjson::SizeType memberCount = m_object.MemberCount();
    m_positions.Add(hash, memberCount);
    m_object.AddMember(member.name, member.value, m_pool.AllocatorFor(memberCount, allocator));
    return nullptr;
}

std::uint32_t TermIndex::PositionOf(const rapidjson::Value& name, std::uint64_t hash) const
{
    const auto members = m_object.MemberBegin();
    return m_positions.Find(hash, [&](std::uint32_t i) { return BytesOf(members[i].name) == BytesOf(name); });
}
