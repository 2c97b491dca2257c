#include "Tools/DocTools/VantorPagemeld/IndexCombiner.h"

#include "tests/support/MergedModules.h"

#include <gtest/gtest.h>

#include <random>

namespace
{

struct Term
{
    std::string name; // as JSON writes it
    std::vector<int> numbers;
};

struct Module
{
    std::vector<int> pageOfInfo;
    std::vector<Term> terms;
};

/// Writes a module, or a combined index whose page entries carry their modules, as JSON.
std::string ToJson(const std::vector<std::string>& pages, const Module& module)
{
    std::vector<std::string> info;
    for (const int page : module.pageOfInfo)
    {
        info.push_back("[\"t\"," + std::to_string(page) + "]");
    }
    std::vector<std::string> terms;
    for (const Term& term : module.terms)
    {
        std::vector<std::string> numbers;
        for (const int number : term.numbers)
        {
            numbers.push_back(std::to_string(number));
        }
        terms.push_back("\"" + term.name + "\":[" + Joined(numbers) + "]");
    }
    return "{\"pages\":[" + Joined(pages) + "],\"info\":[" + Joined(info) +
           "],\"common\":{},\"searchIndex\":{" + Joined(terms) + "}}";
}

/// The merge as one would explain it: every term is searched for from the first to the last.
void MergeTerms(std::vector<Term>& combined, const std::vector<Term>& terms, int infoOffset)
{
    for (const Term& term : terms)
    {
        auto found = combined.begin();
        while (found != combined.end() && found->name != term.name)
        {
            ++found;
        }
        if (found == combined.end())
        {
            found = combined.insert(found, {term.name, {}});
        }
        for (const int number : term.numbers)
        {
            found->numbers.push_back(number + infoOffset);
        }
    }
}

Module RandomModule(std::mt19937& random)
{
    const char* const names[] = {"",
                                 "a",
                                 "b",
                                 "ab",
                                 "\\u0000",
                                 "a\\u0000",
                                 "a\\u0000b",
                                 "c",
                                 "cc",
                                 "ccc",
                                 "a term that is longer than the short form",
                                 "a term that is longer, too"};
    const auto below = [&](int limit) { return static_cast<int>(random() % static_cast<unsigned>(limit)); };
    Module module;
    for (int i = below(4); i > 0; --i)
    {
        module.pageOfInfo.push_back(0);
    }
    for (int i = below(30); i > 0; --i)
    {
        Term term = {names[below(12)], {}};
        for (int k = module.pageOfInfo.empty() ? 0 : below(4); k > 0; --k)
        {
            term.numbers.push_back(below(static_cast<int>(module.pageOfInfo.size())));
        }
        module.terms.push_back(term);
    }
    return module;
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
        {{"{\"pages\":\n[[\"A\", \"A\"]],\n\"info\": \n[[\"A text\",0]],\n\"common\": "
          "{\"a\":1},\n\"searchIndex\": "
          "\n{\"a\":[1]}}\n",
          "{\"pages\":\n[[\"B\", \"B\"]],\n\"info\": \n[[\"B text\",0]],\n\"common\": "
          "{\"a\":1},\n\"searchIndex\": "
          "\n{\"b\":[2]}}\n"},
         R"({"pages":[["A","A",0],["B","B",1]],"info":[["A text",0],["B text",1]],"common":{"a":1},"searchIndex":{"a":[1],"b":[3]}})"},
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
        std::vector<std::string> pages;
        Module combined;
        for (int index = 0; index < 5; ++index)
        {
            const Module module = RandomModule(random);
            modules.push_back(ToJson({R"(["p","P"])"}, module));
            MergeTerms(combined.terms, module.terms, static_cast<int>(combined.pageOfInfo.size()));
            pages.push_back("[\"p\",\"P\"," + std::to_string(index) + "]");
            combined.pageOfInfo.insert(combined.pageOfInfo.end(), module.pageOfInfo.size(), index);
        }
        EXPECT_EQ(ToJson(pages, combined), MergedModules<IndexCombiner>(modules).Json()) << "seed " << seed;
    }
}
