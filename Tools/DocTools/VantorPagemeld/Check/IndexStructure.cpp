#include "Tools/DocTools/VantorPagemeld/Check/IndexStructure.h"

#include "Tools/DocTools/VantorPagemeld/Read/JsonDocument.h"

#include <algorithm>
#include <cstdint>
#include <iterator>

namespace
{

using rapidjson::Value;
using Member = Value::Member;
using Fault = StructureFault;
using Count = std::int64_t;

/// The size that a missing array is given, so that numbers that refer to it are not reported as well.
constexpr Count kUnbounded = INT64_MAX;

bool IsPair(const Value& entry)
{
    return entry.IsArray() && entry.Size() == 2;
}

/// Compares as an unsigned number: a negative one is out of bounds too.
bool IsBelow(const Value& number, Count count)
{
    return static_cast<std::uint32_t>(number.GetInt()) < count;
}

/// What an entry must fulfil, once it fulfils the requirements before this one. The count is that of the
/// array which a number of the entry points into.
template <typename Entry>
struct Requirement
{
    Fault fault;
    bool (*isMet)(const Entry& entry, Count count);
};

constexpr Requirement<Value> kPage[] = {
    {Fault::PageNotPair, [](const Value& page, Count) { return IsPair(page); }},
    {Fault::PageNotStrings,
     [](const Value& page, Count) { return page[0].IsString() && page[1].IsString(); }},
};

constexpr Requirement<Value> kInfo[] = {
    {Fault::InfoNotPair, [](const Value& info, Count) { return IsPair(info); }},
    {Fault::InfoTextNotString, [](const Value& info, Count) { return info[0].IsString(); }},
    {Fault::InfoPageNotInt, [](const Value& info, Count) { return info[1].IsInt(); }},
    {Fault::InfoPageOutOfBounds,
     [](const Value& info, Count pageCount) { return IsBelow(info[1], pageCount); }},
};

constexpr Requirement<Value> kPosting[] = {
    {Fault::PostingNotInt, [](const Value& posting, Count) { return posting.IsInt(); }},
    {Fault::PostingOutOfBounds, IsBelow},
};

// Keys of parsed text are strings: other keys can only occur in a document that was made by hand.

constexpr Requirement<Member> kCommonWord[] = {
    {Fault::CommonKeyNotString, [](const Member& word, Count) { return word.name.IsString(); }},
    {Fault::CommonValueNotOne,
     [](const Member& word, Count) { return word.value.IsInt() && word.value.GetInt() == 1; }},
};

constexpr Requirement<Member> kTerm[] = {
    {Fault::TermNotString, [](const Member& term, Count) { return term.name.IsString(); }},
    {Fault::TermNotArray, [](const Member& term, Count) { return term.value.IsArray(); }},
};

/// Looks at the requirements from the one at index. They are template arguments, so that the compiler sees
/// the functions that it calls.
template <const auto& requirements, std::size_t index = 0, typename Entry>
std::optional<Fault> FindFault(const Entry& entry, Count count = kUnbounded)
{
    if constexpr (index < std::size(requirements))
    {
        constexpr Requirement<Entry> requirement = requirements[index];
        return requirement.isMet(entry, count) ? FindFault<requirements, index + 1>(entry, count)
                                               : std::optional(requirement.fault);
    }
    return std::nullopt;
}

template <const auto& requirements>
bool CheckEntries(const Value& entries, Count count, const JsonPointer& pointer, const FaultHandler& onFault)
{
    return CheckElements(
        entries, pointer,
        [&](const Value& entry, const JsonPointer& entryPointer)
        { return HandOver(FindFault<requirements>(entry, count), entryPointer, entry, onFault); });
}

bool CheckCommon(const Value& common, const JsonPointer& pointer, const FaultHandler& onFault)
{
    return std::all_of(
        common.MemberBegin(), common.MemberEnd(),
        [&](const Member& word) {
            return HandOver(FindFault<kCommonWord>(word), {pointer, BytesOf(word.name)}, word.value, onFault);
        });
}

bool CheckTerm(const Member& term, Count infoCount, const JsonPointer& pointer, const FaultHandler& onFault)
{
    const std::optional<Fault> fault = FindFault<kTerm>(term);
    return fault ? HandOver(fault, pointer, term.value, onFault)
                 : CheckEntries<kPosting>(term.value, infoCount, pointer, onFault);
}

bool CheckSearchIndex(const Value& searchIndex, Count infoCount, const JsonPointer& pointer,
                      const FaultHandler& onFault)
{
    return std::all_of(searchIndex.MemberBegin(), searchIndex.MemberEnd(),
                       [&](const Member& term) {
                           return CheckTerm(term, infoCount, {pointer, BytesOf(term.name)}, onFault);
                       });
}

struct MemberRow
{
    const char* name;
    rapidjson::Type type;
    Fault notOfType;
};

constexpr MemberRow kMembers[] = {
    {"pages", rapidjson::kArrayType, Fault::PagesNotArray},
    {"info", rapidjson::kArrayType, Fault::InfoNotArray},
    {"common", rapidjson::kObjectType, Fault::CommonNotObject},
    {"searchIndex", rapidjson::kObjectType, Fault::SearchIndexNotObject},
};

Count CountOf(const Value* array)
{
    return array == nullptr ? kUnbounded : array->Size();
}

} // namespace

bool CheckIndexStructure(const Value& document, const FaultHandler& onFault)
{
    const JsonPointer root;
    if (!document.IsObject())
    {
        return HandOver(Fault::NotAnObject, root, document, onFault);
    }
    // The types of all members come before the content of any.
    const Value* members[std::size(kMembers)] = {};
    for (std::size_t i = 0; i < std::size(kMembers); ++i)
    {
        const Value* const member = FindMember(document, kMembers[i].name);
        if (member != nullptr && member->GetType() == kMembers[i].type)
        {
            members[i] = member;
        }
        else if (!HandOverMember(kMembers[i].notOfType, root, document, kMembers[i].name, onFault))
        {
            return false;
        }
    }
    const auto& [pages, info, common, searchIndex] = members;
    return (pages == nullptr || CheckEntries<kPage>(*pages, kUnbounded, {root, "pages"}, onFault)) &&
           (info == nullptr || CheckEntries<kInfo>(*info, CountOf(pages), {root, "info"}, onFault)) &&
           (common == nullptr || CheckCommon(*common, {root, "common"}, onFault)) &&
           (searchIndex == nullptr ||
            CheckSearchIndex(*searchIndex, CountOf(info), {root, "searchIndex"}, onFault));
}
