#include "Tools/DocTools/VantorPagemeld/IndexCombiner.h"
#include "Tools/DocTools/VantorPagemeld/System/ScopedFile.h"
#include "Tools/DocTools/VantorPagemeld/TocCombiner.h"
#include "tests/support/Files.h"
#include "tests/support/ParsedJson.h"
#include "tests/support/TemporaryDirectory.h"

#include <gtest/gtest.h>

#include <cstdio>
#include <functional>
#include <stdexcept>

// What programs that link the combiners may do: derive from them, and change the combined document
// themselves.

namespace
{

using rapidjson::Value;

/// Merges each document by a function instead, which may call Merge.
template <class Combiner>
class Derived : public Combiner
{
public:
    using Override = std::function<void(Derived&, rapidjson::Document&)>;

    explicit Derived(Override append) : m_append(std::move(append)) {}

    bool VerifyJSONStructure(const Value& /*document*/) override { return true; }

    void AddModuleIndexToEachEntry(rapidjson::Document& /*document*/, int /*moduleIndex*/) override {}

    void AppendJsonDocument(rapidjson::Document& document) override
    {
        ++callCount;
        m_append(*this, document);
    }

    void Merge(rapidjson::Document& document) { Combiner::AppendJsonDocument(document); }

    /// Parses a document that lives as long as this object.
    rapidjson::Document& Parse(const char* json)
    {
        m_documents.push_back(ParsedJson(json));
        return m_documents.back();
    }

    int callCount = 0;

private:
    Override m_append;
    std::list<rapidjson::Document> m_documents;
};

/// Returns the titles of a list of entries, each with the outline of its children in parentheses.
std::string Outline(const Value& list)
{
    std::string outline;
    for (const Value& entry : list.GetArray())
    {
        const Value& children = entry["children"];
        outline += entry["title"].GetString();
        outline += children.IsArray() ? "(" + Outline(children) + ")" : "";
    }
    return outline;
}

/// Combines the modules, and once more from the first if that throws, after the caller's change.
template <class Combiner>
void Combine(Combiner& combiner, const std::vector<const char*>& modules, void (*change)(Combiner&))
{
    const TemporaryDirectory directory;
    std::list<std::string> paths;
    for (const char* json : modules)
    {
        paths.push_back(directory / std::to_string(paths.size()));
        WriteFile(paths.back() + "/module.json", json);
    }
    try
    {
        EXPECT_TRUE(combiner.CombineJson(paths, "module.json"));
    }
    catch (const std::runtime_error&)
    {
        change(combiner);
        EXPECT_TRUE(combiner.CombineJson(paths, "module.json"));
    }
}

template <class Combiner>
void LeaveOutTheFirst(Derived<Combiner>& combiner, rapidjson::Document& document)
{
    if (combiner.callCount > 1)
    {
        combiner.Merge(document);
    }
}

template <class Combiner>
void ThrowOnce(Derived<Combiner>& combiner, rapidjson::Document& document)
{
    combiner.Merge(document);
    if (combiner.callCount == 2)
    {
        throw std::runtime_error("once");
    }
}

} // namespace

TEST(LinkedCombiners, IndexesMergeRightWhateverAnOverrideDoes)
{
    using Combiner = Derived<IndexCombiner>;
    const struct
    {
        const char* what;
        Combiner::Override append;
        const char* terms;
    } cases[] = {
        {"leaves out the first", LeaveOutTheFirst<IndexCombiner>, R"({"z":[2,2],"a":[1]})"},
        {"merges more",
         [](Combiner& combiner, rapidjson::Document& document)
         {
             combiner.Merge(document);
             combiner.CombineSearchIndexJson(combiner.combinedDocument["searchIndex"],
                                             combiner.Parse(R"({"z":[3]})"), 1);
         },
         R"({"a":[1,1],"z":[4,2,4,2,4]})"},
        {"empties the terms",
         [](Combiner& combiner, rapidjson::Document& document)
         {
             combiner.combinedDocument["searchIndex"].RemoveAllMembers();
             combiner.Merge(document);
         },
         R"({"a":[1],"z":[2]})"},
        {"throws", ThrowOnce<IndexCombiner>, R"({"z":[1,2,2],"a":[1,1]})"},
    };
    for (const auto& c : cases)
    {
        Combiner combiner(c.append);
        Combine<Combiner>(combiner,
                          {R"({"pages":[],"info":[],"common":{},"searchIndex":{"a":[1]}})",
                           R"({"pages":[],"info":[],"common":{},"searchIndex":{"z":[2]}})",
                           R"({"pages":[],"info":[],"common":{},"searchIndex":{"a":[1],"z":[2]}})"},
                          [](Combiner& thrower)
                          {
                              Value& terms = thrower.combinedDocument["searchIndex"];
                              terms.RemoveMember("z");
                              terms.MemberBegin()->name.SetString("z");
                          });
        EXPECT_EQ(c.terms, RapidJsonIoUtil::OutputJsonValueToString(combiner.combinedDocument["searchIndex"]))
            << c.what;
    }
}

