#include "Tools/DocTools/VantorPagemeld/RapidJsonIoUtil.h"
#include "tests/support/CapturedStderr.h"
#include "tests/support/NeutralText.h"
#include "tests/support/ParsedJson.h"
#include "tests/support/Repeated.h"
#include "tests/support/TemporaryFolder.h"
#include "tests/support/WholeFile.h"

#include <gtest/gtest.h>

#include <csignal>
#include <cstdlib>
#include <cstring>
#include <filesystem>
#include <fstream>

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

namespace
{

int s_leased = -1; ///< the file that a signal handler gives back

const std::string kTag = "./Tools/DocTools/VantorPagemeld/RapidJsonIoUtil:";

/// Reads a file into a document, and returns what was reported, with @ for the path; "read" when it was
/// accepted.
std::string Read(const std::string& path, rapidjson::Document& document)
{
    CapturedStderr captured;
    const bool wasRead = RapidJsonIoUtil::TryGetJsonDocFromFile(path.c_str(), document);
    return (wasRead ? "read" : "") + ReplaceAll(captured.Text(), path, "@");
}

std::string ParseError(int offset)
{
    return "ERROR: " + kTag + "71 Failed to parse JSON file @, error at offset: " + std::to_string(offset) +
           "\n";
}

} // namespace

