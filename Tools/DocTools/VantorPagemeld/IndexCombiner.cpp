#include "Tools/DocTools/VantorPagemeld/IndexCombiner.h"

#include "Tools/DocTools/VantorPagemeld/Check/IndexStructure.h"
#include "Tools/DocTools/VantorPagemeld/RapidJsonIoUtil.h"
#include "Tools/DocTools/VantorPagemeld/Render/IndexScript.h"
#include "Tools/DocTools/VantorPagemeld/System/Diagnostics.h"

namespace
{

constexpr Diagnostics kDiagnostics("./Tools/DocTools/VantorPagemeld/IndexCombiner");

void EndRun(const char* path)
{
    // This message deliberately has no line break.
    kDiagnostics.CriticalAndExit(176, "Unable to open file %s for writing", path);
}

} // namespace

IndexCombiner::IndexCombiner()
{
    defaultJson = "{\"pages\":[],\n\"info\": [],\n\"common\": {},\n\"searchIndex\": {}}\n";
    if (!RapidJsonIoUtil::TryGetJsonDocFromString(defaultJson.c_str(), combinedDocument))
    {
        kDiagnostics.CriticalAndExit(22, "Failed to initialize IndexCombiner with the default JSON\n");
    }
}

bool IndexCombiner::VerifyJSONStructure(const rapidjson::Value& document)
{
    return CheckIndexStructure(document,
                               [](const FoundFault& found) { return WarnAndStop(kDiagnostics, found); });
}

void IndexCombiner::AppendJsonDocument(rapidjson::Document& document)
{
    if (!ContinuesMerging(document))
    {
        m_merge.emplace(combinedDocument, m_largeObjects);
    }
    m_merge->Append(document);
}

void IndexCombiner::AddModuleIndexToEachEntry(rapidjson::Document& document, int moduleIndex)
{
    for (rapidjson::Value& page : document["pages"].GetArray())
    {
        page.PushBack(moduleIndex, document.GetAllocator());
    }
}

bool IndexCombiner::OutputJsonValueAsJs(const char* modulePath, const rapidjson::Document& document,
                                        const char* outputPath)
{
    return ScriptOutput(document).Write(outputPath, PrefixLines(modulePath));
}

SharedOutput IndexCombiner::ScriptOutput(const rapidjson::Document& document) const
{
    return {{EndRun, false}, RenderIndexScript(document)};
}

void IndexCombiner::CombineInfoJson(rapidjson::Value& combined, rapidjson::Value& input, int pageOffset)
{
    // By a merge of its own, as below: these may be any values, which change between calls.
    IndexMerge(combinedDocument, m_largeObjects).AppendInfos(combined, input, pageOffset);
}

void IndexCombiner::CombineSearchIndexJson(rapidjson::Value& combined, rapidjson::Value& input,
                                           int infoOffset)
{
    IndexMerge(combinedDocument, m_largeObjects).AppendTerms(combined, input, infoOffset);
}
