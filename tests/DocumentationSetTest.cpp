#include "tests/support/RunProgram.h"
#include "tests/support/WholeFile.h"

#include <gtest/gtest.h>

#include <filesystem>

// Texts say @ for the temporary folder.

namespace
{

using Tree = std::map<std::string, std::string>;

const char* const kIndexA =
    R"({"pages":[["a.html","Say \"A\""]],"info":[["About \"A\"",0]],"common":{"the":1},"searchIndex":{"say":[0]}})";
const char* const kIndexB =
    R"({"pages":[["b.html","Ä/B"]],"info":[["b\n",0]],"common":{},"searchIndex":{"say":[0],"b":[0]}})";
const char* const kTocA =
    R"({"link":"toc","title":"toc","children":[{"link":"null","title":"G","children":[{"link":"a.html","title":"Say \"A\"","children":null}]}]})";
const char* const kTocB =
    R"({"link":"toc","title":"toc","children":[{"link":"null","title":"G","children":[{"link":"b.html","title":"B","children":[]}]}]})";

void AddModule(const TemporaryFolder& folder, const std::string& modulePath, const std::string& index,
               const std::string& toc)
{
    WriteWholeFile(folder / (modulePath + "/docdata/index.json"), index);
    WriteWholeFile(folder / (modulePath + "/docdata/toc.json"), toc);
}

/// Returns every file that is no input of a module.
Tree Outputs(const TemporaryFolder& folder)
{
    Tree outputs;
    for (const auto& [path, content] : ReadTree(folder.Path()))
    {
        const std::string name = std::filesystem::path(path).filename();
        if (name != "index.json" && name != "toc.json")
        {
            outputs[path] = content;
        }
    }
    return outputs;
}

std::string Names(const Tree& files)
{
    std::string names;
    for (const auto& [path, content] : files)
    {
        names += path + "\n";
    }
    return names;
}

const char* const kIndexJson = R"({
    "pages": [
        [
            "a.html",
            "Say \"A\"",
            0
        ],
        [
            "b.html",
            "Ä/B",
            1
        ]
    ],
    "info": [
        [
            "About \"A\"",
            0
        ],
        [
            "b\n",
            1
        ]
    ],
    "common": {
        "the": 1
    },
    "searchIndex": {
        "say": [
            0,
            1
        ],
        "b": [
            1
        ]
    }
})";

const char* const kTocJson = R"({
    "link": "toc",
    "title": "toc",
    "children": [
        {
            "link": "null",
            "title": "G",
            "children": [
                {
                    "link": "a.html",
                    "title": "Say \"A\"",
                    "children": null,
                    "module": 0
                },
                {
                    "link": "b.html",
                    "title": "B",
                    "children": [],
                    "module": 1
                }
            ],
            "module": 0
        }
    ],
    "module": 0
})";

std::string IndexScript(const std::string& prefixes)
{
    return prefixes + R"(pages = [
[p0 + "a.html", "Say \"A\""],
[p1 + "b.html", "Ä/B"]
];
info = [["About \"A\"",0],["b\n",1]]
common = {"the":1};
searchIndex = {"say":[0,1],"b":[1]};
)";
}

std::string TocScript(const std::string& prefixes)
{
    return prefixes + R"(toc = {
"link": "toc","title": "toc","children": [{"link": "null","title": "G","children": [{"link": p0+"a.html","title": "Say \"A\"","children": null},{"link": p1+"b.html","title": "B","children": []}]}]};
)";
}

} // namespace

TEST(DocumentationSet, EveryModuleReceivesAllFourFiles)
{
    const TemporaryFolder folder;
    AddModule(folder, "docs/a/Manual", kIndexA, kTocA);
    AddModule(folder, "docs/b/Manual", kIndexB, kTocB);
    AddModule(folder, "docs/c/Manual", "{}", "{}"); // is skipped, but receives the files
    WriteWholeFile(folder / "docs/a/Manual/docdata/global_toc.js",
                   "of an earlier run, and longer than what follows it");
    WriteWholeFile(folder / "docs/b/Manual/docdata/global_index.js.tmp", "left behind");

    EXPECT_EQ("executing Pagemeld\n"
              "WARNING: ./Tools/DocTools/VantorPagemeld/IndexCombiner:290 Pages is not an array or absent\n"
              "WARNING: ./Tools/DocTools/VantorPagemeld/TocCombiner:372 Title is non-string or absent\n"
              "WARNING: ./Tools/DocTools/VantorPagemeld/RapidJsonIoUtil:47 Unable to read "
              "@/docs/a/ScriptReference/docdata/index.json\n"
              "WARNING: ./Tools/DocTools/VantorPagemeld/RapidJsonIoUtil:47 Unable to read "
              "@/docs/b/ScriptReference/docdata/index.json\n"
              "WARNING: ./Tools/DocTools/VantorPagemeld/RapidJsonIoUtil:47 Unable to read "
              "@/docs/c/ScriptReference/docdata/index.json\n"
              "status 0\n",
              ReportOfRun(folder, {"-autopaths", "@\\docs"}));
    Tree expected;
    const char* const prefixes[][2] = {
        {"a", "var p0 = \"\";\nvar p1 = \"../../b/Manual/\";\n"},
        {"b", "var p0 = \"../../a/Manual/\";\nvar p1 = \"\";\n"},
        {"c", "var p0 = \"../../a/Manual/\";\nvar p1 = \"../../b/Manual/\";\n"}};
    for (const auto& [module, lines] : prefixes)
    {
        const std::string docdata = std::string("docs/") + module + "/Manual/docdata/";
        expected[docdata + "global_index.json"] = kIndexJson;
        expected[docdata + "global_index.js"] = IndexScript(lines);
        expected[docdata + "global_toc.json"] = kTocJson;
        expected[docdata + "global_toc.js"] = TocScript(lines);

        const ProgramResult check = RunProgram(NODE_PROGRAM, {CHECK_SCRIPTS, folder / docdata});
        EXPECT_EQ("2 pages, 2 terms\n", check.standardOutput) << check.standardError;
        EXPECT_EQ(0, check.status);
    }
    EXPECT_EQ(expected, Outputs(folder));
}

