#include "Tools/DocTools/VantorPagemeld/RapidJsonIoUtil.h"
#include "Tools/DocTools/VantorPagemeld/Read/NumberGuard.h"
#include "tests/support/CapturedStderr.h"
#include "tests/support/Files.h"
#include "tests/support/ParsedJson.h"
#include "tests/support/Placeholders.h"
#include "tests/support/Repeated.h"
#include "tests/support/TemporaryDirectory.h"

#include <gtest/gtest.h>

#include <csignal>
#include <cstdlib>
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
        {"", ParseError(0)},
        {" \n ", ParseError(3)},
        {"// no comments\n1", ParseError(0)},
        {"[NaN]", ParseError(1)},
        {"\xEF\xBB\xBF{}", ParseError(0)},
        {std::string("[1]\0]", 5), "read"}, // text after a NUL is not seen
        {std::string("[1\0]", 4), ParseError(2)},
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
    const TemporaryDirectory directory;
    for (const auto& c : cases)
    {
        WriteFile(directory / "file", c.text);
        rapidjson::Document document;
        EXPECT_EQ(c.report, Read(directory / "file", document)) << c.text.substr(0, 80);
        EXPECT_EQ(c.report == "read", RapidJsonIoUtil::TryGetJsonDocFromString(c.text.c_str(), document))
            << c.text.substr(0, 80);
    }
}

TEST(JsonReading, WarnsAboutFilesThatCannotBeReadWhole)
{
    const TemporaryDirectory directory;
    std::filesystem::create_directory(directory / "directory");
    ASSERT_EQ(0, ::mkfifo((directory / "pipe").c_str(), 0600));
    std::ofstream(directory / "huge").put(' ');
    std::filesystem::resize_file(directory / "huge", (std::uintmax_t(1) << 32) + 5);

    const std::string unread = "WARNING: " + kTag + "60 Unable to read entire file @, requested ";
    rapidjson::Document document = ParsedJson("[1]");
    EXPECT_EQ("WARNING: " + kTag + "47 Unable to read @\n", Read(directory / "missing", document));
    EXPECT_EQ(unread + "-1, got 0 bytes\n", Read(directory / "pipe", document));
    EXPECT_EQ(unread + "5, got 0 bytes\n", Read(directory / "huge", document)); // in 32 bits
    EXPECT_EQ(unread + "-1, got 0 bytes\n", Read(directory / "directory", document));
    EXPECT_EQ(unread + "-1, got 0 bytes\n", Read("/proc", document)); // a directory of size 0
    EXPECT_EQ("[1]", RapidJsonIoUtil::OutputJsonValueToString(document))
        << "an unread file leaves the document alone";
}

TEST(JsonReading, WaitsForALeaseToBeGivenBack)
{
    const TemporaryDirectory directory;
    WriteFile(directory / "file", "[1]");
    s_leased = ::open((directory / "file").c_str(), O_RDWR);
    const auto handler = std::signal(SIGIO, [](int) { (void)::fcntl(s_leased, F_SETLEASE, F_UNLCK); });
    if (::fcntl(s_leased, F_SETLEASE, F_WRLCK) != 0)
    {
        GTEST_SKIP() << "no leases here";
    }
    rapidjson::Document document;
    EXPECT_EQ("read", Read(directory / "file", document));
    (void)std::signal(SIGIO, handler);
    ::close(s_leased);
}

TEST(JsonReading, DocumentCarriesTheErrorOfTheLastParse)
{
    const struct
    {
        const char* json;
        rapidjson::ParseErrorCode code;
        std::size_t offset;
    } cases[] = {
        {" ", rapidjson::kParseErrorDocumentEmpty, 1},
        {"[1] 2", rapidjson::kParseErrorDocumentRootNotSingular, 4},
        {"[1,]", rapidjson::kParseErrorValueInvalid, 3},
        {"{\"a\":1,}", rapidjson::kParseErrorObjectMissName, 7},
        {"[1e400]", rapidjson::kParseErrorNumberTooBig, 1},
        {"[0.00000000001e-2147483639,]", rapidjson::kParseErrorValueInvalid, 27},
        {"[1.8e308]", rapidjson::kParseErrorDocumentEmpty, 1}, // our own limit: the code is unspecified
        {"[1,2,\"x\"], oops", rapidjson::kParseErrorDocumentRootNotSingular, 9},
    };
    for (const auto& c : cases)
    {
        rapidjson::Document document = ParsedJson(R"({"old":[1,"text that is not short"]})");
        EXPECT_FALSE(RapidJsonIoUtil::TryGetJsonDocFromString(c.json, document));
        EXPECT_TRUE(document.IsNull()) << c.json;
        EXPECT_EQ(c.code, document.GetParseError()) << c.json;
        EXPECT_EQ(c.offset, document.GetErrorOffset()) << c.json;
        EXPECT_TRUE(RapidJsonIoUtil::TryGetJsonDocFromString("[2]", document));
        EXPECT_FALSE(document.HasParseError());
        EXPECT_EQ("[2]", RapidJsonIoUtil::OutputJsonValueToString(document));
    }
}

TEST(JsonReading, NumbersThatWouldOverflowTheLibraryAreCut)
{
    const struct
    {
        const char* text;
        std::size_t maxDigits;
        const char* guarded; ///< null if the text can be parsed as it is
    } cases[] = {
        {"[0.00000000001e-2147483639]", 99, "[0.00000000001e-0999999999]"},
        {"[-1.5E-99999999999,1e-1234567890123]", 99, "[-1.5E-00999999999,1e-0000999999999]"},
        {"[2.5e-00000000001,-9876543210,1E9876543210]", 99, "[2.5e-00000000001,-9876543210,1E9876543210]"},
        {"[1e-123456789,-1234567890,1-1234567890]", 99, nullptr},
        {R"(["\"1e-2147483639",1e-2147483639,"\\",1e-2147483639])", 99,
         R"(["\"1e-2147483639",1e-0999999999,"\\",1e-0999999999])"},
        {"[0.12345,1]", 5, nullptr},
        {"[0.123456,1]", 5, "[0.!"},
        {"[1e-1234567890,123456789012,1]", 11, "[1e-0999999999,!"},
        {"123456", 5, "!"},
        {"[] 123456 junk", 5, "[] !"},
    };
    for (const auto& c : cases)
    {
        const std::optional<std::string> guarded = GuardNumbers(c.text, c.maxDigits);
        EXPECT_EQ(c.guarded == nullptr ? "(as it is)" : c.guarded, guarded.value_or("(as it is)")) << c.text;
    }
    rapidjson::Document document;
    EXPECT_TRUE(RapidJsonIoUtil::TryGetJsonDocFromString("[0.00000000001e-2147483639]", document));
    EXPECT_EQ("[0.0]", RapidJsonIoUtil::OutputJsonValueToString(document));
}

TEST(JsonReading, PublicSuiteHasTheExpectedOutcomes)
{
    const char* const suite = std::getenv("PAGEMELD_JSON_SUITE");
    if (suite == nullptr)
    {
        GTEST_SKIP() << "PAGEMELD_JSON_SUITE names no directory with the cases";
    }
    std::ifstream expected(std::string(suite) + "/expected.tsv");
    int count = 0;
    std::string outcome;
    int offset = 0;
    for (std::string name; expected >> name >> outcome >> offset; ++count)
    {
        rapidjson::Document document;
        EXPECT_EQ(outcome == "accept" ? "read" : ParseError(offset),
                  Read(std::string(suite) + "/" + name, document))
            << name;
    }
    EXPECT_EQ(318, count);
}
