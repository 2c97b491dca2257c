#include "tests/support/Files.h"
#include "tests/support/ParsedJson.h"
#include "tests/support/RunProgram.h"

#include <gtest/gtest.h>

#include <filesystem>

// In the texts, @ is the temporary directory.

namespace
{

const char* const kIndexA =
    R"({"pages":[["a.html","Say \"A\""]],"info":[["About \"A\"",0]],"common":{"the":1},"searchIndex":{"say":[0]}})";
const char* const kIndexB =
    R"({"pages":[["b.html","Ä/B"]],"info":[["b\n",0]],"common":{},"searchIndex":{"say":[0],"b":[0]}})";
const char* const kTocA =
    R"({"link":"toc","title":"toc","children":[{"link":"a.html","title":"Say \"A\"","children":null}]})";
const char* const kTocB =
    R"({"link":"toc","title":"toc","children":[{"link":"null","title":"B","children":[{"link":"b.html","title":"","children":[]}]}]})";

void AddModule(const TemporaryDirectory& directory, const std::string& modulePath, const std::string& index,
               const std::string& toc)
{
    WriteFile(directory / (modulePath + "/docdata/index.json"), index);
    WriteFile(directory / (modulePath + "/docdata/toc.json"), toc);
}

/// Returns every file that is not an input of a module, by its path.
std::map<std::string, std::string> Outputs(const TemporaryDirectory& directory)
{
    std::map<std::string, std::string> outputs;
    for (const auto& [path, content] : ReadTree(directory.Path()))
    {
        const std::string name = std::filesystem::path(path).filename();
        if (name != "index.json" && name != "toc.json")
        {
            outputs[path] = content;
        }
    }
    return outputs;
}

/// Returns the path of every file that is not an input of a module, each on a line.
std::string OutputNames(const TemporaryDirectory& directory)
{
    std::string names;
    for (const auto& [path, content] : Outputs(directory))
    {
        names += path + "\n";
    }
    return names;
}

const char* const kIndexJson =
    R"({"pages":[["a.html","Say \"A\"",0],["b.html","Ä/B",1]],"info":[["About \"A\"",0],["b\n",1]],"common":{"the":1},"searchIndex":{"say":[0,1],"b":[1]}})";
const char* const kTocJson =
    R"({"link":"toc","title":"toc","children":[{"link":"a.html","title":"Say \"A\"","children":null,"module":0},{"link":"null","title":"B","children":[{"link":"b.html","title":"","children":[],"module":1}],"module":1}],"module":0})";

std::string Pretty(const char* json)
{
    return std::string(TextOf(RenderPrettyJson(ParsedJson(json))));
}

const char* const kIndexScript = R"(pages = [
[p0 + "a.html", "Say \"A\""],
[p1 + "b.html", "Ä/B"]
];
info = [["About \"A\"",0],["b\n",1]]
common = {"the":1};
searchIndex = {"say":[0,1],"b":[1]};
)";

const char* const kTocScript = R"(toc = {
"link": "toc","title": "toc","children": [{"link": p0+"a.html","title": "Say \"A\"","children": null},{"link": "null","title": "B","children": [{"link": p1+"b.html","title": "","children": []}]}]};
)";

} // namespace

TEST(DocumentationSet, EveryModuleReceivesAllFourFiles)
{
    const TemporaryDirectory directory;
    AddModule(directory, "docs/a/Manual", kIndexA, kTocA);
    AddModule(directory, "docs/b/Manual", kIndexB, kTocB);
    AddModule(directory, "docs/c/Manual", "{}", "{}"); // is skipped, but receives the files
    WriteFile(directory / "docs/a/Manual/docdata/global_toc.js",
              "of an earlier run, and longer than what follows");
    WriteFile(directory / "docs/b/Manual/docdata/global_index.js.tmp", "of a killed run");

    EXPECT_EQ(R"(executing Pagemeld
WARNING: #IndexCombiner:290 Pages is not an array or absent
WARNING: #TocCombiner:372 Title is non-string or absent
WARNING: #RapidJsonIoUtil:47 Unable to read @/docs/a/ScriptReference/docdata/index.json
WARNING: #RapidJsonIoUtil:47 Unable to read @/docs/b/ScriptReference/docdata/index.json
WARNING: #RapidJsonIoUtil:47 Unable to read @/docs/c/ScriptReference/docdata/index.json
status 0
)",
              RunPagemeld(directory, {"-autopaths", "@\\docs"}));
    std::map<std::string, std::string> expected;
    const std::string prefixes[][2] = {
        {"a", "var p0 = \"\";\nvar p1 = \"../../b/Manual/\";\n"},
        {"b", "var p0 = \"../../a/Manual/\";\nvar p1 = \"\";\n"},
        {"c", "var p0 = \"../../a/Manual/\";\nvar p1 = \"../../b/Manual/\";\n"}};
    for (const auto& [module, lines] : prefixes)
    {
        const std::string docdata = "docs/" + module + "/Manual/docdata/";
        expected[docdata + "global_index.json"] = Pretty(kIndexJson);
        expected[docdata + "global_index.js"] = lines + kIndexScript;
        expected[docdata + "global_toc.json"] = Pretty(kTocJson);
        expected[docdata + "global_toc.js"] = lines + kTocScript;

        const ProgramResult check = RunProgram(NODE_PROGRAM, {CHECK_SCRIPTS, directory / docdata});
        EXPECT_EQ("2 pages, 2 terms\n", check.standardOutput) << check.standardError;
    }
    EXPECT_EQ(expected, Outputs(directory));
}

