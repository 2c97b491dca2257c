#include "Tools/DocTools/VantorPagemeld/TocCombiner.h"

#include "Tools/DocTools/VantorPagemeld/Check/TocStructure.h"
#include "Tools/DocTools/VantorPagemeld/RapidJsonIoUtil.h"
#include "Tools/DocTools/VantorPagemeld/Read/JsonDocument.h"
#include "Tools/DocTools/VantorPagemeld/System/Diagnostics.h"

namespace
{

constexpr Diagnostics kDiagnostics("./Tools/DocTools/VantorPagemeld/TocCombiner");

void ReportUnopened(const char* path)
{
    kDiagnostics.Error(314, "Failed to open output file %s\n", path);
}

} // namespace

TocCombiner::TocCombiner()
{
    if (!RapidJsonIoUtil::TryGetJsonDocFromString(defaultJson.c_str(), combinedDocument))
    {
        kDiagnostics.CriticalAndExit(17, "Failed to initialize the base JSON object\n");
    }
}

bool TocCombiner::VerifyJSONStructure(const rapidjson::Value& node)
{
    return CheckTocNode(
        node, JsonPointer(), [](const FoundFault& found) { return WarnAndStop(kDiagnostics, found); },
        [this](const rapidjson::Value& child, const JsonPointer&) { return VerifyJSONStructure(child); });
}

void TocCombiner::AppendJsonDocument(rapidjson::Document& document)
{
    if (!ContinuesMerging(document))
    {
        m_merge.emplace(combinedDocument);
    }
    m_merge->Append(document);
}

void TocCombiner::AddModuleIndexToEachEntry(rapidjson::Document& document, int moduleIndex)
{
    AddPlatformPrefixToLinks(document, moduleIndex);
}

bool TocCombiner::OutputJsonValueAsJs(const char* modulePath, const rapidjson::Document& document,
                                      const char* outputPath)
{
    if (FindMember(document, "link") == nullptr || FindMember(document, "title") == nullptr)
    {
        return false;
    }
    return ScriptOutput(document).Write(outputPath, PrefixLines(modulePath));
}

SharedOutput TocCombiner::ScriptOutput(const rapidjson::Document& document) const
{
    return {{ReportUnopened, false}, RenderTocScript(document, m_layout)};
}

bool TocCombiner::SameLinkAndTitle(rapidjson::Value& a, rapidjson::Value& b)
{
    return HasSameLinkAndTitle(a, b);
}

void TocCombiner::AppendJsonValue(rapidjson::Value& destination, rapidjson::Value& source)
{
    // By a merge of its own: these may be any values, which change between calls.
    TocMerge(combinedDocument).AppendValue(destination, source);
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
        // An input may bring a "module" of its own, on purpose without a check: the first one counts.
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
    TextBuffer script;
    AppendTocString(script, text, extra, indent, newLine, m_layout);
    return WriteText(file, TextOf(script));
}

bool TocCombiner::OutputValueAsJs(std::FILE* file, const rapidjson::Value& value, int indent)
{
    TextBuffer script;
    AppendTocValue(script, value, indent, m_layout);
    return WriteText(file, TextOf(script));
}
