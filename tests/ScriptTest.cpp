#include "Tools/DocTools/VantorPagemeld/Render/IndexScript.h"
#include "Tools/DocTools/VantorPagemeld/Render/TocScript.h"
#include "Tools/DocTools/VantorPagemeld/System/ScopedFile.h"
#include "Tools/DocTools/VantorPagemeld/TocCombiner.h"
#include "tests/support/CapturedStderr.h"
#include "tests/support/Files.h"
#include "tests/support/ParsedJson.h"
#include "tests/support/TemporaryDirectory.h"

#include <gtest/gtest.h>

namespace
{

std::string TocScript(const std::string& json, const TocScriptLayout& layout)
{
    return std::string(TextOf(RenderTocScript(ParsedJson(json), layout)));
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

TEST(TocScript, PutsPrefixesBeforeLinksAndEscapesQuotes)
{
    const struct
    {
        const char* toc;
        const char* script;
    } cases[] = {
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

TEST(TocScript, LayoutOptionsAddSpacesAndLineBreaks)
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

TEST(ScriptWriting, FailedWritesOfPiecesOfATocAreReported)
{
    TocCombiner toc;
    const rapidjson::Document node = ParsedJson(R"({"link":"a","title":"A","children":[],"module":1})");
    const TemporaryDirectory directory;
    for (const std::string& path : {directory / "script", std::string("/dev/full")})
    {
        const ScopedFile file(std::fopen(path.c_str(), "wb"));
        (void)std::setvbuf(file.get(), nullptr, _IONBF, 0);
        const bool isWritten = path != "/dev/full";
        EXPECT_EQ(isWritten, toc.WriteQuotedStringPlusExtra(file.get(), "say \"a\"", ": ", 3, true));
        EXPECT_EQ(isWritten, toc.OutputValueAsJs(file.get(), node, 0));
    }
    EXPECT_EQ("\"say \\\"a\\\"\": \n{\"link\": p1+\"a\",\"title\": \"A\",\"children\": []}",
              ReadFile(directory / "script"));
}

TEST(ScriptWriting, TocWithoutALinkWritesNoFile)
{
    const TemporaryDirectory directory;
    TocCombiner toc;
    CapturedStderr captured;
    for (const char* json : {"{}", R"({"link":"l"})", R"({"title":"t","children":[]})"})
    {
        EXPECT_FALSE(toc.OutputJsonValueAsJs("m", ParsedJson(json), (directory / "script").c_str())) << json;
    }
    EXPECT_EQ("", captured.Text());
    EXPECT_TRUE(ReadTree(directory.Path()).empty());
}
