#include "Tools/DocTools/VantorPagemeld/Json/JsonReader.h"
#include "Tools/DocTools/VantorPagemeld/RapidJsonIoUtil.h"
#include "Tools/DocTools/VantorPagemeld/TocCombiner.h"

#include <gtest/gtest.h>

#include <functional>

#include <pthread.h>

// Documents as deep as the reader lets them be, on a quarter of the usual stack.

namespace
{

std::string Repeat(const std::string& text, std::size_t times)
{
    std::string all;
    for (std::size_t i = 0; i < times; ++i)
    {
        all += text;
    }
    return all;
}

/// Calls the function on a thread with a stack of 2 MiB, and waits for it.
void RunOnSmallStack(std::function<void()> function)
{
#if defined(__SANITIZE_ADDRESS__) || !defined(__OPTIMIZE__)
    GTEST_SKIP() << "the frames of this build are larger";
#endif
    pthread_attr_t attributes;
    ASSERT_EQ(0, ::pthread_attr_init(&attributes));
    ASSERT_EQ(0, ::pthread_attr_setstacksize(&attributes, 2 << 20));
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
    const std::string deep =
        Repeat(R"({"link":"l","title":"t","children":[)", kLevels) + Repeat("]}", kLevels);
    TocCombiner combiner;
    rapidjson::Document documents[3];
    // The second is copied below the first, the third merged with it level by level.
    const std::string texts[] = {R"({"link":"l","title":"t","children":null})", deep, deep};
    for (int i = 0; i < 3; ++i)
    {
        ASSERT_TRUE(RapidJsonIoUtil::TryGetJsonDocFromString(texts[i].c_str(), documents[i]));
        ASSERT_TRUE(combiner.VerifyJSONStructure(documents[i]));
        combiner.AddModuleIndexToEachEntry(documents[i], i);
        combiner.AppendJsonDocument(documents[i]);
    }
    EXPECT_EQ(Repeat(R"({"link":"l","title":"t","children":[)", kLevels) +
                  Repeat(R"(],"module":1})", kLevels - 1) + R"(],"module":0})",
              RapidJsonIoUtil::OutputJsonValueToString(combiner.combinedDocument));
    EXPECT_EQ("toc = {\n\"link\": \"l\",\"title\": \"t\",\"children\": [" +
                  Repeat(R"({"link": p1+"l","title": "t","children": [)", kLevels - 1) +
                  Repeat("]}", kLevels - 1) + "]};\n",
              TextOf(*combiner.RenderScript(combiner.combinedDocument)));
}

} // namespace

TEST(DeepInput, ArraysAndObjectsAreReadCopiedAndWritten)
{
    const std::string texts[] = {
        Repeat("[", kMaxNestingDepth) + Repeat("]", kMaxNestingDepth),
        Repeat("{\"a\":", kMaxNestingDepth - 1) + "{}" + Repeat("}", kMaxNestingDepth - 1),
    };
    for (const std::string& text : texts)
    {
        RunOnSmallStack(
            [&]
            {
                rapidjson::Document document;
                ASSERT_TRUE(RapidJsonIoUtil::TryGetJsonDocFromString(text.c_str(), document));
                const rapidjson::Value copy(document, document.GetAllocator());
                EXPECT_EQ(text, RapidJsonIoUtil::OutputJsonValueToString(copy));
            });
    }
}

TEST(DeepInput, TablesOfContentsAreCheckedTaggedMergedAndWritten)
{
    RunOnSmallStack(MergeDeepTocs);
}
