#pragma once

#include "Tools/DocTools/VantorPagemeld/Json/PoolWithSmallStart.h"
#include "Tools/DocTools/VantorPagemeld/Output/RenderedText.h"

#include <rapidjson/document.h>

#include <cstdio>
#include <deque>
#include <list>
#include <map>
#include <memory>
#include <string>
#include <vector>

/// Merges one JSON file of every documentation module into one document, and writes that as a script.
///
/// What the file holds is the business of the derived class. A combiner is created, combines once, is asked
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
    /// These take the module indices 0, 1, 2, ... in list order; the others are skipped, and their readers
    /// say why.
    ///
    /// Returns whether any module was merged. To be called once.
    bool CombineJson(const std::list<std::string>& modulePaths, const std::string& fileName);

    /// Stores a module's path, with its trailing '/', in the place of one that may be there.
    void SetModulePathAtIndex(int moduleIndex, const std::string& path);

    /// Writes a line for each module that sets its prefix variable to the path from the module at modulePath.
    /// Nothing in a path is escaped. Returns false as soon as a write fails.
    bool OutputPrefixVars(const char* modulePath, std::FILE* stream) const;

protected:
    JsonCombiner();

    /// Parses defaultJson into combinedDocument. Returns whether that succeeded.
    bool InitializeCombinedDocument();

    /// Writes a script for one module: the prefix variables, then what is the same in all modules. Returns
    /// false as soon as a write fails.
    bool WriteScript(const char* modulePath, const RenderedText& script, std::FILE* stream) const;

    std::map<int, std::string> modulePathTable;
    std::string defaultJson;
    std::deque<PoolWithSmallStart>
        modulePools; ///< one for each of the module documents, whose values it holds
    std::vector<std::unique_ptr<rapidjson::Document>>
        moduleDocuments; ///< every one that CombineJson tried to read

public:
    /// The merged result, to be read only. Its values lie in the module documents' pools too.
    rapidjson::Document combinedDocument;
};
