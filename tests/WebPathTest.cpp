#include "Tools/DocTools/PagemeldCheck/Browse/WebPath.h"

#include "Tools/DocTools/VantorPagemeld/ModuleLayout.h"
#include "Tools/DocTools/VantorPagemeld/Render/ModulePrefix.h"
#include "tests/support/AnswersOfNode.h"

#include <gtest/gtest.h>

#include <random>

namespace
{

constexpr char kBetween = '\x7F'; // between a directory and a link

/// Where a link leads. Addresses begin with http, since Windows drives in those of files have rules of their
/// own.
constexpr const char* kPathInNode = R"(
    const { unescape } = require('querystring');
    function answer(text) {
        const [directory, link] = text.toString().split('\x7F');
        const base = 'http://h' + directory.split('/').map(encodeURIComponent).join('/');
        const url = URL.canParse(link, base) ? new URL(link, base) : {};
        const isHere = url.origin === 'http://h';
        return Buffer.from(isHere ? unescape(url.pathname.replace(/\/+/g, '/')) : 'elsewhere');
    })";

bool IsRight(const std::string& fromRoot, const std::string& toRoot)
{
    const ModulePath from(fromRoot, "Manual");
    const ModulePath to(toRoot, "Manual");
    return FollowLink(from.Text(), RelativePrefix(from.Text(), to.AsLinkTarget())) == WebPathOf(to.Text());
}

std::string RandomPath(std::mt19937& random)
{
    const char* const pieces[] = {"/",  "/",  "/",  "/",    "..", "../", ".",   "%2e",     "%2E.",
                                  "\\", "n",  "g1", "%41",  "%4", "%",   "%25", "#",       "?",
                                  " ",  "\t", "\n", "\x01", ":",  "+",   "\"",  "\xC3\xA9"};
    std::string path;
    for (std::size_t left = random() % 10; left > 0; --left)
    {
        path += pieces[random() % std::size(pieces)];
    }
    return path;
}

} // namespace

TEST(WebPath, TellsRightPrefixesFromWrongOnes)
{
    const struct
    {
        const char* from;
        const char* to;
        bool isRight;
        bool isRightBack;
    } cases[] = {{"docs/a", "docs/b", true, true},
                 {"docs/m1", "docs/m12", true, false}, // one name begins with the other
                 {"docs1", "docs2", false, false},     // no common directory
                 {"./a", "b", true, false},
                 {"a/../b", "a/c", false, true},
                 {"docs/a/", "docs/b/", false, false}, // every slash is one more to climb
                 {"docs/a/", "docs/b", false, true},
                 {"docs//a", "docs//b", true, true},
                 {"/r/100%", "/r/b c", true, true},
                 {"/r/%2e%2e/a", "/r/%2e%2e/b", true, true},
                 {"m", "m/Manual/ftp:", false, true}}; // the prefix has a scheme
    for (const auto& c : cases)
    {
        EXPECT_EQ(c.isRight, IsRight(c.from, c.to)) << "from " << c.from << " to " << c.to;
        EXPECT_EQ(c.isRightBack, IsRight(c.to, c.from)) << "from " << c.to << " to " << c.from;
    }
    EXPECT_EQ("./../../b/", WebPathOf("../a//./../../b"));
    EXPECT_EQ("/%2e#?\\/a../", WebPathOf("//../%2e#?\\/a../"));
    EXPECT_EQ("./", WebPathOf("a/.."));
}

TEST(WebPath, FollowsLinksAsABrowserDoes)
{
    std::vector<std::string> texts;
    std::vector<std::string> paths;
    for (unsigned seed = 0; seed < 10'000; ++seed)
    {
        std::mt19937 random(seed);
        const std::string directory = WebPathOf("/x/y/" + RandomPath(random));
        const std::string link = RandomPath(random);
        texts.push_back(directory + kBetween + link);
        paths.push_back(FollowLink(directory, link).value_or("elsewhere"));
    }
    const std::vector<std::string> expected = AnswersOfNode(kPathInNode, texts);
    ASSERT_EQ(expected.size(), paths.size());
    for (std::size_t i = 0; i < paths.size(); ++i)
    {
        EXPECT_EQ(expected[i], paths[i]) << texts[i];
    }
}

TEST(WebPath, KnowsLinksWithAScheme)
{
    for (const char* link : {"https://a/b", " \tm\nailto:a", "C:\\a", "std::list.html", "zZ.z+A-0a9:"})
    {
        EXPECT_TRUE(HasScheme(link)) << link;
    }
    for (const char* link : {"", "a.html", "//h/a", ":a", "1a:b", "a/b:c", "a#b:c", "a b:c", "\xC3\xA9:a",
                             "a/:", "@:", "[:", "`:", "{:"})
    {
        EXPECT_FALSE(HasScheme(link)) << link;
    }
    for (const char* link : {"http://h", "HttpS:h", "ftp:", "mailto:a@b"})
    {
        EXPECT_TRUE(IsAddress(link)) << link;
    }
    for (const char* link : {"", "http", "javascript:a", "File:a.html", " http://h", "x/http:", "httpS\x1A:"})
    {
        EXPECT_FALSE(IsAddress(link)) << link;
    }
}
