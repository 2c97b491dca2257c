#include "Tools/DocTools/VantorPagemeld/TocCombiner.h"

#include "tests/support/MergedModules.h"
#include "tests/support/PlainMerge.h"

#include <gtest/gtest.h>

#include <random>

namespace
{

/// Returns a list of few different nodes, or null, with lists nested at most that many levels deep.
std::string RandomChildren(std::mt19937& random, int levels)
{
    const char* const texts[] = {"a", "b", "a\\u0000x", "", "\\u0000", "not a short string"};
    if (levels == 0 || random() % 4 == 0)
    {
        return "null";
    }
    std::vector<std::string> nodes;
    for (auto i = random() % 7; i > 0; --i)
    {
        const std::string link = texts[random() % 6];
        const std::string title = texts[random() % 3];
        nodes.push_back("{\"link\":\"" + link + "\",\"title\":\"" + title +
                        "\",\"children\":" + RandomChildren(random, levels - 1) + "}");
    }
    return "[" + Joined(nodes) + "]";
}

} // namespace

TEST(TocCombiner, MergesEntriesOfTheSameLinkAndTitle)
{
    const char* const trivial = R"({"link":"toc","title":"toc","children":null})";
    const char* const simple =
        "{\"link\":\"toc\",\"title\":\"toc\",\"children\":[\t{\"link\":\"null\",\"title\":"
        "\"Classes\",\"children\":[\t\t{\"link\":\"A\",\"title\":\"A\",\"children\":null}\t]}]}";
    const struct
    {
        std::vector<std::string> modules;
        const char* combined;
    } cases[] = {
        {{}, "{}"},
        {{trivial, simple,
          R"({"link":"toc","title":"toc","children":[{"link":"null","title":"Classes","children":[{"link":"C","title":"C","children":null}]}]})"},
         R"({"link":"toc","title":"toc","children":[{"link":"null","title":"Classes","children":[{"link":"A","title":"A","children":null,"module":1},{"link":"C","title":"C","children":null,"module":2}],"module":1}],"module":0})"},
        {{R"({"more":{"children":[{}]},"children":[],"title":"t","link":"l"})", // the first root is taken
                                                                                // over whole
          R"({"link":"l","title":"t","less":1,"children":[{"link":"a","title":"a","children":null},{"link":"a","title":"a","x":1,"children":[{"link":"b","title":"b","children":null}]},{"link":"a","title":"A","children":[]}]})"},
         R"({"more":{"children":[{}]},"children":[{"link":"a","title":"a","children":[{"link":"b","title":"b","children":null,"module":1}],"module":1},{"link":"a","title":"A","children":[],"module":1}],"title":"t","link":"l","module":0})"},
        {{R"({"link":"l","title":"t","children":null})", // into a leaf, a list is copied as it is, twins and
                                                         // all
          R"({"link":"l","title":"t","children":[{"link":"a","title":"a","children":null},{"link":"a","title":"a","children":null}]})",
          R"({"link":"l","title":"t","children":[{"link":"a","title":"a","children":[]},{"link":"b","title":"b","children":null}]})"},
         R"({"link":"l","title":"t","children":[{"link":"a","title":"a","children":[],"module":1},{"link":"a","title":"a","children":null,"module":1},{"link":"b","title":"b","children":null,"module":2}],"module":0})"},
        {{R"({"link":"l","title":"t","children":[]})", // other roots are dropped
          R"({"link":"l","title":"T","children":[{"link":"a","title":"a","children":null}]})",
          R"({"link":"t","title":"l","children":[{"link":"a","title":"a","children":null}]})",
          R"({"link":"l","title":"t","children":null})"},
         R"({"link":"l","title":"t","children":[],"module":0})"},
        {{R"({"link":"l\u0000x","title":"t","children":[{"link":"a","title":"a\u0000y","children":[],"module":"old"}]})",
          R"({"link":"l","title":"t\u0000z","children":[{"link":"a\u0000","title":"a","children":[{"link":"b","title":"b","children":null,"module":7}]}]})"},
         R"({"link":"l\u0000x","title":"t","children":[{"link":"a","title":"a\u0000y","children":[{"link":"b","title":"b","children":null,"module":7,"module":1}],"module":"old","module":0}],"module":0})"},
    };
    for (const auto& c : cases)
    {
        EXPECT_EQ(c.combined, MergedModules<TocCombiner>(c.modules).Json());
    }
}

TEST(TocCombiner, MergesAsALinearSearchWould)
{
    for (unsigned seed = 0; seed < 200; ++seed)
    {
        std::mt19937 random(seed);
        std::vector<std::string> modules;
        PlainTocMerge plain;
        for (int index = 0; index < 5; ++index)
        {
            modules.push_back(R"({"link":"toc","title":"toc","children":)" + RandomChildren(random, 4) + "}");
            plain.Append(ParsedJson(modules.back()), index);
        }
        EXPECT_EQ(RapidJsonIoUtil::OutputJsonValueToString(plain.Merged()),
                  MergedModules<TocCombiner>(modules).Json())
            << "seed " << seed;
    }
}

TEST(TocCombiner, PublicMergesAreRightForAnyValues)
{
    const std::string a = R"({"link":"l","title":"a","children":null})";
    const std::string b = R"({"link":"l","title":"b","children":null})";
    const std::string swapped = R"({"link":"a","title":"l","children":null})";
    const struct
    {
        std::string destination;
        std::string source;
        std::string merged;
    } cases[] = {
        {"[" + a + "]", "[" + a + "]", "[" + a + "]"},
        {"[" + b + "]", "[" + a + "]", "[" + b + "," + a + "]"},
        {"[" + a + "]", "[" + b + "]", "[" + a + "," + b + "]"},
        {"[" + a + "]", "[" + swapped + "]", "[" + a + "," + swapped + "]"},
        {R"([{"link":"l"},)" + a + "," + a + "]", R"([{"link":"l","title":"a","children":[]}])",
         R"([{"link":"l"},{"link":"l","title":"a","children":[]},)" + a + "]"}, // the first of them counts
    };
    TocCombiner combiner;
    rapidjson::Document::AllocatorType pool;
    for (const auto& c : cases)
    {
        pool.Clear(); // so that the values of all rows lie at the same addresses
        rapidjson::Document destination(&pool);
        rapidjson::Document source(&pool);
        destination.Parse(c.destination.c_str());
        source.Parse(c.source.c_str());
        combiner.AppendJsonValue(destination, source);
        EXPECT_EQ(c.merged, RapidJsonIoUtil::OutputJsonValueToString(destination));
    }
}

TEST(TocCombiner, MergesIntoWhatItsCallerChanged)
{
    const char* const module =
        R"({"link":"l","title":"t","children":[{"link":"a","title":"a","children":null}]})";
    rapidjson::Document documents[] = {ParsedJson(module), ParsedJson(module), ParsedJson(module)};
    TocCombiner combiner;
    combiner.AppendJsonDocument(documents[0]);
    combiner.AppendJsonDocument(documents[1]);
    combiner.combinedDocument["children"].Clear();
    combiner.AppendJsonDocument(documents[2]);
    EXPECT_EQ(module, RapidJsonIoUtil::OutputJsonValueToString(combiner.combinedDocument));
}
