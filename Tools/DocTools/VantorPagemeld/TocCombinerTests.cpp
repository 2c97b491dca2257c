#include "Runtime/Testing/Checks.h"
#include "Runtime/Testing/UnitTestMacros.h"
#include "Tools/DocTools/VantorPagemeld/JsonTestUtils.h"
#include "Tools/DocTools/VantorPagemeld/RapidJsonIoUtil.h"
#include "Tools/DocTools/VantorPagemeld/TocCombiner.h"

namespace
{

constexpr const char* kFile = "./Tools/DocTools/VantorPagemeld/TocCombinerTests";

constexpr const char* kTrivialToc = R"({"link":"toc","title":"toc","children":null})";
constexpr const char* kSimpleToc = "{\"link\":\"toc\",\"title\":\"toc\",\"children\":["
                                   "\t{\"link\":\"null\",\"title\":\"Classes\",\"children\":["
                                   "\t\t{\"link\":\"A\",\"title\":\"A\",\"children\":null}\t]}]}";

} // namespace

UNIT_TEST(TocCombiner, TryGetJsonDocFromString_ValidString_ReturnsTrue, kFile, 27)
{
    rapidjson::Document document;
    UnitTest::CheckAt(31, RapidJsonIoUtil::TryGetJsonDocFromString(kTrivialToc, document), "success");
    UnitTest::CheckAt(33, RapidJsonIoUtil::TryGetJsonDocFromString(kSimpleToc, document), "success");
}

UNIT_TEST(TocCombiner, AppendJsonDocument_OneValueJson_ProducesThatJson, kFile, 36)
{
    rapidjson::Document document;
    RapidJsonIoUtil::TryGetJsonDocFromString(kTrivialToc, document);
    TocCombiner combiner;
    combiner.AppendJsonDocument(document);
    UnitTest::CheckEqualAt(53, kTrivialToc,
                           RapidJsonIoUtil::OutputJsonValueToString(combiner.combinedDocument));
}

UNIT_TEST(TocCombiner, AppendJsonDocument_TrivialAndSimpleJson_ProducesSimpleJson, kFile, 57)
{
    TocCombiner combiner;
    VerifyCombineJsons(combiner, kTrivialToc, 0, kSimpleToc, 1,
                       R"({"link":"toc","title":"toc","children":[)"
                       R"({"link":"null","title":"Classes","children":[)"
                       R"({"link":"A","title":"A","children":null,"module":1}],"module":1}],"module":0})");
}
