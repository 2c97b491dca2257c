#include "Tools/DocTools/VantorPagemeld/IndexCombiner.h"

#include "Tools/DocTools/VantorPagemeld/Check/IndexStructure.h"
#include "Tools/DocTools/VantorPagemeld/Render/IndexScript.h"
#include "Tools/DocTools/VantorPagemeld/System/Messages.h"

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

bool ReportAndStop(const StructureFault& fault, const JsonPointer& /*pointer*/,
                   const rapidjson::Value& /*value*/)
{
    if (fault.text != nullptr)
    {
        kDiagnostics.Warning(fault.number, "%s\n", fault.text);
    }
    return false;
}

void EndRun(const char* path)
{
    // This message deliberately has no line break.
    kDiagnostics.CriticalAndExit(176, "Unable to open file %s for writing", path);
}

} // namespace

const OutputKind IndexCombiner::kScriptFile = {EndRun, false};

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
    return CheckIndexStructure(document, ReportAndStop);
}

void IndexCombiner::AppendJsonDocument(rapidjson::Document& document)
{
    if (!ContinuesMerging())
    {
        m_merge = std::make_unique<Merge>(combinedDocument["searchIndex"], m_largeObjects);
    }
    rapidjson::Value& common = combinedDocument["common"];
    if (common.ObjectEmpty())
    {
        common.CopyFrom(document["common"], combinedDocument.GetAllocator());
    }
    rapidjson::Value& pages = combinedDocument["pages"];
    rapidjson::Value& info = combinedDocument["info"];
    const auto pageOffset = static_cast<int>(pages.Size());
    const auto infoOffset = static_cast<int>(info.Size());
    m_merge->arrays.MoveElements(pages, document["pages"], combinedDocument.GetAllocator());
    MoveInfo(m_merge->arrays, info, document["info"], pageOffset);
    MoveTerms(*m_merge, document["searchIndex"], infoOffset);
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
    SharedText script(RenderIndexScript(document));
    return WriteOutput(outputPath, PrefixLines(modulePath), script, kScriptFile);
}

void IndexCombiner::CombineInfoJson(rapidjson::Value& combined, rapidjson::Value& input, int pageOffset)
{
    ArrayRecycler arrays;
    MoveInfo(arrays, combined, input, pageOffset);
}

void IndexCombiner::CombineSearchIndexJson(rapidjson::Value& combined, rapidjson::Value& input,
                                           int infoOffset)
{
    Merge merge(combined, m_largeObjects);
    MoveTerms(merge, input, infoOffset);
}

void IndexCombiner::MoveInfo(ArrayRecycler& arrays, rapidjson::Value& combined, rapidjson::Value& input,
                             int pageOffset)
{
    for (rapidjson::Value& entry : input.GetArray())
    {
        Rebase(entry[1], pageOffset);
    }
    arrays.MoveElements(combined, input, combinedDocument.GetAllocator());
}

void IndexCombiner::MoveTerms(Merge& merge, rapidjson::Value& input, int infoOffset)
{
    for (auto& term : input.GetObject())
    {
        for (rapidjson::Value& infoNumber : term.value.GetArray())
        {
            Rebase(infoNumber, infoOffset);
        }
        if (rapidjson::Value* known = merge.terms.FindOrAppend(term, combinedDocument.GetAllocator()))
        {
            merge.arrays.MoveElements(*known, term.value, combinedDocument.GetAllocator());
        }
    }
}
