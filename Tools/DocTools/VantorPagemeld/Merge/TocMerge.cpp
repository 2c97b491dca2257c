#include "Tools/DocTools/VantorPagemeld/Merge/TocMerge.h"

#include "Tools/DocTools/VantorPagemeld/Merge/SipHash.h"
#include "Tools/DocTools/VantorPagemeld/Read/JsonDocument.h"

using rapidjson::Value;

namespace
{

/// Returns null when there is no such member or it is not a string.
const char* FindText(const Value& entry, const char* name)
{
    const Value* text = FindMember(entry, name);
    return text != nullptr && text->IsString() ? CStringOf(*text) : nullptr;
}

/// Returns nothing when the link or the title is missing or is not a string.
std::optional<EntryKey> KeyOf(const Value& entry)
{
    const char* const link = FindText(entry, "link");
    const char* const title = FindText(entry, "title");
    return link != nullptr && title != nullptr ? std::optional(EntryKey{link, title}) : std::nullopt;
}

/// Returns nothing for an entry without a link, a title or children: it is the same as no other.
std::optional<std::uint64_t> HashOf(const Value& entry)
{
    const std::optional<EntryKey> key = KeyOf(entry);
    if (!key || FindMember(entry, "children") == nullptr)
    {
        return std::nullopt;
    }
    // Without the factor, an entry would share its hash with one whose link and title are swapped.
    return 31 * KeyedHash(key->link) + KeyedHash(key->title);
}

/// Returns the children of the first entry of list that is the same as entry. If there is none, moves entry
/// to the end of the list and returns null.
Value* FindChildrenOrAppend(PositionTable& siblings, Value& list, Value& entry,
                            rapidjson::Document::AllocatorType& allocator)
{
    siblings.CatchUp(
        list.Size(), [&](std::uint32_t i) { return HashOf(list[i]); },
        [&](std::uint32_t i, std::uint32_t j) { return HasSameLinkAndTitle(list[i], list[j]); });
    const std::optional<std::uint64_t> hash = HashOf(entry);
    const std::uint32_t position =
        siblings.Find(hash, [&](std::uint32_t i) { return HasSameLinkAndTitle(list[i], entry); });
    if (position != PositionTable::kNotFound)
    {
        return &list[position]["children"];
    }
    list.PushBack(entry, allocator);
    siblings.Add(hash);
    return nullptr;
}

} // namespace

bool HasSameLinkAndTitle(const Value& a, const Value& b)
{
    const std::optional<EntryKey> key = KeyOf(a);
    const std::optional<EntryKey> other = KeyOf(b);
    return key && other && *key == *other;
}

void TocMerge::AppendValue(Value& destination, Value& source)
{
    if (source.IsArray())
    {
        AppendList(destination, source);
    }
    else if (source.IsObject())
    {
        AppendNode(destination, source);
    }
}

void TocMerge::AppendNode(Value& destination, Value& source)
{
    if (FindMember(destination, "link") == nullptr || FindMember(destination, "title") == nullptr)
    {
        destination = source; // the first root is taken over whole, with members that nobody knows
    }
    else if (HasSameLinkAndTitle(destination, source))
    {
        AppendValue(destination["children"], source["children"]);
    }
    // A root with another link or title is dropped: there is only one, and the first module decides.
}

void TocMerge::AppendList(Value& destination, Value& source)
{
    if (!destination.IsArray())
    {
        // A leaf takes the whole list over as it is, twins and all. Only into a list, even an empty one, do
        // entries go one by one, so that twins become one.
        destination = DeepCopy(source, m_combined.GetAllocator());
        return;
    }
    PositionTable& siblings = m_siblings[&destination];
    for (Value& entry : source.GetArray())
    {
        if (Value* children = FindChildrenOrAppend(siblings, destination, entry, m_combined.GetAllocator()))
        {
            AppendValue(*children, entry["children"]);
        }
    }
}
