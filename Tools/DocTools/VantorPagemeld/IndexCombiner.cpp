#include "Tools/DocTools/VantorPagemeld/IndexCombiner.h"

#include "Tools/DocTools/VantorPagemeld/Output/Diagnostics.h"
#include "Tools/DocTools/VantorPagemeld/Output/OutputFile.h"
#include "Tools/DocTools/VantorPagemeld/Script/IndexScript.h"
#include "Tools/DocTools/VantorPagemeld/Structure/IndexStructure.h"

#include <algorithm>
#include <cstdint>

namespace
{

constexpr Diagnostics kDiagnostics("./Tools/DocTools/VantorPagemeld/IndexCombiner");

/// Raises a number by a plain 32-bit addition, which wraps around.
void Rebase(rapidjson::Value& number, int offset)
{
    number.SetInt(
        static_cast<int>(static_cast<std::uint32_t>(number.GetInt()) + static_cast<std::uint32_t>(offset)));
}

} // namespace

IndexCombiner::IndexCombiner()
{
    defaultJson = "{\"pages\":[],\n\"info\": [],\n\"common\": {},\n\"searchIndex\": {}}\n";
    if (!InitializeCombinedDocument())
    {
        kDiagnostics.CriticalAndExit(22, "Failed to initialize IndexCombiner with the default JSON\n");
    }
}

bool IndexCombiner::VerifyJSONStructure(const rapidjson::Value& document)
{
    return CheckIndexStructure(document,
                               [](const StructureFault& fault, const JsonPlace&)
                               {
                                   if (fault.text != nullptr)
                                   {
                                       kDiagnostics.Warning(fault.number, "%s\n", fault.text);
                                   }
                                   return false;
                               });
}

void IndexCombiner::AppendJsonDocument(rapidjson::Document& document)
{
    rapidjson::Value& common = combinedDocument["common"];
    if (common.ObjectEmpty())
    {
        common.CopyFrom(document["common"], combinedDocument.GetAllocator());
    }
    rapidjson::Value& pages = combinedDocument["pages"];
    rapidjson::Value& info = combinedDocument["info"];
    const auto pageOffset = static_cast<int>(pages.Size());
    const auto infoOffset = static_cast<int>(info.Size());
    m_lists.MoveElements(pages, document["pages"], combinedDocument.GetAllocator());
    CombineInfoJson(info, document["info"], pageOffset);
    CombineSearchIndexJson(combinedDocument["searchIndex"], document["searchIndex"], infoOffset);
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
    return OutputScript(modulePath, RenderIndexScript(document), outputPath);
}

bool IndexCombiner::OutputScript(const char* modulePath, const RenderedText& script,
                                 const char* outputPath) const
{
    OutputFile file(outputPath);
    if (!file.IsOpen())
    {
        // This message deliberately has no line break.
        kDiagnostics.CriticalAndExit(176, "Unable to open file %s for writing", outputPath);
    }
    return file.Finish(WriteScript(modulePath, script, file.Stream()));
}

void IndexCombiner::CombineInfoJson(rapidjson::Value& combined, rapidjson::Value& input, int pageOffset)
{
    for (rapidjson::Value& entry : input.GetArray())
    {
        Rebase(entry[1], pageOffset);
    }
    m_lists.MoveElements(combined, input, combinedDocument.GetAllocator());
}

void IndexCombiner::CombineSearchIndexJson(rapidjson::Value& combined, rapidjson::Value& input,
                                           int infoOffset)
{
    m_terms.Follow(combined);
    for (auto& term : input.GetObject())
    {
        for (rapidjson::Value& infoNumber : term.value.GetArray())
        {
            Rebase(infoNumber, infoOffset);
        }
        if (rapidjson::Value* known = m_terms.FindOrAppend(term, combinedDocument.GetAllocator()))
        {
            m_lists.MoveElements(*known, term.value, combinedDocument.GetAllocator());
        }
    }
}
