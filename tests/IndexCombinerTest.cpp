#include "Tools/DocTools/VantorPagemeld/IndexCombiner.h"

#include "tests/support/MergedModules.h"
#include "tests/support/PlainMerge.h"

#include <gtest/gtest.h>

#include <random>

namespace
{

/// Returns a module of three infos whose few terms are often the same.
std::string RandomModule(std::mt19937& random)
{
    const char* const names[] = {"",        "a",        "b",         "ab",
                                 "\\u0000", "a\\u0000", "a\\u0000b", "not a short string"};
    std::vector<std::string> terms;
    for (auto i = random() % 20; i > 0; --i)
    {
        std::vector<std::string> numbers;
        for (auto k = random() % 4; k > 0; --k)
        {
            numbers.push_back(std::to_string(random() % 3));
        }
        terms.push_back("\"" + std::string(names[random() % 8]) + "\":[" + Joined(numbers) + "]");
    }
    return R"({"pages":[["p","P"]],"info":[["t",0],["t",0],["t",0]],"common":{},"searchIndex":{)" +
           Joined(terms) + "}}";
}

} // namespace

TEST(IndexCombiner, MergesModulesInTheirOrder)
{
    const struct
    {
        std::vector<std::string> modules;
        const char* combined;
    } cases[] = {
        {{}, R"({"pages":[],"info":[],"common":{},"searchIndex":{}})"},
        {{R"({"searchIndex":{"a":[1]},"x":1,"common":{"a":1},"info":[["A text",0]],"pages":[["A","A"]]})"},
         R"({"pages":[["A","A",0]],"info":[["A text",0]],"common":{"a":1},"searchIndex":{"a":[1]}})"},
        {{R"({"pages":[["p","P"],["q","Q"]],"info":[["t",1],["u",0],["v",1]],"common":{},"searchIndex":{"a":[2,0,2],"b":[]}})",
          R"({"pages":[],"info":[],"common":{"x":1},"searchIndex":{}})",
          R"({"pages":[["r","R"]],"info":[["w",0]],"common":{"y":1},"searchIndex":{"c":[0],"a":[0,0],"b":[0],"c":[0]}})"},
         R"({"pages":[["p","P",0],["q","Q",0],["r","R",2]],"info":[["t",1],["u",0],["v",1],["w",2]],"common":{"x":1},"searchIndex":{"a":[2,0,2,3,3],"b":[3],"c":[3,3]}})"},
        {{R"({"pages":[],"info":[],"common":{"a":1},"searchIndex":{"a":[],"a\u0000":[]}})",
          R"({"pages":[],"info":[],"common":{"b":1},"searchIndex":{"a\u0000b":[],"A":[]}})"},
         R"({"pages":[],"info":[],"common":{"a":1},"searchIndex":{"a":[],"a\u0000":[],"a\u0000b":[],"A":[]}})"},
    };
    for (const auto& c : cases)
    {
        EXPECT_EQ(c.combined, MergedModules<IndexCombiner>(c.modules).Json());
    }
}

TEST(IndexCombiner, MergesAsALinearSearchWould)
{
    for (unsigned seed = 0; seed < 200; ++seed)
    {
        std::mt19937 random(seed);
        std::vector<std::string> modules;
        PlainIndexMerge plain;
        for (int index = 0; index < 5; ++index)
        {
            modules.push_back(RandomModule(random));
            plain.Append(ParsedJson(modules.back()), index);
        }
        EXPECT_EQ(RapidJsonIoUtil::OutputJsonValueToString(plain.Merged()),
                  MergedModules<IndexCombiner>(modules).Json())
            << "seed " << seed;
    }
}

TEST(IndexCombiner, ManyTermsKeepTheirOrderAndNumbers)
{
    // For each module, half of them in both. On the way the object moves to a pool of its own.
    constexpr int kTerms = 100'000;
    std::vector<std::string> modules;
    for (const int first : {0, kTerms / 2})
    {
        std::vector<std::string> terms;
        for (int i = first; i < first + kTerms; ++i)
        {
            terms.push_back("\"t" + std::to_string(i) + "\":[0]");
        }
        modules.push_back(R"({"pages":[["p","P"]],"info":[["i",0]],"common":{},"searchIndex":{)" +
                          Joined(terms) + "}}");
    }
    std::vector<std::string> expected;
    for (int i = 0; i < kTerms + kTerms / 2; ++i)
    {
        const char* const numbers = i < kTerms / 2 ? "[0]" : i < kTerms ? "[0,1]" : "[1]";
        expected.push_back("\"t" + std::to_string(i) + "\":" + numbers);
    }
    const std::string json = MergedModules<IndexCombiner>(modules).Json();
    EXPECT_TRUE(json.find("\"searchIndex\":{" + Joined(expected) + "}}") != std::string::npos);
}

TEST(IndexCombiner, PublicMergesAreRightForAnyValues)
{
    const struct
    {
        const char* combined;
        const char* input;
        const char* merged; ///< with numbers raised by 10
    } cases[] = {
        {R"({"b":[0]})", R"({"b":[0]})", R"({"b":[0,10]})"},
        {R"({"a":[0]})", R"({"b":[0]})", R"({"a":[0],"b":[10]})"},
        {R"({"b":[1]})", R"({"b":[0,1]})", R"({"b":[1,10,11]})"},
        {R"({"a":[],"b":[1],"a":[2],"a\u0000":[3]})", R"({"a\u0000":[0],"a":[0]})",
         R"({"a":[10],"b":[1],"a":[2],"a\u0000":[3,10]})"}, // the first of a name counts
    };
    IndexCombiner combiner;
    rapidjson::Document::AllocatorType pool;
    for (const auto& c : cases)
    {
        pool.Clear(); // so that the values of all rows lie at the same addresses
        rapidjson::Document combined(&pool);
        rapidjson::Document input(&pool);
        combined.Parse(c.combined);
        input.Parse(c.input);
        combiner.CombineSearchIndexJson(combined, input, 10);
        EXPECT_EQ(c.merged, RapidJsonIoUtil::OutputJsonValueToString(combined));
    }
}

TEST(IndexCombiner, MergesIntoWhatItsCallerChanged)
{
    const char* const module = R"({"pages":[],"info":[],"common":{},"searchIndex":{"a":[],"b":[1]}})";
    rapidjson::Document first = ParsedJson(module);
    std::list<rapidjson::Document> later; // hold values of what they are merged into
    IndexCombiner byHand;
    byHand.AppendJsonDocument(first);
    MergedModules<IndexCombiner> combined({module, module});
    for (IndexCombiner* combiner : {&byHand, &combined.Get()})
    {
        rapidjson::Value& searchIndex = combiner->combinedDocument["searchIndex"];
        searchIndex.MemberBegin()->name.SetString("c");
        later.push_back(ParsedJson(R"({"pages":[],"info":[],"common":{},"searchIndex":{"c":[2],"a":[1]}})"));
        combiner->AppendJsonDocument(later.back());
        EXPECT_EQ("[2]", RapidJsonIoUtil::OutputJsonValueToString(searchIndex["c"]));
        EXPECT_EQ("[1]", RapidJsonIoUtil::OutputJsonValueToString(searchIndex["a"]));
    }
}
