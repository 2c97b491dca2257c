#include "Tools/DocTools/VantorPagemeld/Json/JsonReader.h"
#include "Tools/DocTools/VantorPagemeld/RapidJsonIoUtil.h"
#include "Tools/DocTools/VantorPagemeld/Structure/TocStructure.h"
#include "Tools/DocTools/VantorPagemeld/TocCombiner.h"
#include "fuzz/Property.h"
#include "fuzz/ScriptForm.h"
#include "tests/support/PlainMerge.h"

#include <list>

// Tables of contents that pass the structure check merge as a plain linear merge has it, and both writers say
// what the merged one holds.

namespace
{

using rapidjson::Value;

constexpr const char* kFirstModule =
    R"({"link":"toc","title":"toc","children":[{"link":"null","title":"Classes","children":[)"
    R"({"link":"A","title":"A","children":null},{"link":"a\"\\","title":"\"\\","children":[]}]},)"
    R"({"link":"B","title":"B","module":7,"children":null},{"link":"B","title":"C","children":[]}]})";

bool IsSound(const Value& document)
{
    int faults = 0;
    Require(CheckTocStructure(document, [&](const StructureFault&, const JsonPlace& place)
                              { return (void)place.ToPointer(), ++faults > 0; }),
            "a check that is told to go on does");
    const bool sound =
        CheckTocStructure(document, [](const StructureFault&, const JsonPlace&) { return false; });
    Require(sound == (faults == 0), "the first fault and all faults agree");
    return sound;
}

void RequireWritersAgree(const TocCombiner& combiner)
{
    const Value& merged = combiner.combinedDocument;
    RequireReadsBack(merged, RapidJsonIoUtil::RenderPrettyJson(merged).GetString());
    Require(IsTocScript(TextOf(combiner.RenderScript(merged).value()), merged), "the script has its form");
}

void RequireMergesLikePlain(const std::vector<std::string>& texts)
{
    std::list<rapidjson::Document> documents; // they hold the values of the merged one
    TocCombiner combiner;
    PlainTocMerge plain;
    int moduleIndex = 0;
    for (const std::string& text : texts)
    {
        rapidjson::Document& document = documents.emplace_back();
        if (!ParseJson(text.c_str(), document).IsError() && IsSound(document))
        {
            plain.Append(document, moduleIndex);
            combiner.AddModuleIndexToEachEntry(document, moduleIndex);
            combiner.AppendJsonDocument(document);
            ++moduleIndex;
        }
    }
    Require(IsSameValue(combiner.combinedDocument, plain.Merged()), "the merge equals the plain one");
    if (moduleIndex > 0)
    {
        RequireWritersAgree(combiner);
    }
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    std::vector<std::string> texts = SplitInput(data, size);
    RequireMergesLikePlain(texts);
    texts.insert(texts.begin(), kFirstModule);
    RequireMergesLikePlain(texts);
    return 0;
}
