#include "Tools/DocTools/VantorPagemeld/Merge/IndexMerge.h"

#include "Tools/DocTools/VantorPagemeld/Merge/SipHash.h"
#include "Tools/DocTools/VantorPagemeld/Read/JsonDocument.h"

// The JSON library finds a member by a linear search, which makes the merge of n terms take n * n steps. The
// table beside the object costs 16 to 32 bytes a term and one hash of each name; the names stay in the
// object.

using rapidjson::Value;

namespace
{

/// Raises a number by a plain 32-bit addition, which wraps around.
void Rebase(Value& number, int offset)
{
    number.SetInt(
        static_cast<int>(static_cast<std::uint32_t>(number.GetInt()) + static_cast<std::uint32_t>(offset)));
}

} // namespace

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

void IndexMerge::Append(rapidjson::Document& input)
{
    Value& common = m_combined["common"];
    if (common.ObjectEmpty())
    {
        common = DeepCopy(input["common"], m_combined.GetAllocator());
    }
    Value& pages = m_combined["pages"];
    Value& infos = m_combined["info"];
    // Taken before anything is appended: input counts its own pages and infos from 0.
    const auto pageOffset = static_cast<int>(pages.Size());
    const auto infoOffset = static_cast<int>(infos.Size());
    m_arrays.MoveElements(pages, input["pages"], m_combined.GetAllocator());
    AppendInfos(infos, input["info"], pageOffset);
    AppendTerms(m_combined["searchIndex"], input["searchIndex"], infoOffset);
}

void IndexMerge::AppendInfos(Value& infos, Value& input, int pageOffset)
{
    for (Value& entry : input.GetArray())
    {
        Rebase(entry[1], pageOffset);
    }
    m_arrays.MoveElements(infos, input, m_combined.GetAllocator());
}

void IndexMerge::AppendTerms(Value& searchIndex, Value& input, int infoOffset)
{
    for (auto& term : input.GetObject())
    {
        for (Value& infoNumber : term.value.GetArray())
        {
            Rebase(infoNumber, infoOffset);
        }
        if (Value* known = FindOrAppend(searchIndex, term))
        {
            m_arrays.MoveElements(*known, term.value, m_combined.GetAllocator());
        }
    }
}

/// Returns the value of the first term of that name, valid until the object grows. If there is none, moves
/// term to the end and returns null.
Value* IndexMerge::FindOrAppend(Value& searchIndex, Value::Member& term)
{
    const auto nameAt = [&](std::uint32_t i) { return BytesOf(searchIndex.MemberBegin()[i].name); };
    m_terms.CatchUp(
        searchIndex.MemberCount(), [&](std::uint32_t i) { return KeyedHash(nameAt(i)); },
        [&](std::uint32_t i, std::uint32_t j) { return nameAt(i) == nameAt(j); });
    const std::string_view name = BytesOf(term.name);
    const std::uint64_t hash = KeyedHash(name);
    const std::uint32_t position = m_terms.Find(hash, [&](std::uint32_t i) { return nameAt(i) == name; });
    if (position != PositionTable::kNotFound)
    {
        return &searchIndex.MemberBegin()[position].value;
    }
    searchIndex.AddMember(term.name, term.value,
                          m_largeObjects.AllocatorFor(searchIndex.MemberCount(), m_combined.GetAllocator()));
    m_terms.Add(hash);
    return nullptr;
}
