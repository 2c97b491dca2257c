#include "Tools/DocTools/VantorPagemeld/Check/IndexStructure.h"

#include "Tools/DocTools/VantorPagemeld/Read/JsonDocument.h"

#include <cstdint>
#include <optional>
#include <utility>

namespace
{

using rapidjson::SizeType;
using rapidjson::Value;

// Deliberately reported without a message.
constexpr StructureFault kNotAnObject = {0, nullptr};

constexpr StructureFault kPagesNotArray = {290, "Pages is not an array or absent"};
constexpr StructureFault kInfoNotArray = {296, "Info is not an array or absent"};
constexpr StructureFault kCommonNotObject = {302, "Common is not an object or absent"};
constexpr StructureFault kSearchIndexNotObject = {308, "SearchIndex is not an object or absent"};
constexpr StructureFault kPageNotPair = {318, "Content in pages is not an array of 2 elements"};
constexpr StructureFault kPageNotStrings = {327, "Content in pages sub-element is not a string"};
constexpr StructureFault kInfoNotPair = {340, "Content in info is not an array of 2 elements"};
constexpr StructureFault kInfoTextNotString = {345, "1st item in info sub-element is not a string"};
constexpr StructureFault kInfoPageNotInt = {350, "2nd item in info sub-element is not an int"};
constexpr StructureFault kInfoPageOutOfBounds = {356, "2nd item in info sub-element is out of bounds"};
// Keys of parsed text are strings: 366 and 382 can only occur in a document that was made by hand.
constexpr StructureFault kCommonKeyNotString = {366, "Key in common is not a string"};
constexpr StructureFault kCommonValueNotOne = {371, "Value in common is not an int(1)"};
constexpr StructureFault kTermNotString = {382, "Key in searchIndex is not string"};
constexpr StructureFault kTermNotArray = {387, "Value in searchIndex is not array"};
constexpr StructureFault kPostingNotInt = {396, "Value in index is not int"};
constexpr StructureFault kPostingOutOfBounds = {401, "Value in index is out of bounds"};

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
        return kPageNotPair;
    }
    if (!page[0].IsString() || !page[1].IsString())
    {
        return kPageNotStrings;
    }
    return std::nullopt;
}

std::optional<StructureFault> FindInfoFault(const Value& entry, std::int64_t pageCount)
{
    if (!IsPair(entry))
    {
        return kInfoNotPair;
    }
    if (!entry[0].IsString())
    {
        return kInfoTextNotString;
    }
    if (!entry[1].IsInt())
    {
        return kInfoPageNotInt;
    }
    if (!IsBelow(entry[1], pageCount))
    {
        return kInfoPageOutOfBounds;
    }
    return std::nullopt;
}

std::optional<StructureFault> FindCommonFault(const Value::Member& word)
{
    if (!word.name.IsString())
    {
        return kCommonKeyNotString;
    }
    if (!word.value.IsInt() || word.value.GetInt() != 1)
    {
        return kCommonValueNotOne;
    }
    return std::nullopt;
}

std::optional<StructureFault> FindTermFault(const Value::Member& term)
{
    if (!term.name.IsString())
    {
        return kTermNotString;
    }
    if (!term.value.IsArray())
    {
        return kTermNotArray;
    }
    return std::nullopt;
}

std::optional<StructureFault> FindPostingFault(const Value& posting, std::int64_t infoCount)
{
    if (!posting.IsInt())
    {
        return kPostingNotInt;
    }
    if (!IsBelow(posting, infoCount))
    {
        return kPostingOutOfBounds;
    }
    return std::nullopt;
}

bool CheckPages(const Value& pages, const JsonPointer& pointer, const FaultHandler& onFault)
{
    for (SizeType i = 0; i < pages.Size(); ++i)
    {
        const auto fault = FindPageFault(pages[i]);
        if (fault && !onFault(*fault, {pointer, i}, pages[i]))
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
        const auto fault = FindInfoFault(info[i], pageCount);
        if (fault && !onFault(*fault, {pointer, i}, info[i]))
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
        const auto fault = FindCommonFault(word);
        if (fault && !onFault(*fault, {pointer, BytesOf(word.name)}, word.value))
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
        const auto fault = FindPostingFault(postings[i], infoCount);
        if (fault && !onFault(*fault, {pointer, i}, postings[i]))
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
        if (fault ? !onFault(*fault, termPointer, term.value)
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
bool RequireMember(const Value& document, const char* name, rapidjson::Type type,
                   const StructureFault& notOfType, const FaultHandler& onFault, const Value*& found)
{
    const JsonPointer root;
    found = FindMember(document, name);
    if (found == nullptr)
    {
        return onFault(notOfType, root, document);
    }
    if (found->GetType() == type)
    {
        return true;
    }
    const Value& mistyped = *std::exchange(found, nullptr);
    return onFault(notOfType, {root, name}, mistyped);
}

} // namespace

bool CheckIndexStructure(const Value& document, const FaultHandler& onFault)
{
    const JsonPointer root;
    if (!document.IsObject())
    {
        return onFault(kNotAnObject, root, document);
    }
    const Value* pages = nullptr;
    const Value* info = nullptr;
    const Value* common = nullptr;
    const Value* searchIndex = nullptr;
    return RequireMember(document, "pages", rapidjson::kArrayType, kPagesNotArray, onFault, pages) &&
           RequireMember(document, "info", rapidjson::kArrayType, kInfoNotArray, onFault, info) &&
           RequireMember(document, "common", rapidjson::kObjectType, kCommonNotObject, onFault, common) &&
           RequireMember(document, "searchIndex", rapidjson::kObjectType, kSearchIndexNotObject, onFault,
                         searchIndex) &&
           (pages == nullptr || CheckPages(*pages, {root, "pages"}, onFault)) &&
           (info == nullptr || CheckInfo(*info, CountOf(pages), {root, "info"}, onFault)) &&
           (common == nullptr || CheckCommon(*common, {root, "common"}, onFault)) &&
           (searchIndex == nullptr ||
            CheckSearchIndex(*searchIndex, CountOf(info), {root, "searchIndex"}, onFault));
}
