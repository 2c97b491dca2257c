#pragma once

#include "Tools/DocTools/VantorPagemeld/Merge/PositionTable.h"

#include <rapidjson/document.h>

#include <unordered_map>

/// Whether both nodes have a link and a title, and equal ones, each as NUL-terminated text.
[[nodiscard]] bool HasSameLinkAndTitle(const rapidjson::Value& a, const rapidjson::Value& b);

/// Merges tables of contents into a combined one, which grows with its document's allocator. Values are
/// moved, so every input must live as long as the combined document is used.
///
/// Keeps look-up tables from one merge to the next. Meanwhile others may add entries to the lists and members
/// to the entries, or empty lists, but not change or reorder the entries that there are.
class TocMerge
{
public:
    /// The combined document must outlive this object.
    explicit TocMerge(rapidjson::Document& combined) : m_combined(combined) {}

    /// Merges a whole table of contents.
    void Append(rapidjson::Document& input) { AppendValue(m_combined, input); }

    /// Merges a node or a list of nodes; any other source changes nothing.
    void AppendValue(rapidjson::Value& destination, rapidjson::Value& source);

private:
    void AppendNode(rapidjson::Value& destination, rapidjson::Value& source);
    void AppendList(rapidjson::Value& destination, rapidjson::Value& source);

    rapidjson::Document& m_combined;

    /// The entries, by link and title, of every list that another was merged into, by the address of its
    /// "children" value. If a further member takes that value elsewhere, its list is looked over again; no
    /// other value comes to the address, since pools never free.
    std::unordered_map<const rapidjson::Value*, PositionTable> m_siblings;
};
