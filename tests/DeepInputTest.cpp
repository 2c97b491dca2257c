#include "Tools/DocTools/VantorPagemeld/Read/JsonReader.h"
#include "Tools/DocTools/VantorPagemeld/TocCombiner.h"
#include "tests/support/MergedModules.h"
#include "tests/support/Repeated.h"

#include <gtest/gtest.h>
#include <rapidjson/prettywriter.h>

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

/// Returns the pretty form without its spaces, which can take more than half a gigabyte.
std::string Lines(const rapidjson::Value& value)
{
    TextBuffer text;
    rapidjson::PrettyWriter<TextBuffer> writer(text);
    writer.SetIndent(' ', 0);
    EXPECT_TRUE(value.Accept(writer));
    return text.GetString();
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
    const struct
    {
        std::string text;
        std::string lines;
    } cases[] = {
        {Repeated("[", kMaxNestingDepth) + Repeated("]", kMaxNestingDepth),
         Repeated("[\n", kMaxNestingDepth - 1) + "[]" + Repeated("\n]", kMaxNestingDepth - 1)},
        {Repeated("{\"a\":", kMaxNestingDepth - 1) + "{}" + Repeated("}", kMaxNestingDepth - 1),
         Repeated("{\n\"a\": ", kMaxNestingDepth - 1) + "{}" + Repeated("\n}", kMaxNestingDepth - 1)},
    };
    for (const auto& c : cases)
    {
        RunOnSmallStack(
            [&]
            {
                const rapidjson::Document document = ParsedJson(c.text);
                rapidjson::Document::AllocatorType allocator;
                const rapidjson::Value copy(document, allocator);
                EXPECT_EQ(c.text, RapidJsonIoUtil::OutputJsonValueToString(copy));
                EXPECT_EQ(c.lines, Lines(copy));
            });
    }
}

TEST(DeepInput, TablesOfContentsAreCheckedTaggedMergedAndWritten)
{
    RunOnSmallStack(MergeDeepTocs);
}
