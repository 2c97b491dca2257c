#include "Tools/DocTools/VantorPagemeld/Lookup/TermIndex.h"

#include "Tools/DocTools/VantorPagemeld/Json/JsonValue.h"
#include "Tools/DocTools/VantorPagemeld/Lookup/KeyedHash.h"

void TermIndex::Follow(rapidjson::Value& object)
{
    const bool known = m_object == &object && m_memberCount == object.MemberCount() &&
                       (m_memberCount == 0 || m_members == &*object.MemberBegin());
    if (known)
    {
        return;
    }
    m_object = &object;
    m_positions.Clear();
    NoteStorage();
    for (rapidjson::SizeType i = 0; i < m_memberCount; ++i)
    {
        const std::uint64_t hash = KeyedHash(BytesOf(m_members[i].name));
        if (PositionOf(m_members[i].name, hash) == PositionTable::kNotFound)
        {
            m_positions.Add(hash, i);
        }
    }
}

rapidjson::Value* TermIndex::FindOrAppend(rapidjson::Value::Member& member, Allocator& allocator)
{
    const std::uint64_t hash = KeyedHash(BytesOf(member.name));
    const std::uint32_t position = PositionOf(member.name, hash);
    if (position != PositionTable::kNotFound)
    {
        return &m_members[position].value;
    }
    m_positions.Add(hash, m_memberCount);
    m_object->AddMember(member.name, member.value, AllocatorForGrowth(allocator));
    NoteStorage();
    return nullptr;
}

std::uint32_t TermIndex::PositionOf(const rapidjson::Value& name, std::uint64_t hash) const
{
    return m_positions.Find(hash,
                            [&](std::uint32_t i) { return BytesOf(m_members[i].name) == BytesOf(name); });
}

TermIndex::Allocator& TermIndex::AllocatorForGrowth(Allocator& allocator)
{
    constexpr rapidjson::SizeType kLargeObject = 1 << 16;
    if (m_memberCount < kLargeObject)
    {
        return allocator;
    }
    if (m_largeObjectAllocator.Capacity() == 0)
    {
        // A pool without memory crashes when it is to grow what another one allocated.
        (void)m_largeObjectAllocator.Malloc(1);
    }
    return m_largeObjectAllocator;
}

void TermIndex::NoteStorage()
{
    m_memberCount = m_object->MemberCount();
    m_members = m_memberCount == 0 ? nullptr : &*m_object->MemberBegin();
}
