#include "Tools/DocTools/VantorPagemeld/Check/IndexStructure.h"
#include "Tools/DocTools/VantorPagemeld/Check/TocStructure.h"
#include "Tools/DocTools/VantorPagemeld/IndexCombiner.h"
#include "Tools/DocTools/VantorPagemeld/TocCombiner.h"
#include "tests/support/CapturedStderr.h"
#include "tests/support/ParsedJson.h"

#include <gtest/gtest.h>
#include <rapidjson/pointer.h>

namespace
{

struct StructureCase
{
    const char* json;
    const char* message; ///< the number and text of the first fault; empty if there is none
    const char* faults;  ///< every fault: its number and its place
};

/// Refuses what a derived class may refuse beyond the format: a node with the title "secret".
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
              [&](const StructureFault& fault, const JsonPointer& pointer, const rapidjson::Value& value)
              {
                  const std::string where = pointer.Text();
                  EXPECT_EQ(&value, rapidjson::Pointer(where.c_str()).Get(document)) << where;
                  faults += std::to_string(fault.number) + where + " ";
                  return true;
              });
    return wentOn ? faults : faults + "stopped";
}

template <class Combiner, class Check>
void ExpectStructure(const StructureCase& c, const std::string& tag, Check check)
{
    Combiner combiner;
    const rapidjson::Document document = ParsedJson(c.json);
    const std::string message = c.message;
    const bool isSound = std::string(c.faults).empty();
    EXPECT_EQ((isSound ? "sound " : "refused ") + (message.empty() ? "" : "WARNING: " + tag + message + "\n"),
              Verify(combiner, document))
        << c.json;
    EXPECT_EQ(c.faults, AllFaults(check, document)) << c.json;
}

} // namespace

TEST(IndexStructure, FirstFaultIsReportedAndEveryFaultIsFound)
{
    const StructureCase cases[] = {
        {R"({"pages":[],"info":[],"common":{},"searchIndex":{}})", "", ""},
        {R"({"x":[[]],"searchIndex":{"a":[0,1,0],"a":[]},"common":{"a":1},"info":[["t",0],["u",1]],"pages":[["",""],["a","b"]]})",
         "", ""},
        {"[]", "", "0 "}, // refused without a message
        {"null", "", "0 "},
        {"\"pages\"", "", "0 "},
        {"{}", "290 Pages is not an array or absent", "290 296 302 308 "},
        {R"({"pages":{},"common":{},"searchIndex":{}})", "290 Pages is not an array or absent",
         "290/pages 296 "},
        {R"({"pages":[],"common":[],"searchIndex":[]})", "296 Info is not an array or absent",
         "296 302/common 308/searchIndex "},
        {R"({"pages":[],"info":[],"common":null,"searchIndex":0})", "302 Common is not an object or absent",
         "302/common 308/searchIndex "},
        {R"({"pages":[],"info":[],"common":{},"searchIndex":[]})",
         "308 SearchIndex is not an object or absent", "308/searchIndex "},
        {R"({"pages":1,"pages":[],"info":[],"common":{},"searchIndex":{}})", // the first of a name counts
         "290 Pages is not an array or absent", "290/pages "},
        {R"({"pages":[["a","b",0],["a"],{},["a","b"]],"info":[],"common":{},"searchIndex":{}})",
         "318 Content in pages is not an array of 2 elements", "318/pages/0 318/pages/1 318/pages/2 "},
        {R"({"pages":[["a","b"],["a",1],[null,"b"],7],"info":[],"common":{},"searchIndex":{}})",
         "327 Content in pages sub-element is not a string", "327/pages/1 327/pages/2 318/pages/3 "},
        {R"({"pages":[],"info":["t",["t",0,0]],"common":{},"searchIndex":{}})",
         "340 Content in info is not an array of 2 elements", "340/info/0 340/info/1 "},
        {R"({"pages":[],"info":[[0,"t"]],"common":{},"searchIndex":{}})",
         "345 1st item in info sub-element is not a string", "345/info/0 "},
        {R"({"pages":[["a","b"]],"info":[["t",0.0],["t",2147483648],["t",-2147483649],["t",true],["t","0"]],"common":{},"searchIndex":{}})",
         "350 2nd item in info sub-element is not an int",
         "350/info/0 350/info/1 350/info/2 350/info/3 350/info/4 "},
        {R"({"pages":[["a","b"]],"info":[["t",-0],["t",1],["t",-1],["t",-2147483648]],"common":{},"searchIndex":{}})",
         "356 2nd item in info sub-element is out of bounds", "356/info/1 356/info/2 356/info/3 "},
        {R"({"pages":[],"info":[],"common":{"a":1,"b":2,"c":1.0,"d":true,"e":"1","f/~":4294967297},"searchIndex":{}})",
         "371 Value in common is not an int(1)",
         "371/common/b 371/common/c 371/common/d 371/common/e 371/common/f~1~0 "},
        {R"({"pages":[],"info":[],"common":{},"searchIndex":{"a":[],"b":{},"c":null}})",
         "387 Value in searchIndex is not array", "387/searchIndex/b 387/searchIndex/c "},
        {R"({"pages":[["a","b"]],"info":[["t",0]],"common":{},"searchIndex":{"":[0,"0",0.0,[0]],"a":[0,1]}})",
         "396 Value in index is not int",
         "396/searchIndex//1 396/searchIndex//2 396/searchIndex//3 401/searchIndex/a/1 "},
        {R"({"pages":[["a","b"]],"info":[["t",0]],"common":{},"searchIndex":{"a":[0,0,1,-1]}})",
         "401 Value in index is out of bounds", "401/searchIndex/a/2 401/searchIndex/a/3 "},
        {R"({"pages":0,"info":[["t",5]],"common":{},"searchIndex":{"a":[0]}})", // no pages to refer to
         "290 Pages is not an array or absent", "290/pages "},
        {R"({"pages":[["A","A"]],"info":[["A text",0]],"common":{"a":1},"searchIndex":{"a":[1]}})",
         "401 Value in index is out of bounds", "401/searchIndex/a/0 "},
    };
    for (const StructureCase& c : cases)
    {
        ExpectStructure<IndexCombiner>(c,
                                       "./Tools/DocTools/VantorPagemeld/IndexCombiner:", CheckIndexStructure);
    }
}