TEST(DocumentationSet, SetsAreIndependentAndPathsAreUsedAsGiven)
{
    const TemporaryDirectory directory;
    AddModule(directory, "a/Manual", kIndexA, "[]"); // no table of contents at all: the set is not written
    AddModule(directory, "b/Manual", kIndexB, R"({"link":"l","title":"t"})");
    AddModule(directory, "b/ScriptReference", kIndexB, kTocB);
    WriteFile(directory / "a/Manual/docdata/global_toc.js", "stale");
    std::filesystem::create_directories(directory / "a/ScriptReference/docdata");
    EXPECT_EQ(R"(executing Pagemeld
WARNING: #TocCombiner:372 Title is non-string or absent
WARNING: #TocCombiner:382 Children is not an array or null
WARNING: #RapidJsonIoUtil:47 Unable to read @/a//ScriptReference/docdata/index.json
WARNING: #RapidJsonIoUtil:47 Unable to read @/a//ScriptReference/docdata/toc.json
status 0
)",
              RunPagemeld(directory, {"@/a/", "@/b"}));
    EXPECT_EQ(R"(a/Manual/docdata/global_toc.js
a/ScriptReference/docdata/global_index.js
a/ScriptReference/docdata/global_index.json
a/ScriptReference/docdata/global_toc.js
a/ScriptReference/docdata/global_toc.json
b/ScriptReference/docdata/global_index.js
b/ScriptReference/docdata/global_index.json
b/ScriptReference/docdata/global_toc.js
b/ScriptReference/docdata/global_toc.json
)",
              OutputNames(directory));
    EXPECT_EQ("stale", ReadFile(directory / "a/Manual/docdata/global_toc.js"));
    EXPECT_EQ(R"(var p0 = "../../../b/ScriptReference/";
toc = {
"link": "toc","title": "toc","children": [{"link": "null","title": "B","children": [{"link": p0+"b.html","title": "","children": []}]}]};
)",
              ReadFile(directory / "a/ScriptReference/docdata/global_toc.js"));
}

TEST(DocumentationSet, OnlyAnUnwritableIndexScriptEndsTheRun)
{
    const TemporaryDirectory directory;
    for (const char* modulePath : {"a/Manual", "c/Manual", "a/ScriptReference", "c/ScriptReference"})
    {
        AddModule(directory, modulePath, kIndexA, kTocA);
    }
    std::filesystem::create_directory(directory / "a/Manual/docdata/global_toc.js.tmp");
    EXPECT_EQ(R"(executing Pagemeld
WARNING: #RapidJsonIoUtil:47 Unable to read @/b/Manual/docdata/index.json
WARNING: #RapidJsonIoUtil:47 Unable to read @/b/Manual/docdata/toc.json
ERROR: #TocCombiner:314 Failed to open output file @/a/Manual/docdata/global_toc.js.tmp
WARNING: #RapidJsonIoUtil:23 Failed to open @/b/Manual/docdata/global_index.json.tmp for writing
CRITICAL: #IndexCombiner:176 Unable to open file @/b/Manual/docdata/global_index.js.tmp for writingstatus 255
)",
              RunPagemeld(directory, {"@/a", "@/b", "@/c"}));
    EXPECT_EQ(R"(a/Manual/docdata/global_index.js
a/Manual/docdata/global_index.json
a/Manual/docdata/global_toc.json
)",
              OutputNames(directory));
}
