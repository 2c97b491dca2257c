#include "Tools/DocTools/VantorPagemeld/JsonTestUtils.h"

#include "Runtime/Testing/Checks.h"
#include "Tools/DocTools/VantorPagemeld/RapidJsonIoUtil.h"

void VerifyCombineJsons(JsonCombiner& combiner, const std::string& first, int firstModuleIndex,
                        const std::string& second, int secondModuleIndex, const std::string& expected)
{
    rapidjson::Document firstDocument;
    rapidjson::Document secondDocument;
    RapidJsonIoUtil::TryGetJsonDocFromString(first.c_str(), firstDocument);
    RapidJsonIoUtil::TryGetJsonDocFromString(second.c_str(), secondDocument);
    combiner.AddModuleIndexToEachEntry(firstDocument, firstModuleIndex);
    combiner.AddModuleIndexToEachEntry(secondDocument, secondModuleIndex);
    combiner.AppendJsonDocument(firstDocument);
    combiner.AppendJsonDocument(secondDocument);
    UnitTest::CheckEqualAt(31, expected, RapidJsonIoUtil::OutputJsonValueToString(combiner.combinedDocument));
}
