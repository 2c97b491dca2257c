#pragma once

#include "Tools/DocTools/VantorPagemeld/Merge/PositionTable.h"

#include <rapidjson/document.h>

#include <cstdint>
#include <vector>

/// Finds the entries of one growing table-of-contents list by link and title in expected constant time. Like
/// a linear search, it finds the first entry with the same link and title as NUL-terminated text.
///
/// Entries without a link or a title are never found. The list must live as long as the index, nobody else
/// may change it meanwhile, and no entry may be given a further member.
class SiblingIndex
{
public:
    /// Walks over the entries that the list has already.
    explicit SiblingIndex(rapidjson::Value& list);

    /// Returns the "children" of the first entry that has entry's link and title. If there is none, moves
    /// entry to the end of the list, which grows with the allocator, and returns null.
    rapidjson::Value* FindChildrenOrAppend(rapidjson::Value& entry,
                                           rapidjson::Document::AllocatorType& allocator);

private:
    /// What a look-up needs of an entry. All of it lies in the entry's members, which stay in place when the
    /// entry moves.
    struct Sibling
    {
        const char* link = nullptr;
        const char* title = nullptr;
        rapidjson::Value* children = nullptr;
        std::uint64_t hash = 0;

        [[nodiscard]] bool CanBeFound() const { return children != nullptr; }
    };

    static Sibling Describe(rapidjson::Value& entry);
    [[nodiscard]] const Sibling* Find(const Sibling& like) const;
    void Add(const Sibling& sibling);

    rapidjson::Value& m_list;
    std::vector<Sibling> m_siblings;
    PositionTable m_positions;
};
