#include "Tools/DocTools/PagemeldCheck/MergedContents.h"

#include "Tools/DocTools/PagemeldCheck/Browse/WebPath.h"
#include "Tools/DocTools/VantorPagemeld/Merge/SipHash.h"
#include "Tools/DocTools/VantorPagemeld/Read/JsonDocument.h"

#include <string_view>
#include <utility>

// Only one document is in memory at a time, and the merged tree would take as much as all of them. So an
// entry is kept as a hash of the way to it. Two ways with the same 64 bits would be taken for one: with ten
// million entries the odds are one to 400,000.
//
// A list that comes to an entry without one is taken over whole, twins and all. Later look-ups find the first
// twin only, so nothing can be merged with what is below the others. Whatever comes to a list goes in one by
// one.

using rapidjson::Value;

namespace
{

/// Whether the link is one of the module. An address leads to the same from every module.
bool HasPage(const Value& node)
{
    const std::string_view link = CStringOf(*FindMember(node, "link"));
    return link != "null" && !IsAddress(link);
}

/// Returns the hash of a way that goes on with a text.
std::uint64_t Extended(std::uint64_t way, const char* text)
{
    constexpr std::uint64_t kGoldenRatio = 0x9E3779B97F4A7C15; // in 64 bits, so that all of them spread
    const std::uint64_t product = (way ^ KeyedHash(text)) * kGoldenRatio;
    return product ^ product >> 32U;
}

std::uint64_t WayTo(std::uint64_t parent, const Value& node)
{
    return Extended(Extended(parent, CStringOf(*FindMember(node, "link"))),
                    CStringOf(*FindMember(node, "title")));
}

} // namespace

void MergedContents::Merge(const Value& toc, FileFindings& findings)
{
    const Source source = {static_cast<std::uint32_t>(m_roots.size()), findings};
    const std::uint64_t way = WayTo(0, toc);
    const std::uint32_t root = m_entries.empty() ? Add(way, source.module) : Find(way);
    if (root != PositionTable::kNotFound)
    {
        m_roots.push_back(findings.Scope().root);
        MergeChildren(source, toc, JsonPointer(), root, false);
    }
}

std::uint32_t MergedContents::Find(std::uint64_t way) const
{
    return m_positions.Find(way, [&](std::uint32_t position) { return m_entries[position].way == way; });
}

std::uint32_t MergedContents::Add(std::uint64_t way, std::uint32_t module)
{
    const auto position = static_cast<std::uint32_t>(m_entries.size());
    m_entries.push_back({way, module, false});
    m_positions.Add(way);
    return position;
}

std::vector<std::uint64_t> MergedContents::WaysTo(const Value& children, std::uint64_t parent) const
{
    std::vector<std::uint64_t> ways(children.Size());
    for (rapidjson::SizeType i = 0; i < children.Size(); ++i)
    {
        ways[i] = WayTo(parent, children[i]);
        m_positions.Prefetch(ways[i]);
    }
    return ways;
}

void MergedContents::MergeChildren(const Source& source, const Value& node, const JsonPointer& pointer,
                                   std::uint32_t position, bool isHidden)
{
    const Value& children = *FindMember(node, "children");
    if (!children.IsArray())
    {
        return;
    }
    const bool isTakenWhole = !std::exchange(m_entries[position].hasList, true);
    const std::vector<std::uint64_t> ways = WaysTo(children, m_entries[position].way);
    const JsonPointer list(pointer, "children");
    for (rapidjson::SizeType i = 0; i < children.Size(); ++i)
    {
        const JsonPointer child(list, i);
        const std::uint32_t known = Find(ways[i]);
        if (known == PositionTable::kNotFound)
        {
            MergeChildren(source, children[i], child, Add(ways[i], source.module), isHidden);
        }
        else if (!isTakenWhole)
        {
            const Entry winner = m_entries[known];
            const bool isFirstHidden = !isHidden && winner.module != source.module && HasPage(children[i]);
            if (isFirstHidden)
            {
                Report(source, children[i], child, winner);
            }
            MergeChildren(source, children[i], child, known, isHidden || isFirstHidden);
        }
    }
}

void MergedContents::Report(const Source& source, const Value& node, const JsonPointer& pointer,
                            const Entry& winner) const
{
    source.findings.AddAtValue(
        Rule::ShadowedEntry, node, pointer,
        [&]
        {
            return Visible(m_roots[winner.module]) + " has the same entry, " +
                   source.findings.Quote(BytesOf(*FindMember(node, "title"))) + " with the link " +
                   source.findings.Quote(BytesOf(*FindMember(node, "link"))) +
                   ": in the contents it leads to the page of that module, and not to this one's";
        });
}