TEST(LinkedCombiners, ContentsMergeRightWhateverAnOverrideDoes)
{
    using Combiner = Derived<TocCombiner>;
    const struct
    {
        const char* what;
        Combiner::Override append;
        const char* outline;
    } cases[] = {
        {"leaves out the first", LeaveOutTheFirst<TocCombiner>, "BA(y)C"},
        {"merges more",
         [](Combiner& combiner, rapidjson::Document& document)
         {
             combiner.Merge(document);
             combiner.AppendJsonValue(
                 combiner.combinedDocument,
                 combiner.Parse(
                     R"({"link":"","title":"","children":[{"link":"","title":"C","children":null}]})"));
         },
         "A(xy)CB"},
        {"tags what is merged, which moves its members",
         [](Combiner& combiner, rapidjson::Document& document)
         {
             combiner.Merge(document);
             combiner.AddPlatformPrefixToLinks(combiner.combinedDocument, 7);
         },
         "A(xy)BC"},
        {"empties the list",
         [](Combiner& combiner, rapidjson::Document& document)
         {
             combiner.Merge(document);
             combiner.combinedDocument["children"].Clear();
         },
         ""},
        {"throws", ThrowOnce<TocCombiner>, "A(xy)BC"},
    };
    for (const auto& c : cases)
    {
        Combiner combiner(c.append);
        Combine<Combiner>(
            combiner,
            {R"({"link":"","title":"","children":[{"link":"","title":"A","children":[{"link":"","title":"x","children":null}]}]})",
             R"({"link":"","title":"","children":[{"link":"","title":"B","children":null}]})",
             R"({"link":"","title":"","children":[{"link":"","title":"A","children":[{"link":"","title":"y","children":null}]},{"link":"","title":"C","children":null}]})"},
            [](Combiner& thrower) { thrower.combinedDocument["children"].Clear(); });
        EXPECT_EQ(c.outline, Outline(combiner.combinedDocument["children"])) << c.what;
    }
}

TEST(LinkedCombiners, MayStartFromTheBase)
{
    struct ListCombiner : JsonCombiner
    {
        ListCombiner() { combinedDocument.Parse(defaultJson.c_str()); }
        bool VerifyJSONStructure(const Value& document) override { return document.IsArray(); }
        void AppendJsonDocument(rapidjson::Document& /*document*/) override {}
        void AddModuleIndexToEachEntry(rapidjson::Document& document, int moduleIndex) override
        {
            document.PushBack(moduleIndex, combinedDocument.GetAllocator());
        }
        bool OutputJsonValueAsJs(const char*, const rapidjson::Document&, const char*) override
        {
            return true;
        }
    };
    ListCombiner combiner;
    rapidjson::Document list = ParsedJson("[1]");
    combiner.AddModuleIndexToEachEntry(list, 5);
    EXPECT_EQ("[1,5]{}", RapidJsonIoUtil::OutputJsonValueToString(list) +
                             RapidJsonIoUtil::OutputJsonValueToString(combiner.combinedDocument));
}

TEST(LinkedCombiners, MergeInfosAndWriteScriptsOnTheirOwn)
{
    const TemporaryDirectory directory;
    IndexCombiner combiner;
    rapidjson::Document infos = ParsedJson(R"([["t",0]])");
    rapidjson::Document input = ParsedJson(R"([["u",0],["v",2147483647]])");
    combiner.CombineInfoJson(infos, input, 3);
    EXPECT_EQ(R"([["t",0],["u",3],["v",-2147483646]])", RapidJsonIoUtil::OutputJsonValueToString(infos));

    combiner.SetModulePathAtIndex(1, "b/Manual/");
    combiner.SetModulePathAtIndex(0, "a/Manual/");
    for (const std::string& path : {directory / "script", std::string("/dev/full")})
    {
        const ScopedFile file(std::fopen(path.c_str(), "wb"));
        (void)std::setvbuf(file.get(), nullptr, _IONBF, 0);
        EXPECT_EQ(path != "/dev/full", combiner.OutputPrefixVars("b/Manual", file.get()));
    }
    const std::string prefixes = "var p0 = \"../a/Manual/\";\nvar p1 = \"\";\n";
    EXPECT_EQ(prefixes, ReadFile(directory / "script"));
    const std::string path = directory / "script";
    EXPECT_TRUE(combiner.OutputJsonValueAsJs("b/Manual", combiner.combinedDocument, path.c_str()));
    EXPECT_EQ(prefixes + "pages = [\n];\ninfo = []\ncommon = {};\nsearchIndex = {};\n", ReadFile(path));
}

TEST(LinkedCombiners, CopyConstantStrings)
{
    std::string text = "a string that is not short";
    rapidjson::Document index = ParsedJson(R"({"pages":[],"info":[],"common":{},"searchIndex":{}})");
    index["common"].AddMember(rapidjson::StringRef(text.c_str()), 1, index.GetAllocator());
    rapidjson::Document list = ParsedJson("[]");
    list.PushBack(rapidjson::StringRef(text.c_str()), list.GetAllocator());
    IndexCombiner indexes;
    TocCombiner contents;
    Value leaf;
    indexes.AppendJsonDocument(index);
    contents.AppendJsonValue(leaf, list);
    text[0] = 'X';
    EXPECT_TRUE(indexes.combinedDocument["common"].HasMember("a string that is not short"));
    EXPECT_STREQ("a string that is not short", leaf[0].GetString());
}
