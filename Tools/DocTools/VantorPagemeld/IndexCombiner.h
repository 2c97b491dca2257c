#pragma once

#include "Tools/DocTools/VantorPagemeld/Json/SpareLists.h"
#include "Tools/DocTools/VantorPagemeld/JsonCombiner.h"
#include "Tools/DocTools/VantorPagemeld/Lookup/TermIndex.h"

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

    /// Writes what RenderIndexScript returned for combinedDocument; otherwise as OutputJsonValueAsJs.
    bool OutputScript(const char* modulePath, const RenderedText& script, const char* outputPath) const;

    /// Moves the entries of input behind those of combined, their page numbers raised by pageOffset.
    void CombineInfoJson(rapidjson::Value& combined, rapidjson::Value& input, int pageOffset);

    /// Moves the terms of input into combined, their info numbers raised by infoOffset. New terms go to the
    /// end, in their order.
    void CombineSearchIndexJson(rapidjson::Value& combined, rapidjson::Value& input, int infoOffset);

private:
    TermIndex m_terms;
    SpareLists m_lists;
};
