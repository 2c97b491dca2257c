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
    /// Sets defaultJson to an empty object. A derived class parses it, or its own, into combinedDocument.
    JsonCombiner();

    /// Returns whether document follows, in the same call of CombineJson, the one that was passed here last.
    ///
    /// Look-up tables can be kept only then: in between, nobody but overrides had a chance to change
    /// combinedDocument. Before and after CombineJson its caller may change anything.
    [[nodiscard]] bool ContinuesMerging(const rapidjson::Document& document);

    std::map<int, std::string> modulePathTable;
    std::string defaultJson;

    /// One for each of the module documents, whose values it holds.
    std::deque<DocumentPool> modulePools;

    /// Every document that CombineJson tried to read.
    std::vector<std::unique_ptr<rapidjson::Document>> moduleDocuments;

public:
    /// The merged result. Its values lie in the module documents' pools too. While CombineJson runs,
    /// overrides may add to it, as the operations of the derived classes do, but not change what it holds.
    rapidjson::Document combinedDocument;

private:
    /// Whether the document that was last passed to ContinuesMerging is of the running call of CombineJson.
    bool m_hasMerged = false;
};
