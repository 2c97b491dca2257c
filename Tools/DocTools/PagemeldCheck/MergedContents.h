#pragma once

#include "Tools/DocTools/PagemeldCheck/Report/FileFindings.h"
#include "Tools/DocTools/VantorPagemeld/Merge/PositionTable.h"

#include <cstdint>
#include <string>
#include <vector>

/// The entries that the modules of a set have brought to the common contents so far. Grows by 40 bytes or so
/// for each entry, and holds no texts.
class MergedContents
{
public:
    /// Merges the sound contents of the next module as a run does: nothing, if the root is not that of the
    /// first.
    ///
    /// Reports the topmost of its entries that have a page and become one with an entry of an earlier module.
    /// Those below stay unmentioned. Entries that a module has twice itself are no loss: their children are
    /// joined.
    void Merge(const rapidjson::Value& toc, FileFindings& findings);

private:
    struct Entry
    {
        std::uint64_t way;    ///< what leads to it: the hash of the links and titles from the root down
        std::uint32_t module; ///< the first that has it, a position in the list of roots
        bool hasList;         ///< whether its children are a list
    };

    /// What stays the same while one module is merged.
    struct Source
    {
        std::uint32_t module;
        FileFindings& findings;
    };

    [[nodiscard]] std::uint32_t Find(std::uint64_t way) const;
    std::uint32_t Add(std::uint64_t way, std::uint32_t module);
    [[nodiscard]] std::vector<std::uint64_t> WaysTo(const rapidjson::Value& children,
                                                    std::uint64_t parent) const;
    void MergeChildren(const Source& source, const rapidjson::Value& node, const JsonPointer& pointer,
                       std::uint32_t position, bool isHidden);
    void Report(const Source& source, const rapidjson::Value& node, const JsonPointer& pointer,
                const Entry& winner) const;

    std::vector<std::string> m_roots;
    std::vector<Entry> m_entries;
    PositionTable m_positions;
};
