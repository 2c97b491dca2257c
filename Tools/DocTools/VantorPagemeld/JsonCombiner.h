#pragma once

#include "Tools/DocTools/VantorPagemeld/Read/JsonDocument.h"

#include <rapidjson/document.h>

#include <cstdio>
#include <deque>
#include <list>
#include <map>
#include <memory>
#include <string>
#include <vector>

/// Merges one JSON file of every documentation module into one document.
///
/// Only the derived class knows what the file holds. A combiner is created, combines once, is asked
/// for its outputs and is destroyed; it is used by one thread.
class JsonCombiner
{
public:
    virtual ~JsonCombiner();

    JsonCombiner(const JsonCombiner&) = delete;
    JsonCombiner& operator=(const JsonCombiner&) = delete;

    /// Returns whether a loaded document may be merged, and otherwise reports the first fault. Changes
    /// nothing.
    virtual bool VerifyJSONStructure(const rapidjson::Value& document) = 0;

    /// Merges a verified and tagged document into combinedDocument. Values are moved, so the memory of
    /// document must live as long as this object.
    virtual void AppendJsonDocument(rapidjson::Document& document) = 0;

    /// Tags the entries of a document with the index of the module that it comes from.
    virtual void AddModuleIndexToEachEntry(rapidjson::Document& document, int moduleIndex) = 0;

    /// Writes a combined document as a script for the module at modulePath (without a trailing '/').
    ///
    /// Returns true when every byte reached the file, and otherwise false with the file removed. What happens
    /// when the file can't be opened differs between the derived classes, deliberately.
    virtual bool OutputJsonValueAsJs(const char* modulePath, const rapidjson::Document& document,
                                     const char* outputPath) = 0;

    /// Reads the file of that name below every module path, and merges those that can be read and are sound.
    /// These take the module indices 0, 1, 2, ... in list order. The others are skipped:
    /// TryGetJsonDocFromFile and VerifyJSONStructure report why.
    ///
    /// Returns whether any module was merged. To be called once.
    bool CombineJson(const std::list<std::string>& modulePaths, const std::string& fileName);

    /// Stores a module's path, with its trailing '/', replacing one that may be there.
    void SetModulePathAtIndex(int moduleIndex, const std::string& path);

    /// Returns the prefix lines of the module at modulePath: what RenderPrefixLines makes of the module
    /// paths.
    [[nodiscard]] std::string PrefixLines(const char* modulePath) const;

    /// Writes PrefixLines to the stream. Returns false if not all was written.
    bool OutputPrefixVars(const char* modulePath, std::FILE* stream) const;

protected:
    JsonCombiner();

    /// Parses defaultJson into combinedDocument. Returns whether that succeeded.
    bool InitializeCombinedDocument();

    /// Returns whether CombineJson has merged another document before the one that it merges now. Nothing has
    /// changed combinedDocument since, so look-up tables of the last merge are still valid.
    [[nodiscard]] bool ContinuesMerging() const { return m_continuesMerging; }

    std::map<int, std::string> modulePathTable;
    std::string defaultJson;

    /// One for each of the module documents, whose values it holds.
    std::deque<DocumentPool> modulePools;

    /// Every document that CombineJson tried to read.
    std::vector<std::unique_ptr<rapidjson::Document>> moduleDocuments;

public:
    /// The merged result, to be read only. Its values lie in the module documents' pools too.
    rapidjson::Document combinedDocument;

private:
    bool m_continuesMerging = false;
};
