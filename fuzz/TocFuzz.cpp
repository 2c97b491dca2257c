#include "Tools/DocTools/VantorPagemeld/RapidJsonIoUtil.h"
#include "Tools/DocTools/VantorPagemeld/Structure/TocStructure.h"
#include "Tools/DocTools/VantorPagemeld/TocCombiner.h"
#include "fuzz/MergeProperty.h"
#include "fuzz/ScriptForm.h"
#include "tests/support/PlainMerge.h"

// Tables of contents that pass the structure check merge as a plain linear merge has it, and both writers say
// what the merged one holds.

namespace
{

using rapidjson::Value;

constexpr const char* kFirstModule =
    R"({"link":"toc","title":"toc","children":[{"link":"null","title":"Classes","children":[)"
    R"({"link":"A","title":"A","children":null},{"link":"a\"\\","title":"\"\\","children":[]}]},)"
    R"({"link":"B","title":"B","module":7,"children":null},{"link":"B","title":"C","children":[]}]})";

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
    const int merged = MergeLikePlain<PlainTocMerge>(combiner, documents, CheckTocStructure, texts);
    if (merged > 0)
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
