#include "Tools/DocTools/VantorPagemeld/Lookup/SiblingIndex.h"
#include "Tools/DocTools/VantorPagemeld/Lookup/TermIndex.h"
#include "tests/support/ParsedJson.h"

#include <gtest/gtest.h>

namespace
{

/// Looks for a member with this name and the value "new", and tells what was found; "appended" if nothing.
std::string FindTerm(TermIndex& index, const std::string& name, rapidjson::Document& owner)
{
    rapidjson::Document::AllocatorType& allocator = owner.GetAllocator();
    const auto length = static_cast<rapidjson::SizeType>(name.size());
    rapidjson::Value::Member member = {rapidjson::Value(name.data(), length, allocator),
                                       rapidjson::Value("new")};
    const rapidjson::Value* found = index.FindOrAppend(member, allocator);
    return found == nullptr ? "appended" : found->GetString();
}

/// Looks for the children of such an entry, and tells their text; "appended" if there is no such entry.
std::string FindSibling(SiblingIndex& index, const std::string& entryJson, rapidjson::Document& owner)
{
    const rapidjson::Document parsed = ParsedJson(entryJson);
    rapidjson::Value entry(parsed, owner.GetAllocator());
    const rapidjson::Value* found = index.FindChildrenOrAppend(entry, owner.GetAllocator());
    return found == nullptr ? "appended" : found->GetString();
}

} // namespace

TEST(Lookup, FollowsWhatIsFilledOrChangedAndFindsTheFirstOfANameThere)
{
    rapidjson::Document terms =
        ParsedJson(R"([{"a":"1st","b":"2nd","a":"3rd","a\u0000":"4th","b":"5th"},{"b":"other"}])");
    TermIndex termIndex;
    termIndex.Follow(terms[0]);
    EXPECT_EQ("1st", FindTerm(termIndex, "a", terms));
    EXPECT_EQ("2nd", FindTerm(termIndex, "b", terms));
    EXPECT_EQ("4th", FindTerm(termIndex, std::string("a\0", 2), terms));
    EXPECT_EQ("appended", FindTerm(termIndex, "c", terms));
    EXPECT_EQ("new", FindTerm(termIndex, "c", terms));
    terms[0].EraseMember("a");
    termIndex.Follow(terms[0]);
    EXPECT_EQ("3rd", FindTerm(termIndex, "a", terms));
    EXPECT_EQ("new", FindTerm(termIndex, "c", terms));
    termIndex.Follow(terms[1]);
    EXPECT_EQ("appended", FindTerm(termIndex, "a", terms));
    EXPECT_EQ("other", FindTerm(termIndex, "b", terms));

    const std::string a = R"({"link":"l","title":"a","children":"new"})";
    const std::string b = R"({"link":"l","title":"b","children":"new"})";
    const std::string swapped = R"({"link":"a","title":"l","children":"new"})";
    rapidjson::Document tocs = ParsedJson(
        R"([[{"link":"l","children":"no title"},{"link":"l","title":"a","children":"1st"},{"link":"l","title":"a","children":"2nd"}],
            [{"link":"l","title":"b","children":"other"}]])");
    SiblingIndex siblingIndex;
    siblingIndex.Follow(tocs[0]);
    EXPECT_EQ("1st", FindSibling(siblingIndex, a, tocs));
    EXPECT_EQ("appended", FindSibling(siblingIndex, swapped, tocs));
    EXPECT_EQ("new", FindSibling(siblingIndex, swapped, tocs));
    tocs[0].Erase(tocs[0].Begin() + 1);
    siblingIndex.Follow(tocs[0]);
    EXPECT_EQ("2nd", FindSibling(siblingIndex, a, tocs));
    siblingIndex.Follow(tocs[1]);
    EXPECT_EQ("appended", FindSibling(siblingIndex, a, tocs));
    EXPECT_EQ("other", FindSibling(siblingIndex, b, tocs));
}
