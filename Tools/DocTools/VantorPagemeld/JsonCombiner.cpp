#include "Tools/DocTools/VantorPagemeld/JsonCombiner.h"

#include "Tools/DocTools/VantorPagemeld/ModuleLayout.h"
#include "Tools/DocTools/VantorPagemeld/RapidJsonIoUtil.h"
#include "Tools/DocTools/VantorPagemeld/Render/ModulePrefix.h"

#include <utility>

JsonCombiner::JsonCombiner() : defaultJson("{}")
{
    // An allocator of the library that has no memory yet crashes when it is asked to grow what another one
    // allocated. Tagging and merging ask for that: lists of the module documents grow in the combined one.
    (void)combinedDocument.GetAllocator().Malloc(1);
}

JsonCombiner::~JsonCombiner()
{
    moduleDocuments.clear(); // before their pools and before combinedDocument, which is declared after them
}

bool JsonCombiner::CombineJson(const std::list<std::string>& modulePaths, const std::string& fileName)
{
    m_hasMerged = false;
    int nextModuleIndex = 0;
    for (const std::string& path : modulePaths)
    {
        const ModulePath modulePath(path);
        rapidjson::Document& document = *moduleDocuments.emplace_back(
            std::make_unique<rapidjson::Document>(&modulePools.emplace_back().allocator));
        if (!RapidJsonIoUtil::TryGetJsonDocFromFile(modulePath.File(fileName).c_str(), document) ||
            !VerifyJSONStructure(document))
        {
            continue;
        }
        SetModulePathAtIndex(nextModuleIndex, modulePath.AsLinkTarget());
        AddModuleIndexToEachEntry(document, nextModuleIndex);
        AppendJsonDocument(document);
        ++nextModuleIndex;
    }
    return nextModuleIndex > 0;
}

bool JsonCombiner::ContinuesMerging(const rapidjson::Document& document)
{
    // Other callers of AppendJsonDocument bring documents of their own.
    const bool isModule = !moduleDocuments.empty() && moduleDocuments.back().get() == &document;
    return std::exchange(m_hasMerged, isModule) && isModule;
}

void JsonCombiner::SetModulePathAtIndex(int moduleIndex, const std::string& path)
{
    modulePathTable[moduleIndex] = path;
}

std::string JsonCombiner::PrefixLines(const char* modulePath) const
{
    return RenderPrefixLines(modulePath, modulePathTable);
}

bool JsonCombiner::OutputPrefixVars(const char* modulePath, std::FILE* stream) const
{
    return WriteText(stream, PrefixLines(modulePath));
}
