#include "Tools/DocTools/VantorPagemeld/TocCombiner.h"

#include "Tools/DocTools/VantorPagemeld/Json/JsonValue.h"
#include "Tools/DocTools/VantorPagemeld/Output/Diagnostics.h"
#include "Tools/DocTools/VantorPagemeld/Output/OutputFile.h"
#include "Tools/DocTools/VantorPagemeld/Structure/TocStructure.h"

#include <cstring>

namespace
{

constexpr Diagnostics kDiagnostics("./Tools/DocTools/VantorPagemeld/TocCombiner");

bool ReportAndStop(const StructureFault& fault, const JsonPlace& /*place*/)
{
    kDiagnostics.Warning(fault.number, "%s\n", fault.text);
    return false;
}

} // namespace

TocCombiner::TocCombiner()
{
    defaultJson = "{}";
    if (!InitializeCombinedDocument())
    {
        kDiagnostics.CriticalAndExit(17, "Failed to initialize the base JSON object\n");
    }
}

bool TocCombiner::VerifyJSONStructure(const rapidjson::Value& node)
{
    return CheckTocNode(node, JsonPlace(), ReportAndStop,
                        [this](const rapidjson::Value& child, const JsonPlace&)
                        { return VerifyJSONStructure(child); });
}

void TocCombiner::AppendJsonDocument(rapidjson::Document& document)
{
    AppendJsonValue(combinedDocument, document);
}

void TocCombiner::AddModuleIndexToEachEntry(rapidjson::Document& document, int moduleIndex)
{
    AddPlatformPrefixToLinks(document, moduleIndex);
}

bool TocCombiner::OutputJsonValueAsJs(const char* modulePath, const rapidjson::Document& document,
                                      const char* outputPath)
{
    return OutputScript(modulePath, RenderScript(document), outputPath);
}

std::optional<RenderedText> TocCombiner::RenderScript(const rapidjson::Value& root) const
{
    return RenderTocScript(root, m_layout);
}

bool TocCombiner::OutputScript(const char* modulePath, const std::optional<RenderedText>& script,
                               const char* outputPath) const
{
    if (!script)
    {
        return false;
    }
    OutputFile file(outputPath);
    if (!file.IsOpen())
    {
        kDiagnostics.Error(314, "Failed to open output file %s\n", outputPath);
        return false;
    }
    return file.Finish(WriteScript(modulePath, *script, file.Stream()));
}

bool TocCombiner::SameLinkAndTitle(rapidjson::Value& a, rapidjson::Value& b)
{
    return std::strcmp(CStringOf(a["link"]), CStringOf(b["link"])) == 0 &&
           std::strcmp(CStringOf(a["title"]), CStringOf(b["title"])) == 0;
}

void TocCombiner::AppendJsonValue(rapidjson::Value& destination, rapidjson::Value& source)
{
    if (source.IsArray())
    {
        AppendList(destination, source);
    }
    else if (source.IsObject())
    {
        AppendNode(destination, source);
    }
}

void TocCombiner::AppendList(rapidjson::Value& destination, rapidjson::Value& source)
{
    if (!destination.IsArray())
    {
        destination.CopyFrom(source, combinedDocument.GetAllocator());
        return;
    }
    SiblingIndex& siblings = m_siblings[&destination];
    siblings.Follow(destination);
    for (rapidjson::Value& entry : source.GetArray())
    {
        if (rapidjson::Value* children =
                siblings.FindChildrenOrAppend(entry, combinedDocument.GetAllocator()))
        {
            AppendJsonValue(*children, entry["children"]);
        }
    }
}

void TocCombiner::AppendNode(rapidjson::Value& destination, rapidjson::Value& source)
{
    if (FindMember(destination, "link") == nullptr || FindMember(destination, "title") == nullptr)
    {
        destination = source;
    }
    else if (SameLinkAndTitle(destination, source))
    {
        AppendJsonValue(destination["children"], source["children"]);
    }
}

void TocCombiner::AddPlatformPrefixToLinks(rapidjson::Value& value, int moduleIndex)
{
    if (value.IsArray())
    {
        for (rapidjson::Value& entry : value.GetArray())
        {
            AddPlatformPrefixToLinks(entry, moduleIndex);
        }
    }
    else if (value.IsObject())
    {
        // An input may bring a "module" of its own; the first one counts, and no check is wanted here.
        value.AddMember("module", moduleIndex, combinedDocument.GetAllocator());
        if (rapidjson::Value* children = FindMember(value, "children"))
        {
            AddPlatformPrefixToLinks(*children, moduleIndex);
        }
    }
}

bool TocCombiner::WriteQuotedStringPlusExtra(std::FILE* file, const char* text, const char* extra, int indent,
                                             bool newLine)
{
    RenderedText script;
    AppendTocString(script, text, extra, indent, newLine, m_layout);
    return WriteText(file, TextOf(script));
}

bool TocCombiner::OutputValueAsJs(std::FILE* file, const rapidjson::Value& value, int indent)
{
    RenderedText script;
    AppendTocValue(script, value, indent, m_layout);
    return WriteText(file, TextOf(script));
}
