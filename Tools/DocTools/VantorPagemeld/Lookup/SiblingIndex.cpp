#include "Tools/DocTools/VantorPagemeld/Lookup/SiblingIndex.h"

#include "Tools/DocTools/VantorPagemeld/Json/JsonValue.h"
#include "Tools/DocTools/VantorPagemeld/Lookup/KeyedHash.h"

#include <cstring>

void SiblingIndex::Follow(rapidjson::Value& list)
{
    if (m_list == &list && m_storage == list.Begin() && m_siblings.size() == list.Size())
    {
        return;
    }
    m_list = &list;
    m_storage = list.Begin();
    m_siblings.clear();
    m_positions.Clear();
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
    m_list->PushBack(entry, allocator);
    m_storage = m_list->Begin();
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
    // The product keeps a pair apart from its swapped twin; the hashes themselves are beyond an input's
    // control.
    const std::uint64_t hash = 31 * KeyedHash(CStringOf(*link)) + KeyedHash(CStringOf(*title));
    return {CStringOf(*link), CStringOf(*title), children, hash};
}

const SiblingIndex::Sibling* SiblingIndex::Find(const Sibling& wanted) const
{
    if (!wanted.CanBeFound())
    {
        return nullptr;
    }
    const std::uint32_t position =
        m_positions.Find(wanted.hash,
                         [&](std::uint32_t i)
                         {
                             return std::strcmp(m_siblings[i].link, wanted.link) == 0 &&
                                    std::strcmp(m_siblings[i].title, wanted.title) == 0;
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
