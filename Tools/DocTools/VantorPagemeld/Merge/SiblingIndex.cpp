#include "Tools/DocTools/VantorPagemeld/Merge/SiblingIndex.h"

#include "Tools/DocTools/VantorPagemeld/Merge/SipHash.h"
#include "Tools/DocTools/VantorPagemeld/Read/JsonDocument.h"

#include <cstring>

SiblingIndex::SiblingIndex(rapidjson::Value& list) : m_list(list)
{
    for (rapidjson::Value& entry : list.GetArray())
    {
        Add(Describe(entry));
    }
}

rapidjson::Value* SiblingIndex::FindChildrenOrAppend(rapidjson::Value& entry,
                                                     rapidjson::Document::AllocatorType& allocator)
{
    const Sibling sibling = Describe(entry);
    if (const Sibling* known = Find(sibling))
    {
        return known->children;
    }
    Add(sibling);
    m_list.PushBack(entry, allocator);
    return nullptr;
}

SiblingIndex::Sibling SiblingIndex::Describe(rapidjson::Value& entry)
{
    const rapidjson::Value* link = FindMember(entry, "link");
    const rapidjson::Value* title = FindMember(entry, "title");
    rapidjson::Value* children = FindMember(entry, "children");
    if (link == nullptr || !link->IsString() || title == nullptr || !title->IsString() || children == nullptr)
    {
        return {};
    }
    // Without the factor, an entry would share its hash with one whose link and title are swapped.
    const std::uint64_t hash = 31 * KeyedHash(CStringOf(*link)) + KeyedHash(CStringOf(*title));
    return {CStringOf(*link), CStringOf(*title), children, hash};
}

const SiblingIndex::Sibling* SiblingIndex::Find(const Sibling& like) const
{
    if (!like.CanBeFound())
    {
        return nullptr;
    }
    const std::uint32_t position =
        m_positions.Find(like.hash,
                         [&](std::uint32_t i)
                         {
                             return std::strcmp(m_siblings[i].link, like.link) == 0 &&
                                    std::strcmp(m_siblings[i].title, like.title) == 0;
                         });
    return position == PositionTable::kNotFound ? nullptr : &m_siblings[position];
}

void SiblingIndex::Add(const Sibling& sibling)
{
    if (sibling.CanBeFound() && Find(sibling) == nullptr)
    {
        m_positions.Add(sibling.hash, static_cast<std::uint32_t>(m_siblings.size()));
    }
    m_siblings.push_back(sibling);
}
