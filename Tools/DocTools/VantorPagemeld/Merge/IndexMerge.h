#pragma once

#include "Tools/DocTools/VantorPagemeld/Merge/ArrayRecycler.h"
#include "Tools/DocTools/VantorPagemeld/Merge/PositionTable.h"

#include <rapidjson/document.h>

#include <cstddef>

/// Memory for the member lists of large objects. It must outlive every use of such an object.
///
/// A pool can grow only its newest block in place. A list that has a pool to itself therefore leaves no
/// outgrown copies, which for a large list would take as much memory as the list itself.
class LargeObjectPool
{
public:
    using Allocator = rapidjson::Document::AllocatorType;

    /// Returns the allocator by which an object of that many members is to grow: this pool's own if there are
    /// many, and otherwise the one given.
    Allocator& AllocatorFor(rapidjson::SizeType memberCount, Allocator& allocator);

private:
    /// Two million members have room in a block; memory is taken as it is used.
    Allocator m_allocator{std::size_t{1} << 26};
};

/// Merges search indexes into a combined one, which grows with its document's allocator. Values are moved, so
/// every input must live as long as the combined document is used.
///
/// Keeps a look-up table from one merge to the next. Meanwhile others may add terms to the combined search
/// index or empty it, but not change or reorder the terms that it has.
class IndexMerge
{
public:
    /// The combined document and the pool must outlive this object.
    IndexMerge(rapidjson::Document& combined, LargeObjectPool& largeObjects)
        : m_combined(combined), m_largeObjects(largeObjects)
    {
    }

    // Without these, clang++ rejects an optional of this class: its implicit copies take no const argument.
    IndexMerge(const IndexMerge&) = delete;
    IndexMerge& operator=(const IndexMerge&) = delete;

    /// Moves all of input except its common words, which are copied if there are none yet.
    void Append(rapidjson::Document& input);

    /// Moves the entries of input to the end of infos, their page numbers raised by pageOffset.
    void AppendInfos(rapidjson::Value& infos, rapidjson::Value& input, int pageOffset);

    /// Moves the terms of input into searchIndex, the same one in each call, their info numbers raised by
    /// infoOffset.
    void AppendTerms(rapidjson::Value& searchIndex, rapidjson::Value& input, int infoOffset);

private:
    rapidjson::Value* FindOrAppend(rapidjson::Value& searchIndex, rapidjson::Value::Member& term);

    rapidjson::Document& m_combined;
    LargeObjectPool& m_largeObjects;
    PositionTable m_terms; ///< by the bytes of their names
    ArrayRecycler m_arrays;
};
