#include "Tools/DocTools/VantorPagemeld/Check/IndexStructure.h"
#include "Tools/DocTools/VantorPagemeld/IndexCombiner.h"
#include "Tools/DocTools/VantorPagemeld/Render/IndexScript.h"
#include "fuzz/MergeProperty.h"
#include "tests/support/PlainMerge.h"

// Search indexes that pass the structure check merge as in a plain linear merge, and the JSON that is
// written of the result reads back equal. The first module is a fixed one.

namespace
{

using rapidjson::Value;

constexpr const char* kFirstModule = R"({"pages":[["a.html","A \"quoted\" \\ title"],["b\"c\\.html",""]],)"
                                     R"("info":[["text",0],["",1]],"common":{},)"
                                     R"("searchIndex":{"a":[0,1],"b":[1],"":[],"b":[0]}})";

void RequireWritable(const Value& merged)
{
    RequireReadsBack(merged, RenderPrettyJson(merged).GetString());
    (void)RenderIndexScript(merged); // under the sanitizers
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    std::vector<std::string> texts = SplitInput(data, size);
    texts.insert(texts.begin(), kFirstModule);

    MergeLikePlain<PlainIndexMerge, IndexCombiner>(CheckIndexStructure, texts, RequireWritable);
    return 0;
}
