#pragma once

#include "Tools/DocTools/VantorPagemeld/JsonCombiner.h"
#include "Tools/DocTools/VantorPagemeld/Merge/IndexMerge.h"
#include "Tools/DocTools/VantorPagemeld/Write/SharedOutput.h"

#include <optional>

/// Merges the search indexes of all modules. Pages and infos are appended, the numbers that point to them
/// re-based; a term that several modules use holds the numbers of the first, then those of the second, and so
/// on.
class IndexCombiner : public JsonCombiner
{
public:
    /// Starts with an empty search index.
    IndexCombiner();

    bool VerifyJSONStructure(const rapidjson::Value& document) override;

    /// Trusts that the document passed VerifyJSONStructure. The combined common words are those of the first
    /// module that has any; those of later modules are deliberately ignored.
    void AppendJsonDocument(rapidjson::Document& document) override;

    /// Appends the module index to every page entry, with the document's own allocator.
    void AddModuleIndexToEachEntry(rapidjson::Document& document, int moduleIndex) override;

    /// Ends the process with status 255 when the file can't be opened.
    bool OutputJsonValueAsJs(const char* modulePath, const rapidjson::Document& document,
                             const char* outputPath) override;

    /// Returns what OutputJsonValueAsJs writes after the prefix lines, for many files.
    [[nodiscard]] SharedOutput ScriptOutput(const rapidjson::Document& document) const;

    /// Moves the entries of input to the end of combined, their page numbers raised by pageOffset.
    void CombineInfoJson(rapidjson::Value& combined, rapidjson::Value& input, int pageOffset);

    /// Moves the terms of input into combined, their info numbers raised by infoOffset. New terms go to the
    /// end, in their order.
    void CombineSearchIndexJson(rapidjson::Value& combined, rapidjson::Value& input, int infoOffset);

private:
    LargeObjectPool m_largeObjects;
    std::optional<IndexMerge> m_merge; ///< of the documents that CombineJson merges one after the other
};