TEST(DocumentationSet, SetsAreIndependentAndPathsAreUsedAsGiven)
{
    const TemporaryFolder folder;
    AddModule(folder, "a/Manual", kIndexA,
              "[]"); // without any table of contents nothing of the set is written
    AddModule(folder, "b/Manual", kIndexB, R"({"link":"l","title":"t"})");
    AddModule(folder, "b/ScriptReference", kIndexB, kTocB);
    WriteWholeFile(folder / "a/Manual/docdata/global_toc.js", "stale");
    std::filesystem::create_directories(folder / "a/ScriptReference/docdata");
    EXPECT_EQ("executing Pagemeld\n"
              "WARNING: ./Tools/DocTools/VantorPagemeld/TocCombiner:372 Title is non-string or absent\n"
              "WARNING: ./Tools/DocTools/VantorPagemeld/TocCombiner:382 Children is not an array or null\n"
              "WARNING: ./Tools/DocTools/VantorPagemeld/RapidJsonIoUtil:47 Unable to read "
              "@/a//ScriptReference/docdata/index.json\n"
              "WARNING: ./Tools/DocTools/VantorPagemeld/RapidJsonIoUtil:47 Unable to read "
              "@/a//ScriptReference/docdata/toc.json\n"
              "status 0\n",
              ReportOfRun(folder, {"@/a/", "@/b"}));

    const Tree outputs = Outputs(folder);
    EXPECT_EQ("a/Manual/docdata/global_toc.js\n"
              "a/ScriptReference/docdata/global_index.js\na/ScriptReference/docdata/global_index.json\n"
              "a/ScriptReference/docdata/global_toc.js\na/ScriptReference/docdata/global_toc.json\n"
              "b/ScriptReference/docdata/global_index.js\nb/ScriptReference/docdata/global_index.json\n"
              "b/ScriptReference/docdata/global_toc.js\nb/ScriptReference/docdata/global_toc.json\n",
              Names(outputs));
    EXPECT_EQ("stale", outputs.at("a/Manual/docdata/global_toc.js"));
    EXPECT_EQ("var p0 = \"../../../b/ScriptReference/\";\npages = [\n[p0 + \"b.html\", \"Ä/B\"]\n];\ninfo = "
              "[[\"b\\n\",0]]\ncommon = {};\nsearchIndex = {\"say\":[0],\"b\":[0]};\n",
              outputs.at("a/ScriptReference/docdata/global_index.js"));
}

TEST(DocumentationSet, UnwritableSearchIndexScriptEndsTheRun)
{
    const TemporaryFolder folder;
    for (const char* module : {"a", "c"})
    {
        AddModule(folder, std::string(module) + "/Manual", kIndexA, kTocA);
        AddModule(folder, std::string(module) + "/ScriptReference", kIndexA, kTocA);
    }
    EXPECT_EQ("executing Pagemeld\n"
              "WARNING: ./Tools/DocTools/VantorPagemeld/RapidJsonIoUtil:47 Unable to read "
              "@/b/Manual/docdata/index.json\n"
              "WARNING: ./Tools/DocTools/VantorPagemeld/RapidJsonIoUtil:47 Unable to read "
              "@/b/Manual/docdata/toc.json\n"
              "WARNING: ./Tools/DocTools/VantorPagemeld/RapidJsonIoUtil:23 Failed to open "
              "@/b/Manual/docdata/global_index.json.tmp for writing\n"
              "CRITICAL: ./Tools/DocTools/VantorPagemeld/IndexCombiner:176 Unable to open file "
              "@/b/Manual/docdata/global_index.js.tmp for writingstatus 255\n",
              ReportOfRun(folder, {"@/a", "@/b", "@/c"}));
    EXPECT_EQ("a/Manual/docdata/global_index.js\na/Manual/docdata/global_index.json\na/Manual/docdata/"
              "global_toc.js\n"
              "a/Manual/docdata/global_toc.json\n",
              Names(Outputs(folder)));
}
