#include "Tools/DocTools/VantorPagemeld/Read/JsonReader.h"
#include "Tools/DocTools/VantorPagemeld/TocCombiner.h"
#include "tests/support/MergedModules.h"
#include "tests/support/Repeated.h"

#include <gtest/gtest.h>

#include <functional>

#include <pthread.h>

// Documents as deep as the reader allows, on a quarter of the usual stack.

namespace
{

#if defined(__SANITIZE_ADDRESS__) || !defined(__OPTIMIZE__)
constexpr std::size_t kStackBytes = 64 << 20; // the frames of this build are larger
#else
constexpr std::size_t kStackBytes = 2 << 20;
#endif

/// Calls the function on a thread with a small stack, and waits for it.
void RunOnSmallStack(std::function<void()> function)
{
    pthread_attr_t attributes;
    ASSERT_EQ(0, ::pthread_attr_init(&attributes));
    ASSERT_EQ(0, ::pthread_attr_setstacksize(&attributes, kStackBytes));
    pthread_t thread = {};
    const auto call = [](void* callee) -> void*
    {
        (*static_cast<std::function<void()>*>(callee))();
        return nullptr;
    };
    ASSERT_EQ(0, ::pthread_create(&thread, &attributes, call, &function));
    ::pthread_join(thread, nullptr);
    ::pthread_attr_destroy(&attributes);
}

void MergeDeepTocs()
{
    constexpr std::size_t kLevels = kMaxNestingDepth / 2;
    const std::string node = R"({"link":"l","title":"t","children":[)";
    const std::string deep = Repeated(node, kLevels) + Repeated("]}", kLevels);
    // The second is copied below the first, the third merged with it level by level.
    MergedModules<TocCombiner> merged({R"({"link":"l","title":"t","children":null})", deep, deep});
    TocCombiner& combiner = merged.Get();
    EXPECT_TRUE(combiner.TocCombiner::VerifyJSONStructure(combiner.combinedDocument));
    EXPECT_EQ(Repeated(node, kLevels) + Repeated(R"(],"module":1})", kLevels - 1) + R"(],"module":0})",
              merged.Json());
    EXPECT_EQ("toc = {\n\"link\": \"l\",\"title\": \"t\",\"children\": [" +
                  Repeated(R"({"link": p1+"l","title": "t","children": [)", kLevels - 1) +
                  Repeated("]}", kLevels - 1) + "]};\n",
              TextOf(RenderTocScript(combiner.combinedDocument)));
}

} // namespace

TEST(DeepInput, ArraysAndObjectsAreReadCopiedAndWritten)
{
    for (const std::string& text :
         {Repeated("[", kMaxNestingDepth) + Repeated("]", kMaxNestingDepth),
          Repeated("{\"a\":", kMaxNestingDepth - 1) + "{}" + Repeated("}", kMaxNestingDepth - 1)})
    {
        RunOnSmallStack(
            [&]
            {
                const rapidjson::Document document = ParsedJson(text);
                rapidjson::Document::AllocatorType allocator;
                const rapidjson::Value copy(document, allocator);
                EXPECT_EQ(text, RapidJsonIoUtil::OutputJsonValueToString(copy));
            });
    }
}

TEST(DeepInput, TablesOfContentsAreCheckedTaggedMergedAndWritten)
{
    RunOnSmallStack(MergeDeepTocs);
}
