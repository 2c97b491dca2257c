#include "Tools/DocTools/VantorPagemeld/Check/IndexStructure.h"
#include "Tools/DocTools/VantorPagemeld/Check/TocStructure.h"
#include "Tools/DocTools/VantorPagemeld/IndexCombiner.h"
#include "Tools/DocTools/VantorPagemeld/TocCombiner.h"
#include "tests/support/CapturedStderr.h"
#include "tests/support/Files.h"
#include "tests/support/ParsedJson.h"

#include <gtest/gtest.h>
#include <rapidjson/pointer.h>

namespace
{

/// Refuses more than the format requires, as a derived class may: a node with the title "secret".
class SecretiveCombiner : public TocCombiner
{
public:
    bool VerifyJSONStructure(const rapidjson::Value& node) override
    {
        return node["title"] != "secret" && TocCombiner::VerifyJSONStructure(node);
    }
};

/// What a combiner reports of a document, after "sound" or "refused".
std::string Verify(JsonCombiner& combiner, const rapidjson::Value& document)
{
    CapturedStderr captured;
    const bool isSound = combiner.VerifyJSONStructure(document);
    return (isSound ? "sound " : "refused ") + captured.Text();
}

template <class Check>
std::string AllFaults(Check check, const rapidjson::Value& document)
{
    std::string faults;
    const bool wentOn =
        check(document,
              [&](const FoundFault& found)
              {
                  const std::string where = found.pointer.Text();
                  EXPECT_EQ(&found.place, rapidjson::Pointer(where.c_str()).Get(document)) << where;
                  faults += (faults.empty() ? "" : " ") + std::to_string(RowOf(found.fault).number) + where;
                  return true;
              });
    return wentOn ? faults : faults + "stopped";
}

/// Returns a text of a row of the table, empty if it has none.
std::string TextOf(const rapidjson::Value& row, const char* name)
{
    const auto member = row.FindMember(name);
    return member == row.MemberEnd() ? "" : member->value.GetString();
}

/// Tests a combiner and a structure check against the rows of a list in structureCases.json, against which
/// script/check-schemas tests the schemas as well.
///
/// A row has a document and, if that is faulty, "faults": the number and place of each, and "message": the
/// number and text of the first one.
template <class Combiner, class Check>
void ExpectStructure(const char* list, const std::string& tag, Check check)
{
    const rapidjson::Document cases = ParsedJson(ReadFile(STRUCTURE_CASES));
    ASSERT_FALSE(cases[list].Empty());
    for (const rapidjson::Value& row : cases[list].GetArray())
    {
        SCOPED_TRACE(RapidJsonIoUtil::OutputJsonValueToString(row));
        const std::string message = TextOf(row, "message");
        const std::string faults = TextOf(row, "faults");
        Combiner combiner;
        EXPECT_EQ((faults.empty() ? "sound " : "refused ") +
                      (message.empty() ? "" : "WARNING: " + tag + message + "\n"),
                  Verify(combiner, row["document"]));
        EXPECT_EQ(faults, AllFaults(check, row["document"]));
    }
}

} // namespace

TEST(IndexStructure, FirstFaultIsReportedAndEveryFaultIsFound)
{
    ExpectStructure<IndexCombiner>("index",
                                   "./Tools/DocTools/VantorPagemeld/IndexCombiner:", CheckIndexStructure);
}

TEST(TocStructure, FirstFaultIsReportedAndEveryFaultIsFound)
{
    ExpectStructure<TocCombiner>("toc", "./Tools/DocTools/VantorPagemeld/TocCombiner:", CheckTocStructure);
}

TEST(TocStructure, OverridingCombinerIsAskedForEveryNode)
{
    SecretiveCombiner combiner;
    EXPECT_EQ("refused ",
              Verify(combiner, ParsedJson(R"({"link":"l","title":"t","children":[{"link":"a","title":"a",
        "children":[{"link":"b","title":"secret","children":null}]}]})")));
}
