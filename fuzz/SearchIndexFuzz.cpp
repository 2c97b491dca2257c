#include "Tools/DocTools/VantorPagemeld/IndexCombiner.h"
#include "Tools/DocTools/VantorPagemeld/Json/JsonReader.h"
#include "Tools/DocTools/VantorPagemeld/RapidJsonIoUtil.h"
#include "Tools/DocTools/VantorPagemeld/Script/IndexScript.h"
#include "Tools/DocTools/VantorPagemeld/Structure/IndexStructure.h"
#include "fuzz/Property.h"
#include "fuzz/ScriptForm.h"
#include "tests/support/PlainMerge.h"

#include <list>

// Search indexes that pass the structure check merge as a plain linear merge has it, and both writers say
// what the merged one holds. The first module is a fixed one.

namespace
{

using rapidjson::Value;

constexpr const char* kFirstModule = R"({"pages":[["a.html","A \"quoted\" \\ title"],["b\"c\\.html",""]],)"
                                     R"("info":[["text",0],["",1]],"common":{},)"
                                     R"("searchIndex":{"a":[0,1],"b":[1],"":[],"b":[0]}})";

bool IsSound(const Value& document)
{
    int faults = 0;
    Require(CheckIndexStructure(document, [&](const StructureFault&, const JsonPlace& place)
                                { return (void)place.ToPointer(), ++faults > 0; }),
            "a check that is told to go on does");
    const bool sound =
        CheckIndexStructure(document, [](const StructureFault&, const JsonPlace&) { return false; });
    Require(sound == (faults == 0), "the first fault and all faults agree");
    return sound;
}

void RequireWritersAgree(const Value& merged)
{
    RequireReadsBack(merged, RapidJsonIoUtil::RenderPrettyJson(merged).GetString());
    Require(IsIndexScript(TextOf(RenderIndexScript(merged)), merged), "the script has its form");
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    std::vector<std::string> texts = SplitInput(data, size);
    texts.insert(texts.begin(), kFirstModule);

    std::list<rapidjson::Document> documents; // they hold the values of the merged one
    IndexCombiner combiner;
    PlainIndexMerge plain;
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
    Require(moduleIndex > 0, "the fixed module is sound");
    Require(IsSameValue(combiner.combinedDocument, plain.Merged()), "the merge equals the plain one");
    RequireWritersAgree(combiner.combinedDocument);
    return 0;
}
