#pragma once

#include "Tools/DocTools/VantorPagemeld/JsonCombiner.h"
#include "Tools/DocTools/VantorPagemeld/Merge/TocMerge.h"
#include "Tools/DocTools/VantorPagemeld/Render/TocScript.h"
#include "Tools/DocTools/VantorPagemeld/Write/SharedOutput.h"

#include <optional>

/// Merges the tables of contents of all modules. Entries of one list that have the same link and title become
/// one; new ones go to the end of the list in the order of the modules.
class TocCombiner : public JsonCombiner
{
public:
    /// Starts with an empty object.
    TocCombiner();

    /// Checks the node and, by calling itself, everything below it.
    bool VerifyJSONStructure(const rapidjson::Value& node) override;

    /// Trusts that the document passed VerifyJSONStructure. The first document becomes the combined one; a
    /// later one whose root has another link or title is deliberately dropped without a message.
    void AppendJsonDocument(rapidjson::Document& document) override;

    /// Adds a "module" member to every node, with the combined document's allocator.
    void AddModuleIndexToEachEntry(rapidjson::Document& document, int moduleIndex) override;

    /// Reports an error and returns false when the file can't be opened. Returns false without a message and
    /// without a file when the root has no link or no title.
    bool OutputJsonValueAsJs(const char* modulePath, const rapidjson::Document& document,
                             const char* outputPath) override;

    /// Returns what OutputJsonValueAsJs writes after the prefix lines, for many files.
    [[nodiscard]] SharedOutput ScriptOutput(const rapidjson::Document& document) const;

    /// Whether two nodes count as the same entry: equal links and equal titles, each as NUL-terminated text.
    bool SameLinkAndTitle(rapidjson::Value& a, rapidjson::Value& b);

    /// Merges source, a node or list of a module document, into destination, which lies in the combined
    /// document.
    void AppendJsonValue(rapidjson::Value& destination, rapidjson::Value& source);

    /// Tags a node or list and everything below it. The links themselves stay as they are, despite the name:
    /// their prefixes differ from one output module to the next and are put before them when the script is
    /// written.
    void AddPlatformPrefixToLinks(rapidjson::Value& value, int moduleIndex);

    /// Writes text in double quotes, with those inside it escaped, and then extra. Returns false if the write
    /// fails.
    bool WriteQuotedStringPlusExtra(std::FILE* file, const char* text, const char* extra, int indent,
                                    bool newLine);

    /// Writes one node, or the nodes of one list, with everything below. Returns false if the write fails.
    bool OutputValueAsJs(std::FILE* file, const rapidjson::Value& value, int indent);

private:
    TocScriptLayout m_layout;
    std::optional<TocMerge> m_merge; ///< of the documents that CombineJson merges one after the other
};