TEST(TocStructure, FirstFaultIsReportedAndEveryFaultIsFound)
{
    const char* const noTitle = "372 Title is non-string or absent";
    const char* const noLink = "377 Link is non-string or absent";
    const char* const noChildren = "382 Children is not an array or null";
    const StructureCase cases[] = {
        {R"({"link":"toc","title":"toc","children":null})", "", ""},
        {R"({"children":[{"title":"","children":[],"link":"","module":"x","more":[{}]}],"title":"t","link":"null"})",
         "", ""},
        {"{}", noTitle, "372 377 382 "},
        {"[]", noTitle, "372 "},
        {"null", noTitle, "372 "},
        {R"({"title":1})", noTitle, "372/title 377 382 "},
        {R"({"Title":"t","link":"l","children":null})", noTitle, "372 "},
        {R"({"title":"t","link":null,"children":null})", noLink, "377/link "},
        {R"({"title":"t","link":1,"link":"l","children":null})", noLink,
         "377/link "}, // the first of a name counts
        {R"({"title":"t","link":"l"})", noChildren, "382 "},
        {R"({"title":"t","link":"l","children":{}})", noChildren, "382/children "},
        {R"({"title":"t","link":"l","children":"null"})", noChildren, "382/children "},
        {R"({"title":"t","link":"l","children":[{"title":"a","link":"a","children":null},7,{"title":"b","link":"b","children":[{"title":"c","link":1,"children":0}]},{"link":""}]})",
         noTitle,
         "372/children/1 377/children/2/children/0/link 382/children/2/children/0/children "
         "372/children/3 382/children/3 "},
        {R"({"title":"t","link":"l","children":[{"title":"b","link":"b","children":[{"title":"c","children":[{}]}]}]})",
         noLink,
         "377/children/0/children/0 372/children/0/children/0/children/0 "
         "377/children/0/children/0/children/0 "
         "382/children/0/children/0/children/0 "},
    };
    for (const StructureCase& c : cases)
    {
        ExpectStructure<TocCombiner>(c, "./Tools/DocTools/VantorPagemeld/TocCombiner:", CheckTocStructure);
    }
}

TEST(TocStructure, OverridingCombinerIsAskedForEveryNode)
{
    SecretiveCombiner combiner;
    EXPECT_EQ("refused ",
              Verify(combiner, ParsedJson(R"({"link":"l","title":"t","children":[{"link":"a","title":"a",
        "children":[{"link":"b","title":"secret","children":null}]}]})")));
}
