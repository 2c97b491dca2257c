#include "Tools/DocTools/VantorPagemeld/ModuleLayout.h"
#include "Tools/DocTools/VantorPagemeld/Read/JsonDocument.h"
#include "tests/support/AnswersOfNode.h"
#include "tests/support/ParsedJson.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <filesystem>
#include <random>
#include <set>
#include <sstream>

// What the checker reports before a run must agree with what the run then makes of the same modules, some of
// them damaged.

namespace
{

using rapidjson::Value;

using Names = std::set<std::string>;

const std::vector<std::string> kModules = {"first", "second", "third"};

const Names kOfOutputs = {"output-missing", "output-broken", "wrong-prefixes",
                          "output-differs", "output-stale",  "leftover"};

constexpr const char* kEvaluatesInNode = R"(
    const vm = require('vm');
    function answer(script) {
        try {
            vm.runInNewContext(script.toString());
            return Buffer.from('evaluates');
        } catch (error) { return Buffer.from(String(error)); }
    })";

std::string Docdata(const std::string& root)
{
    return root + "/Manual/docdata";
}

/// Makes the input files of modules, sound ones and damaged ones.
class TreeMaker
{
public:
    explicit TreeMaker(unsigned seed) : m_random(seed) {}

    void Write(const std::string& root, const std::string& name)
    {
        WriteInput(Docdata(root) + "/index.json", R"({"pages":[[")" + name + R"(.html","A"],[")" + name +
                                                      "\",\"" + OneOf(kTitles) + "\"]" + OneOf(kMorePages) +
                                                      R"(],"info":[["text",0],["",1]],"common":{"the":1},)" +
                                                      R"("searchIndex":{"word":[0,1],"other":[1]}})");
        WriteInput(Docdata(root) + "/toc.json",
                   R"({"link":")" + OneOf(kRoots) + R"(","title":"toc","children":[{"link":"one-)" + name +
                       R"(","title":"One","children":null},{"link":"two-)" + name + R"(","title":")" +
                       OneOf(kTitles) + "\"" + OneOf(kMoreMembers) + R"(,"children":[]}]})");
    }

private:
    static inline const std::vector<std::string> kTitles = {
        "Two",     "Two",      "Two", R"(\"Two\")", R"(C:\\new)", R"(\\)", R"(\"\\\" Operator)",
        R"(a\nb)", R"(\u0000)"};
    static inline const std::vector<std::string> kMorePages = {"", "", "", R"(,["a","b",0])"};
    static inline const std::vector<std::string> kMoreMembers = {"", "", "", R"(,"module":1)"};
    static inline const std::vector<std::string> kRoots = {"toc", "toc", "toc", R"(toc\u0000x)", "root"};

    std::size_t Below(std::size_t count) { return m_random() % count; }

    const std::string& OneOf(const std::vector<std::string>& texts) { return texts[Below(texts.size())]; }

    void WriteInput(const std::string& path, std::string text)
    {
        constexpr std::string_view kBytes("{}[]\",:\\\n\0 07x-\xE9", 16);
        switch (Below(8))
        {
        case 0:
            return; // no file
        case 1:
            std::filesystem::create_directories(path);
            return;
        case 2:
        case 3:
            text[Below(text.size())] = kBytes[Below(kBytes.size())];
            break;
        case 4:
            text.erase(Below(text.size()), 1);
            break;
        default:
            break;
        }
        WriteFile(path, text);
    }

    std::mt19937 m_random;
};

/// What the checker finds in a tree.
class Findings
{
public:
    explicit Findings(const std::string& lines)
    {
        std::istringstream stream(lines);
        for (std::string line; std::getline(stream, line);)
        {
            m_findings.push_back(ParsedJson(line));
        }
    }

    [[nodiscard]] bool Has(const Names& rules, const std::string& file = "") const
    {
        return std::any_of(m_findings.begin(), m_findings.end(),
                           [&](const Value& finding) {
                               return rules.count(Text(finding, "rule")) != 0 &&
                                      (file.empty() || Text(finding, "file") == file);
                           });
    }

    /// Whether the module's contents are reported as dropped: at its own file, or by name at the first
    /// module's.
    [[nodiscard]] bool IsDropped(const std::string& root, const std::string& name) const
    {
        return std::any_of(m_findings.begin(), m_findings.end(),
                           [&](const Value& finding)
                           {
                               const std::string message = Text(finding, "message");
                               const bool isOddFirst = message.find("it comes first") != std::string::npos;
                               return Text(finding, "rule") == "root-differs" &&
                                      (isOddFirst ? message.find('"' + name + '"') != std::string::npos
                                                  : Text(finding, "file") == Docdata(root) + "/toc.json");
                           });
    }

private:
    static std::string Text(const Value& finding, const char* member)
    {
        const Value* const text = FindMember(finding, member);
        return text == nullptr ? "" : text->GetString();
    }

    std::vector<rapidjson::Document> m_findings;
};

