#include "Tools/DocTools/VantorPagemeld/IndexCombiner.h"
#include "Tools/DocTools/VantorPagemeld/Script/IndexScript.h"
#include "Tools/DocTools/VantorPagemeld/Script/TocScript.h"
#include "Tools/DocTools/VantorPagemeld/TocCombiner.h"
#include "tests/support/CapturedStderr.h"
#include "tests/support/FullDevice.h"
#include "tests/support/MergedModules.h"
#include "tests/support/TemporaryFolder.h"
#include "tests/support/WholeFile.h"

#include <gtest/gtest.h>

#include <filesystem>

namespace
{

/// A combiner whose modules lie in /r/A/Manual/ and /r/B/Manual/.
template <class Combiner>
class PlacedCombiner : public Combiner
{
public:
    using Combiner::WriteScript;

    PlacedCombiner()
    {
        this->SetModulePathAtIndex(1, "(a path that is replaced)");
        this->SetModulePathAtIndex(1, "/r/B/Manual/");
        this->SetModulePathAtIndex(0, "/r/A/Manual/");
    }
};

using PlacedIndex = MergedModules<PlacedCombiner<IndexCombiner>>;
using PlacedToc = MergedModules<PlacedCombiner<TocCombiner>>;

const std::vector<std::string> kIndexModules = {
    R"({"pages":[["A","A"]],"info":[["A text",0]],"common":{"a":1},"searchIndex":{"a":[1]}})",
    R"({"pages":[["B","B"]],"info":[["B text",0]],"common":{"a":1},"searchIndex":{"b":[2]}})"};
const char* const kIndexScript =
    "var p0 = \"\";\nvar p1 = \"../../B/Manual/\";\npages = [\n[p0 + \"A\", \"A\"],\n[p1 + "
    "\"B\", \"B\"]\n];\ninfo = [[\"A text\",0],[\"B text\",1]]\ncommon = "
    "{\"a\":1};\nsearchIndex = {\"a\":[1],\"b\":[3]};\n";

const std::vector<std::string> kTocModules = {
    R"({"link":"toc","title":"toc","children":null})",
    R"({"link":"toc","title":"toc","children":[{"link":"null","title":"Classes","children":[{"link":"A","title":"A","children":null}]}]})"};
const char* const kTocScript = "var p0 = \"\";\nvar p1 = \"../../B/Manual/\";\ntoc = {\n\"link\": "
                               "\"toc\",\"title\": \"toc\",\"children\": "
                               "[{\"link\": \"null\",\"title\": \"Classes\",\"children\": [{\"link\": "
                               "p1+\"A\",\"title\": \"A\",\"children\": "
                               "null}]}]};\n";

/// Writes the combined document for the module /r/A/Manual. Returns whether that succeeded.
bool WriteScriptFile(JsonCombiner& combiner, const std::string& path)
{
    return combiner.OutputJsonValueAsJs("/r/A/Manual", combiner.combinedDocument, path.c_str());
}

/// Writes to a file on a full disk, and then to one that has room.
void ExpectWholeOrRemoved(JsonCombiner& combiner, const std::string& script)
{
    const TemporaryFolder folder;
    const std::string path = folder / "script";
    std::filesystem::create_symlink("/dev/full", path);
    EXPECT_FALSE(WriteScriptFile(combiner, path)) << "its bytes wait in a buffer until it is flushed";
    ASSERT_FALSE(std::filesystem::is_symlink(path)) << "a failed file is removed";
    EXPECT_TRUE(WriteScriptFile(combiner, path));
    EXPECT_EQ(script, ReadWholeFile(path));
}

/// Writes to a device that is full after so many bytes, for every number of bytes.
template <class Combiner>
void ExpectEachFailedWriteToCount(Combiner& combiner, const RenderedText& text, const std::string& script)
{
    for (std::size_t bytes = 0; bytes <= script.size(); ++bytes)
    {
        FullDevice device(bytes);
        EXPECT_EQ(bytes == script.size(), combiner.WriteScript("/r/A/Manual", text, device.Stream()))
            << bytes;
        EXPECT_EQ(script.substr(0, bytes), device.Arrived());
        FullDevice deviceOfPrefixes(bytes);
        EXPECT_EQ(bytes >= 41, combiner.OutputPrefixVars("/r/A/Manual", deviceOfPrefixes.Stream())) << bytes;
    }
}

std::string TocScript(const std::string& json, const TocScriptLayout& layout)
{
    const auto script = RenderTocScript(ParsedJson(json), layout);
    return script ? std::string(TextOf(*script)) : "(none)";
}

} // namespace

TEST(IndexScript, EscapesOnlyTheQuotesOfTitles)
{
    const struct
    {
        const char* index;
        const char* script;
    } cases[] = {
        {R"({"pages":[],"info":[],"common":{},"searchIndex":{}})",
         "pages = [\n];\ninfo = []\ncommon = {};\nsearchIndex = {};\n"},
        {R"({"pages":[["a\"\\\u0000x","\"t\"\\\n\u00e9\"\u0000y",12]],"info":[["\"i\"\u0000\n",0]],"common":{"\"":1},"searchIndex":{"\\\u0000":[0]}})",
         "pages = [\n[p12 + \"a\"\\\", \"\\\"t\\\"\\\n\xC3\xA9\\\"\"]\n];\ninfo = "
         "[[\"\\\"i\\\"\\u0000\\n\",0]]\ncommon = "
         "{\"\\\"\":1};\nsearchIndex = {\"\\\\\\u0000\":[0]};\n"},
    };
    for (const auto& c : cases)
    {
        EXPECT_EQ(c.script, TextOf(RenderIndexScript(ParsedJson(c.index)))) << c.index;
    }
}

