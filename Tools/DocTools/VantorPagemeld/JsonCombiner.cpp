#include "Tools/DocTools/VantorPagemeld/JsonCombiner.h"

#include "Tools/DocTools/VantorPagemeld/RapidJsonIoUtil.h"
#include "Tools/DocTools/VantorPagemeld/Script/RelativePrefix.h"

JsonCombiner::JsonCombiner() : defaultJson("{}") {}

JsonCombiner::~JsonCombiner()
{
    moduleDocuments.clear();
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
    for (const std::string& modulePath : modulePaths)
    {
        rapidjson::Document& document = *moduleDocuments.emplace_back(
            std::make_unique<rapidjson::Document>(&modulePools.emplace_back().allocator));
        const std::string filePath = modulePath + "/" + fileName;
        if (!RapidJsonIoUtil::TryGetJsonDocFromFile(filePath.c_str(), document) ||
            !VerifyJSONStructure(document))
        {
            continue;
        }
        SetModulePathAtIndex(nextModuleIndex, modulePath + "/");
        AddModuleIndexToEachEntry(document, nextModuleIndex);
        AppendJsonDocument(document);
        ++nextModuleIndex;
    }
    return nextModuleIndex > 0;
}

void JsonCombiner::SetModulePathAtIndex(int moduleIndex, const std::string& path)
{
    modulePathTable[moduleIndex] = path;
}

bool JsonCombiner::OutputPrefixVars(const char* modulePath, std::FILE* stream) const
{
    for (const auto& [moduleIndex, path] : modulePathTable)
    {
        const std::string prefix = RelativePrefix(modulePath, path);
        if (std::fprintf(stream, "var p%d = \"%s\";\n", moduleIndex, prefix.c_str()) < 0)
        {
            return false;
        }
    }
    return true;
}

bool JsonCombiner::WriteScript(const char* modulePath, const RenderedText& script, std::FILE* stream) const
{
    return OutputPrefixVars(modulePath, stream) && WriteText(stream, TextOf(script));
}
