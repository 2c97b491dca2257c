#include "Tools/DocTools/VantorPagemeld/Check/TocStructure.h"
#include "Tools/DocTools/VantorPagemeld/TocCombiner.h"
#include "fuzz/MergeProperty.h"
#include "tests/support/PlainMerge.h"

// Tables of contents that pass the structure check merge as in a plain linear merge, and the JSON that is
// written of the result reads back equal.

namespace
{

using rapidjson::Value;

constexpr const char* kFirstModule =
    R"({"link":"toc","title":"toc","children":[{"link":"null","title":"Classes","children":[)"
    R"({"link":"A","title":"A","children":null},{"link":"a\"\\","title":"\"\\","children":[]}]},)"
    R"({"link":"B","title":"B","module":7,"children":null},{"link":"B","title":"C","children":[]}]})";

void RequireWritable(const Value& merged)
{
    RequireReadsBack(merged, RenderPrettyJson(merged).GetString());
    if (!merged.ObjectEmpty())
    {
        (void)RenderTocScript(merged); // under the sanitizers
    }
}

void RequireMergesLikePlain(const std::vector<std::string>& texts)
{
    MergeLikePlain<PlainTocMerge, TocCombiner>(CheckTocStructure, texts, RequireWritable);
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
