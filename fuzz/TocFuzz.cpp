#include "Tools/DocTools/VantorPagemeld/Check/TocStructure.h"
#include "Tools/DocTools/VantorPagemeld/TocCombiner.h"
#include "fuzz/MergeProperty.h"
#include "fuzz/ScriptForm.h"
#include "tests/support/PlainMerge.h"

// Tables of contents that pass the structure check merge as a plain linear merge has it, and both writers
// write what the merged one holds.

namespace
{

using rapidjson::Value;

constexpr const char* kFirstModule =
    R"({"link":"toc","title":"toc","children":[{"link":"null","title":"Classes","children":[)"
    R"({"link":"A","title":"A","children":null},{"link":"a\"\\","title":"\"\\","children":[]}]},)"
    R"({"link":"B","title":"B","module":7,"children":null},{"link":"B","title":"C","children":[]}]})";

void RequireWritersAgree(const Value& merged)
{
    RequireReadsBack(merged, RenderPrettyJson(merged).GetString());
    Require(merged.ObjectEmpty() || IsTocScript(TextOf(RenderTocScript(merged)), merged),
            "the script has its form");
}

void RequireMergesLikePlain(const std::vector<std::string>& texts)
{
    MergeLikePlain<PlainTocMerge, TocCombiner>(CheckTocStructure, texts, RequireWritersAgree);
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
