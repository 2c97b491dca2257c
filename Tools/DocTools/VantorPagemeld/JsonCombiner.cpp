#include "Tools/DocTools/VantorPagemeld/JsonCombiner.h"

#include "Tools/DocTools/VantorPagemeld/ModulePath.h"
#include "Tools/DocTools/VantorPagemeld/RapidJsonIoUtil.h"
#include "Tools/DocTools/VantorPagemeld/Render/ModulePrefix.h"

JsonCombiner::JsonCombiner() : defaultJson("{}") {}

JsonCombiner::~JsonCombiner()
{
    moduleDocuments.clear(); // before their pools and before combinedDocument, which is declared after them
}

bool JsonCombiner::InitializeCombinedDocument()
{
    // The library's allocator crashes when it is asked to grow what another one allocated while it has no
    // memory of its own yet; tagging and merging do just that.
    (void)combinedDocument.GetAllocator().Malloc(1);
    return RapidJsonIoUtil::TryGetJsonDocFromString(defaultJson.c_str(), combinedDocument);
}

bool JsonCombiner::CombineJson(const std::list<std::string>& modulePaths, const std::string& fileName)
{
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
        m_continuesMerging = true;
    }
    m_continuesMerging = false;
    return nextModuleIndex > 0;
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
