#include "Runtime/Testing/Checks.h"
#include "Runtime/Testing/UnitTestMacros.h"
#include "Tools/DocTools/VantorPagemeld/IndexCombiner.h"
#include "Tools/DocTools/VantorPagemeld/JsonTestUtils.h"
#include "Tools/DocTools/VantorPagemeld/RapidJsonIoUtil.h"

namespace
{

constexpr const char* kFile = "./Tools/DocTools/VantorPagemeld/IndexCombinerTests";

constexpr const char* kSampleA = "{\"pages\":\n[[\"A\", \"A\"]],\n\"info\": \n[[\"A text\",0]],\n"
                                 "\"common\": {\"a\":1},\n\"searchIndex\": \n{\"a\":[1]}}\n";
constexpr const char* kSampleB = "{\"pages\":\n[[\"B\", \"B\"]],\n\"info\": \n[[\"B text\",0]],\n"
                                 "\"common\": {\"a\":1},\n\"searchIndex\": \n{\"b\":[2]}}\n";

} // namespace

UNIT_TEST(IndexCombiner, TryGetJsonDocFromString_ValidString_ReturnsTrue, kFile, 30)
{
    rapidjson::Document document;
    UnitTest::CheckAt(34, RapidJsonIoUtil::TryGetJsonDocFromString(kSampleA, document), "success");
    UnitTest::CheckAt(36, RapidJsonIoUtil::TryGetJsonDocFromString(kSampleB, document), "success");
}

UNIT_TEST(IndexCombiner, AppendJsonDocument_OneValueJson_ProducesThatJson, kFile, 39)
{
    rapidjson::Document document;
    RapidJsonIoUtil::TryGetJsonDocFromString(kSampleA, document);
    IndexCombiner combiner;
    combiner.AddModuleIndexToEachEntry(document, 0);
    const std::string expected = RapidJsonIoUtil::OutputJsonValueToString(document);
    combiner.AppendJsonDocument(document);
    UnitTest::CheckEqualAt(58, expected, RapidJsonIoUtil::OutputJsonValueToString(combiner.combinedDocument));
}

UNIT_TEST(IndexCombiner, AppendJsonDocument_TwoValidJsons_ProducesCombinedJson, kFile, 62)
{
    IndexCombiner combiner;
    VerifyCombineJsons(combiner, kSampleA, 0, kSampleB, 1,
                       R"({"pages":[["A","A",0],["B","B",1]],"info":[["A text",0],["B text",1]],)"
                       R"("common":{"a":1},"searchIndex":{"a":[1],"b":[3]}})");
}
