#include "Tools/DocTools/VantorPagemeld/IndexCombiner.h"
#include "tests/support/CapturedStderr.h"
#include "tests/support/NeutralText.h"
#include "tests/support/ParsedJson.h"
#include "tests/support/TemporaryFolder.h"
#include "tests/support/WholeFile.h"

#include <gtest/gtest.h>

namespace
{

class OpenCombiner : public IndexCombiner
{
public:
    using IndexCombiner::moduleDocuments;
    using IndexCombiner::modulePathTable;
};

} // namespace

TEST(JsonCombiner, SkippedModulesTakeNoIndex)
{
    const TemporaryFolder folder;
    const std::string page = R"({"pages":[["p","P"]],"info":[],"common":{},"searchIndex":{}})";
    WriteWholeFile(folder / "a/index.json", page);
    WriteWholeFile(folder / "noJson/index.json", page + "}");
    WriteWholeFile(folder / "unsound/index.json",
                   R"({"pages":[["p","P",0]],"info":[],"common":{},"searchIndex":{}})");
    WriteWholeFile(folder / "silent/index.json", "[]");
    std::list<std::string> modules;
    for (const char* name : {"missing", "a", "noJson", "unsound", "silent", "a"})
    {
        modules.push_back(folder / name);
    }

    OpenCombiner combiner;
    CapturedStderr captured;
    EXPECT_TRUE(combiner.CombineJson(modules, "index.json"));
    EXPECT_EQ("WARNING: #RapidJsonIoUtil:47 Unable to read @/missing/index.json\nERROR: #RapidJsonIoUtil:71 "
              "Failed to parse JSON file @/noJson/index.json, error at offset: 60\nWARNING: "
              "#IndexCombiner:318 Content in pages is not an array of 2 elements\n",
              Neutral(captured.Text(), folder));
    EXPECT_EQ((std::map<int, std::string>{{0, folder / "a/"}, {1, folder / "a/"}}), combiner.modulePathTable);
    EXPECT_EQ(6U, combiner.moduleDocuments.size());
    EXPECT_EQ(R"({"pages":[["p","P",0],["p","P",1]],"info":[],"common":{},"searchIndex":{}})",
              RapidJsonIoUtil::OutputJsonValueToString(combiner.combinedDocument));
}

TEST(JsonCombiner, NothingToMergeIsAFailure)
{
    OpenCombiner combiner;
    EXPECT_FALSE(combiner.CombineJson({}, "index.json"));
    EXPECT_TRUE(combiner.modulePathTable.empty());
    EXPECT_EQ(R"({"pages":[],"info":[],"common":{},"searchIndex":{}})",
              RapidJsonIoUtil::OutputJsonValueToString(combiner.combinedDocument));
}
