#include "Tools/DocTools/VantorPagemeld/Check/IndexStructure.h"

#include "Tools/DocTools/VantorPagemeld/Read/JsonDocument.h"

#include <cstdint>

namespace
{

using rapidjson::SizeType;
using rapidjson::Value;

/// The size that a missing array is given, so that numbers that refer to it are not reported as well.
constexpr std::int64_t kUnbounded = INT64_MAX;

bool IsPair(const Value& entry)
{
    return entry.IsArray() && entry.Size() == 2;
}

/// Compares as an unsigned number: a negative one is out of bounds too.
bool IsBelow(const Value& number, std::int64_t count)
{
    return static_cast<std::uint32_t>(number.GetInt()) < count;
}

std::optional<StructureFault> FindPageFault(const Value& page)
{
    if (!IsPair(page))
    {
        return StructureFault::PageNotPair;
    }
    if (!page[0].IsString() || !page[1].IsString())
    {
        return StructureFault::PageNotStrings;
    }
    return std::nullopt;
}

std::optional<StructureFault> FindInfoFault(const Value& entry, std::int64_t pageCount)
{
    if (!IsPair(entry))
    {
        return StructureFault::InfoNotPair;
    }
    if (!entry[0].IsString())
    {
        return StructureFault::InfoTextNotString;
    }
    if (!entry[1].IsInt())
    {
        return StructureFault::InfoPageNotInt;
    }
    if (!IsBelow(entry[1], pageCount))
    {
        return StructureFault::InfoPageOutOfBounds;
    }
    return std::nullopt;
}

// Keys of parsed text are strings: other keys can only occur in a document that was made by hand.

std::optional<StructureFault> FindCommonFault(const Value::Member& word)
{
    if (!word.name.IsString())
    {
        return StructureFault::CommonKeyNotString;
    }
    if (!word.value.IsInt() || word.value.GetInt() != 1)
    {
        return StructureFault::CommonValueNotOne;
    }
    return std::nullopt;
}

std::optional<StructureFault> FindTermFault(const Value::Member& term)
{
    if (!term.name.IsString())
    {
        return StructureFault::TermNotString;
    }
    if (!term.value.IsArray())
    {
        return StructureFault::TermNotArray;
    }
    return std::nullopt;
}

std::optional<StructureFault> FindPostingFault(const Value& posting, std::int64_t infoCount)
{
    if (!posting.IsInt())
    {
        return StructureFault::PostingNotInt;
    }
    if (!IsBelow(posting, infoCount))
    {
        return StructureFault::PostingOutOfBounds;
    }
    return std::nullopt;
}

bool CheckPages(const Value& pages, const JsonPointer& pointer, const FaultHandler& onFault)
{
    for (SizeType i = 0; i < pages.Size(); ++i)
    {
        if (!HandOver(FindPageFault(pages[i]), {pointer, i}, pages[i], onFault))
        {
            return false;
        }
    }
    return true;
}

bool CheckInfo(const Value& info, std::int64_t pageCount, const JsonPointer& pointer,
               const FaultHandler& onFault)
{
    for (SizeType i = 0; i < info.Size(); ++i)
    {
        if (!HandOver(FindInfoFault(info[i], pageCount), {pointer, i}, info[i], onFault))
        {
            return false;
        }
    }
    return true;
}

bool CheckCommon(const Value& common, const JsonPointer& pointer, const FaultHandler& onFault)
{
    for (const auto& word : common.GetObject())
    {
        if (!HandOver(FindCommonFault(word), {pointer, BytesOf(word.name)}, word.value, onFault))
        {
            return false;
        }
    }
    return true;
}

bool CheckPostings(const Value& postings, std::int64_t infoCount, const JsonPointer& pointer,
                   const FaultHandler& onFault)
{
    for (SizeType i = 0; i < postings.Size(); ++i)
    {
        if (!HandOver(FindPostingFault(postings[i], infoCount), {pointer, i}, postings[i], onFault))
        {
            return false;
        }
    }
    return true;
}

bool CheckSearchIndex(const Value& searchIndex, std::int64_t infoCount, const JsonPointer& pointer,
                      const FaultHandler& onFault)
{
    for (const auto& term : searchIndex.GetObject())
    {
        const JsonPointer termPointer(pointer, BytesOf(term.name));
        const auto fault = FindTermFault(term);
        if (fault ? !HandOver(fault, termPointer, term.value, onFault)
                  : !CheckPostings(term.value, infoCount, termPointer, onFault))
        {
            return false;
        }
    }
    return true;
}

std::int64_t CountOf(const Value* array)
{
    return array == nullptr ? kUnbounded : array->Size();
}

/// Looks for a member of a type. Sets found to it, or to null after handing over the fault. Returns whether
/// to go on.
bool RequireMember(const Value& document, const char* name, rapidjson::Type type, StructureFault notOfType,
                   const FaultHandler& onFault, const Value*& found)
{
    found = FindMember(document, name);
    if (found != nullptr && found->GetType() == type)
    {
        return true;
    }
    found = nullptr;
    return HandOverMember(notOfType, JsonPointer(), document, name, onFault);
}

} // namespace

bool CheckIndexStructure(const Value& document, const FaultHandler& onFault)
{
    const JsonPointer root;
    if (!document.IsObject())
    {
        return HandOver(StructureFault::NotAnObject, root, document, onFault);
    }
    const Value* pages = nullptr;
    const Value* info = nullptr;
    const Value* common = nullptr;
    const Value* searchIndex = nullptr;
    // Each step hands over its faults and says whether to go on. One that lacks its member has nothing to
    // look at. The types of all members come before the content of any.
    return RequireMember(document, "pages", rapidjson::kArrayType, StructureFault::PagesNotArray, onFault,
                         pages) &&
           RequireMember(document, "info", rapidjson::kArrayType, StructureFault::InfoNotArray, onFault,
                         info) &&
           RequireMember(document, "common", rapidjson::kObjectType, StructureFault::CommonNotObject, onFault,
                         common) &&
           RequireMember(document, "searchIndex", rapidjson::kObjectType,
                         StructureFault::SearchIndexNotObject, onFault, searchIndex) &&
           (pages == nullptr || CheckPages(*pages, {root, "pages"}, onFault)) &&
           (info == nullptr || CheckInfo(*info, CountOf(pages), {root, "info"}, onFault)) &&
           (common == nullptr || CheckCommon(*common, {root, "common"}, onFault)) &&
           (searchIndex == nullptr ||
            CheckSearchIndex(*searchIndex, CountOf(info), {root, "searchIndex"}, onFault));
}