/// Returns the modules whose names occur in the file.
Names NamesIn(const std::string& path)
{
    const std::string text = ReadFile(path);
    Names names;
    for (const std::string& name : kModules)
    {
        if (text.find(name) != std::string::npos)
        {
            names.insert(name);
        }
    }
    return names;
}

} // namespace

TEST(CheckerAgreement, PredictsWhichModulesARunMerges)
{
    std::vector<std::string> scripts;
    int writtenCount = 0;
    for (unsigned seed = 0; seed < 150; ++seed)
    {
        const TemporaryDirectory directory;
        std::vector<std::string> roots;
        TreeMaker maker(seed);
        for (const std::string& name : kModules)
        {
            roots.push_back(directory / name);
            std::filesystem::create_directories(Docdata(roots.back()));
            maker.Write(roots.back(), name);
        }
        std::vector<std::string> arguments = {"--format=json", "--limit=0"};
        arguments.insert(arguments.end(), roots.begin(), roots.end());
        const auto check = [&]
        { return Findings(RunProgram(PAGEMELD_CHECK_PROGRAM, arguments).standardOutput); };
        const Findings findings = check();
        EXPECT_EQ(0, RunProgram(PAGEMELD_PROGRAM, roots).status);

        const std::string combined = Docdata(roots.back());
        const bool isWritten = std::filesystem::exists(combined + "/global_toc.js");
        EXPECT_EQ(isWritten, !findings.Has({"nothing-to-combine"})) << "seed " << seed;
        if (!isWritten)
        {
            continue;
        }
        ++writtenCount;
        arguments.emplace_back("--outputs");
        EXPECT_FALSE(check().Has(kOfOutputs)) << "seed " << seed;
        Names inSearch;
        Names inContents;
        for (std::size_t i = 0; i < roots.size(); ++i)
        {
            const Names refused = {"unreadable", "not-json", "structure"};
            const std::string index = Docdata(roots[i]) + "/index.json";
            const std::string toc = Docdata(roots[i]) + "/toc.json";
            const bool hasFiles = !findings.Has({"set-empty"}, Docdata(roots[i]));
            if (hasFiles && !findings.Has(refused, index) && !findings.Has({"merged-input"}, index))
            {
                inSearch.insert(kModules[i]);
            }
            if (hasFiles && !findings.Has(refused, toc) && !findings.IsDropped(roots[i], kModules[i]))
            {
                inContents.insert(kModules[i]);
            }
        }
        EXPECT_EQ(inSearch, NamesIn(combined + "/global_index.json")) << "seed " << seed;
        EXPECT_EQ(inContents, NamesIn(combined + "/global_toc.json")) << "seed " << seed;
        if (!findings.Has({"script-broken", "wrong-link-path", "merged-input"}))
        {
            scripts.push_back(ReadFile(combined + "/global_index.js"));
            scripts.push_back(ReadFile(combined + "/global_toc.js"));
        }
        const std::string cut = combined + "/" + kOutputs[seed % std::size(kOutputs)].name;
        std::filesystem::resize_file(cut, std::filesystem::file_size(cut) - 1 - seed % 50);
        EXPECT_TRUE(check().Has(kOfOutputs, cut)) << "seed " << seed;
    }
    EXPECT_GT(writtenCount, 60);
    EXPECT_GT(scripts.size(), 20U);
    EXPECT_EQ(std::vector<std::string>(scripts.size(), "evaluates"),
              AnswersOfNode(kEvaluatesInNode, scripts));
}

TEST(CheckerAgreement, TellsWhenOutputsAreNotThoseOfARun)
{
    const char* const changes[] = {
        "mkdir up && mv second up",
        "rm -r third",
        "mv first fourth",
        "cp -r first fourth",
        "rm -r second/Manual/docdata/index.json second/Manual/docdata/toc.json",
        "rm */Manual/docdata/index.json */Manual/docdata/toc.json",
        "sed -i '/^var p1/d' third/Manual/docdata/global_index.js",
        "sed -i 's/^var p0.*/var p0 = \"nonsense\";/' first/Manual/docdata/global_toc.js",
        "truncate -s -9 second/Manual/docdata/global_index.json",
        "truncate -s 100 third/Manual/docdata/global_toc.js",
        "touch first/Manual/docdata/toc.json",
    };
    const std::string check = std::string(PAGEMELD_CHECK_PROGRAM) + " --outputs --discover=.";
    for (const char* change : changes)
    {
        const TemporaryDirectory directory;
        for (const std::string& name : kModules)
        {
            WriteFile(directory / name + "/Manual/docdata/index.json",
                      R"({"pages":[["page.html","Page"]],"info":[],"common":{},"searchIndex":{}})");
            WriteFile(directory / name + "/Manual/docdata/toc.json",
                      R"({"link":"toc","title":"toc","children":[]})");
        }
        const std::string run = "cd '" + (directory / "") + "' && " + PAGEMELD_PROGRAM + " -autopaths . && ";
        EXPECT_EQ(0, RunProgram("sh", {"-c", run + check}).status) << change;
        EXPECT_EQ(1, RunProgram("sh", {"-c", run + "sleep 0.02 && " + change + " && " + check}).status)
            << change;
    }
}