TEST(TocScript, PutsLinksBehindTheirModulesAndEscapesQuotes)
{
    const struct
    {
        const char* toc;
        const char* script;
    } cases[] = {
        {R"({"title":"t","children":[]})", "(none)"},
        {R"({"link":"l","children":[]})", "(none)"},
        {R"({"link":"\"l\"","title":"\"t\"\\","children":null,"module":3})",
         "toc = {\n\"link\": \"\\\"l\\\"\",\"title\": \"\\\"t\\\"\\\",\"children\": []};\n"},
        {R"({"link":"l","title":"t","children":[{"link":"\"a\"\u0000x","title":"\"\u0000x","children":[],"module":2},{"link":"\"b\"","title":"\n","children":null}]})",
         "toc = {\n\"link\": \"l\",\"title\": \"t\",\"children\": [{\"link\": p2+\"\"a\"\",\"title\": "
         "\"\\\"\",\"children\": []},{\"link\": \"\\\"b\\\"\",\"title\": \"\n\",\"children\": null}]};\n"},
        {R"({"link":"l","title":"t","children":[{"link":"null","title":"","children":null},{"link":"a","title":"","children":null,"module":"p","module":1.0,"module":4,"module":5}]})",
         "toc = {\n\"link\": \"l\",\"title\": \"t\",\"children\": [{\"link\": \"null\",\"title\": "
         "\"\",\"children\": null},{\"link\": p4+\"a\",\"title\": \"\",\"children\": null}]};\n"},
    };
    for (const auto& c : cases)
    {
        EXPECT_EQ(c.script, TocScript(c.toc, {})) << c.toc;
    }
}

TEST(TocScript, LayoutOptionsAddBlanksAndLineBreaks)
{
    const char* const toc =
        R"({"link":"l","title":"t","children":[{"link":"a","title":"A","children":[{"link":"b",
        "title":"B","children":null}],"module":0},{"link":"null","title":"C","children":[],"module":0}]})";
    EXPECT_EQ(R"(toc = {
 "link": "l",
 "title": "t",
 "children": [
    {
     "link": p0+"a",
     "title": "A",
     "children": [
        {
         "link": "b",
         "title": "B",
         "children": null
        }
     ]
    }
    ,
    {
     "link": "null",
     "title": "C",
     "children": [
     ]
    }
]};
)",
              TocScript(toc, {true, true}));
    EXPECT_EQ(R"(toc = {
 "link": "l", "title": "t", "children": [    {     "link": p0+"a",     "title": "A",     "children": [        {         "link": "b",         "title": "B",         "children": null        }     ]    }    ,    {     "link": "null",     "title": "C",     "children": [     ]    }]};
)",
              TocScript(toc, {false, true}));
}

TEST(ScriptWriting, SucceedsOnlyIfEveryByteReachedTheFile)
{
    PlacedIndex index(kIndexModules);
    ExpectWholeOrRemoved(index.Get(), kIndexScript);
    ExpectEachFailedWriteToCount(index.Get(), RenderIndexScript(index.Get().combinedDocument), kIndexScript);
    PlacedToc toc(kTocModules);
    ExpectWholeOrRemoved(toc.Get(), kTocScript);
    ExpectEachFailedWriteToCount(toc.Get(), *toc.Get().RenderScript(toc.Get().combinedDocument), kTocScript);
}

TEST(ScriptWriting, PiecesOfATocTellOfAFailedWrite)
{
    TocCombiner toc;
    const rapidjson::Document node = ParsedJson(R"({"link":"a","title":"A","children":[],"module":1})");
    for (std::size_t bytes = 0; bytes <= 50; ++bytes)
    {
        FullDevice device(bytes);
        const std::string text =
            "\"say \\\"a\\\"\": \n{\"link\": p1+\"a\",\"title\": \"A\",\"children\": []}";
        EXPECT_EQ(bytes >= 14, toc.WriteQuotedStringPlusExtra(device.Stream(), "say \"a\"", ": ", 3, true))
            << bytes;
        EXPECT_EQ(bytes == text.size(), toc.OutputValueAsJs(device.Stream(), node, 0)) << bytes;
        EXPECT_EQ(text.substr(0, bytes), device.Arrived());
    }
}

TEST(ScriptWriting, FileThatCannotBeOpened)
{
    const TemporaryFolder folder;
    const std::string path = folder / "missing/script";
    PlacedIndex index(kIndexModules);
    PlacedToc toc(kTocModules);
    EXPECT_EXIT(WriteScriptFile(index.Get(), path), testing::ExitedWithCode(255),
                "^CRITICAL: ./Tools/DocTools/VantorPagemeld/IndexCombiner:176 Unable to open file "
                ".*/missing/script for writing$");
    CapturedStderr captured;
    EXPECT_FALSE(WriteScriptFile(toc.Get(), path));
    EXPECT_EQ("ERROR: ./Tools/DocTools/VantorPagemeld/TocCombiner:314 Failed to open output file " + path +
                  "\n",
              captured.Text());
}

TEST(ScriptWriting, TocWithoutALinkIsNoFile)
{
    const TemporaryFolder folder;
    TocCombiner toc;
    CapturedStderr captured;
    EXPECT_FALSE(WriteScriptFile(toc, folder / "script"));
    EXPECT_EQ("", captured.Text());
    EXPECT_TRUE(ReadTree(folder.Path()).empty());
}