TEST(JsonReading, AcceptsOneRootOrNamesTheOffset)
{
    const struct
    {
        std::string text;
        std::string report;
    } cases[] = {
        {"null", "read"},
        {" \t\r\n7 \t\r\n", "read"},
        {"\"x\"", "read"},
        {"", ParseError(0)},
        {" \n ", ParseError(3)},
        {"[1] 2", ParseError(4)},
        {"[1,]", ParseError(3)},
        {"// no comments\n1", ParseError(0)},
        {"[NaN]", ParseError(1)},
        {"\xEF\xBB\xBF{}", ParseError(0)},
        {std::string("[1]\0]", 5), "read"}, // what stands behind a NUL is not seen
        {std::string("[1\0]", 4), ParseError(2)},
        {"[\"\x1A\"]", ParseError(2)},
        {"[\"\x1F\"]", ParseError(2)},
        {"[1.7976931348623157e308,1e-400,18446744073709551616]", "read"},
        {"[12, 1.8e308]", ParseError(5)}, // becomes an infinity
        {"[12, -1e309, 1]", ParseError(5)},
        {Repeated("[", 10'000) + Repeated("]", 10'000), "read"},
        {Repeated("[", 10'001) + Repeated("]", 10'001), ParseError(10'001)},
        {Repeated("{\"a\":", 10'000) + "1" + Repeated("}", 10'000), "read"},
        {Repeated("{\"a\":", 10'001) + "1" + Repeated("}", 10'001), ParseError(50'001)},
        {Repeated("[{\"a\":", 5'000) + "[" + Repeated("}]", 5'000), ParseError(30'001)},
        {"[" + Repeated("[[{}]],", 10'000) + "1]", "read"}, // many, but not inside one another
    };
    const TemporaryFolder folder;
    for (const auto& c : cases)
    {
        WriteWholeFile(folder / "file", c.text);
        rapidjson::Document document;
        EXPECT_EQ(c.report, Read(folder / "file", document)) << c.text.substr(0, 80);
        EXPECT_EQ(c.report == "read", RapidJsonIoUtil::TryGetJsonDocFromString(c.text.c_str(), document))
            << c.text.substr(0, 80);
    }
}

TEST(JsonReading, WarnsOfWhatHasNoTextToRead)
{
    const TemporaryFolder folder;
    std::filesystem::create_directory(folder / "folder");
    ASSERT_EQ(0, ::mkfifo((folder / "pipe").c_str(), 0600));
    std::ofstream(folder / "huge").put(' ');
    std::filesystem::resize_file(folder / "huge", (std::uintmax_t(1) << 32) + 5);

    const std::string unread = "WARNING: " + kTag + "60 Unable to read entire file @, requested ";
    rapidjson::Document document = ParsedJson("[1]");
    EXPECT_EQ("WARNING: " + kTag + "47 Unable to read @\n", Read(folder / "missing", document));
    EXPECT_EQ(unread + "-1, got 0 bytes\n", Read(folder / "pipe", document));
    EXPECT_EQ(unread + "5, got 0 bytes\n", Read(folder / "huge", document)); // in 32 bits
    EXPECT_EQ(unread + "-1, got 0 bytes\n", Read(folder / "folder", document));
    EXPECT_EQ(unread + "-1, got 0 bytes\n", Read("/proc", document)); // a folder of size 0
    EXPECT_EQ("[1]", RapidJsonIoUtil::OutputJsonValueToString(document))
        << "an unread file leaves the document alone";
}

TEST(JsonReading, WaitsForALeaseToBeGivenBack)
{
    const TemporaryFolder folder;
    WriteWholeFile(folder / "file", "[1]");
    s_leased = ::open((folder / "file").c_str(), O_RDWR);
    const auto handler = std::signal(SIGIO, [](int) { (void)::fcntl(s_leased, F_SETLEASE, F_UNLCK); });
    if (::fcntl(s_leased, F_SETLEASE, F_WRLCK) != 0)
    {
        GTEST_SKIP() << "no leases here";
    }
    rapidjson::Document document;
    EXPECT_EQ("read", Read(folder / "file", document));
    (void)std::signal(SIGIO, handler);
    ::close(s_leased);
}

TEST(JsonReading, DocumentTellsTheOutcomeOfTheLastParse)
{
    rapidjson::Document document = ParsedJson(R"({"old":[1,"text that is not short"]})");
    EXPECT_FALSE(RapidJsonIoUtil::TryGetJsonDocFromString("[[1,2,\"x\"], oops", document));
    EXPECT_TRUE(document.IsNull());
    EXPECT_TRUE(document.HasParseError());
    EXPECT_EQ(12U, document.GetErrorOffset());
    EXPECT_TRUE(RapidJsonIoUtil::TryGetJsonDocFromString("[2]", document));
    EXPECT_FALSE(document.HasParseError());
    EXPECT_EQ("[2]", RapidJsonIoUtil::OutputJsonValueToString(document));
}

TEST(JsonReading, LongExponentsOverflowNothing)
{
    const char* const text =
        R"([0.00000000001e-2147483639,-1.5E-99999999999,"\"0.00000000001e-2147483639",2.5e-00000000001,x)";
    rapidjson::Document document;
    EXPECT_FALSE(RapidJsonIoUtil::TryGetJsonDocFromString(text, document));
    EXPECT_EQ(std::strlen(text) - 1, document.GetErrorOffset());
    EXPECT_TRUE(RapidJsonIoUtil::TryGetJsonDocFromString(ReplaceAll(text, ",x", "]").c_str(), document));
    EXPECT_EQ(R"([0.0,-0.0,"\"0.00000000001e-2147483639",0.25])",
              RapidJsonIoUtil::OutputJsonValueToString(document));
}

TEST(JsonReading, MoreThanABillionDigitsAreRefusedWhereTheyBegin)
{
#ifdef __SANITIZE_ADDRESS__
    GTEST_SKIP() << "the sanitizer would take seconds for a text so long";
#endif
    std::string text = "0.";
    text.resize(1'000'000'003, '0');
    rapidjson::Document document;
    EXPECT_FALSE(RapidJsonIoUtil::TryGetJsonDocFromString(text.c_str(), document));
    EXPECT_EQ(2U, document.GetErrorOffset());
}

TEST(JsonReading, PublicSuiteHasTheExpectedOutcomes)
{
    const char* const ownPlace = std::getenv("PAGEMELD_JSON_SUITE");
    const std::string suite = ownPlace != nullptr ? ownPlace : PAGEMELD_JSON_SUITE;
    std::ifstream expected(suite + "/expected.tsv");
    if (!expected)
    {
        GTEST_SKIP() << "no suite in " << suite;
    }
    int count = 0;
    std::string outcome;
    int offset = 0;
    for (std::string name; expected >> name >> outcome >> offset; ++count)
    {
        rapidjson::Document document;
        EXPECT_EQ(outcome == "accept" ? "read" : ParseError(offset), Read(suite + "/" + name, document))
            << name;
    }
    EXPECT_EQ(318, count);
}
