#include "Tools/DocTools/VantorPagemeld/TocCombiner.h"

#include "tests/support/MergedModules.h"

#include <gtest/gtest.h>

#include <random>

namespace
{

struct Node
{
    std::string link; // link and title as JSON writes them
    std::string title;
    bool isLeaf;
    std::vector<Node> children;
    int module;
};

std::string ToJson(const Node& node, bool isTagged)
{
    std::vector<std::string> children;
    for (const Node& child : node.children)
    {
        children.push_back(ToJson(child, isTagged));
    }
    return "{\"link\":\"" + node.link + "\",\"title\":\"" + node.title +
           "\",\"children\":" + (node.isLeaf ? "null" : "[" + Joined(children) + "]") +
           (isTagged ? ",\"module\":" + std::to_string(node.module) + "}" : "}");
}

bool IsSameText(const std::string& a, const std::string& b)
{
    return a.substr(0, a.find("\\u0000")) == b.substr(0, b.find("\\u0000"));
}

/// The merge as one would explain it: every entry is searched for from the first to the last.
void MergeChildren(Node& destination, const Node& source)
{
    if (source.isLeaf)
    {
        return;
    }
    if (destination.isLeaf)
    {
        destination.isLeaf = false;
        destination.children = source.children;
        return;
    }
    for (const Node& entry : source.children)
    {
        auto found = destination.children.begin();
        while (found != destination.children.end() &&
               !(IsSameText(found->link, entry.link) && IsSameText(found->title, entry.title)))
        {
            ++found;
        }
        if (found == destination.children.end())
        {
            destination.children.push_back(entry);
        }
        else
        {
            MergeChildren(*found, entry);
        }
    }
}

Node RandomNode(std::mt19937& random, int module, int levels)
{
    const char* const texts[] = {"a",         "b",       "",
                                 "a\\u0000x", "\\u0000", "a text that is longer than the short form"};
    Node node = {texts[random() % 6], texts[random() % 3], levels == 0 || random() % 4 == 0, {}, module};
    for (auto i = node.isLeaf ? 0 : random() % 7; i > 0; --i)
    {
        node.children.push_back(RandomNode(random, module, levels - 1));
    }
    return node;
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
        {{trivial, simple},
         R"({"link":"toc","title":"toc","children":[{"link":"null","title":"Classes","children":[{"link":"A","title":"A","children":null,"module":1}],"module":1}],"module":0})"},
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
        Node combined;
        for (int index = 0; index < 5; ++index)
        {
            Node root = RandomNode(random, index, 4);
            root.link = "toc";
            root.title = "toc";
            modules.push_back(ToJson(root, false));
            if (index == 0)
            {
                combined = root;
            }
            else
            {
                MergeChildren(combined, root);
            }
        }
        EXPECT_EQ(ToJson(combined, true), MergedModules<TocCombiner>(modules).Json()) << "seed " << seed;
    }
}

TEST(TocCombiner, TreesAtTheDepthLimitPassThroughEveryStep)
{
    constexpr int kNodes = 5'000; // each an object and a list
    std::string deep;
    std::string ends;
    for (int i = 0; i < kNodes; ++i)
    {
        deep += R"({"link":"l","title":"t","children":[)";
        ends += "]}";
    }
    deep += ends;
    // Into the second module's tree, which was copied into the leaf of the first, the third is merged.
    MergedModules<TocCombiner> merged({R"({"link":"l","title":"t","children":null})", deep, deep});
    EXPECT_TRUE(merged.Get().VerifyJSONStructure(merged.Get().combinedDocument));
    EXPECT_EQ(deep.size() + kNodes * std::string(R"(,"module":0)").size(), merged.Json().size());
    const auto text = merged.Get().RenderScript(merged.Get().combinedDocument);
    EXPECT_NE(std::string::npos, TextOf(*text).find(R"(toc = {
"link": "l","title": "t","children": [{"link": p1+"l","title": "t","children": [{"link": p1+)"));
    EXPECT_LT(deep.size(), RapidJsonIoUtil::RenderPrettyJson(merged.Get().combinedDocument).GetSize());
}
