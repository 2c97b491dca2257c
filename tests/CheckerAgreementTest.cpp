#include "Tools/DocTools/VantorPagemeld/ModuleLayout.h"
#include "Tools/DocTools/VantorPagemeld/Read/JsonDocument.h"
#include "tests/support/AnswersOfNode.h"
#include "tests/support/ParsedJson.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <filesystem>
#include <map>
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

const Names kOfOutputs = {"output-missing", "output-broken", "wrong-prefixes",    "output-differs",
                          "output-stale",   "leftover",      "nothing-to-combine"};

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

/// Makes the modules of a seed below the directory. Returns their roots.
std::vector<std::string> MakeTree(const TemporaryDirectory& directory, unsigned seed)
{
    std::vector<std::string> roots;
    TreeMaker maker(seed);
    for (const std::string& name : kModules)
    {
        roots.push_back(directory / name);
        std::filesystem::create_directories(Docdata(roots.back()));
        maker.Write(roots.back(), name);
    }
    return roots;
}

/// Returns the outputs below the directory, by path.
std::map<std::string, std::string> OutputsBelow(const TemporaryDirectory& directory)
{
    std::map<std::string, std::string> outputs;
    for (const auto& entry : std::filesystem::recursive_directory_iterator(directory.Path()))
    {
        if (entry.path().filename().string().rfind("global_", 0) == 0)
        {
            outputs[entry.path()] = ReadFile(entry.path());
        }
    }
    return outputs;
}

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
        const std::vector<std::string> roots = MakeTree(directory, seed);
        std::vector<std::string> arguments = {"--format=json", "--limit=0"};
        arguments.insert(arguments.end(), roots.begin(), roots.end());
        const Findings findings(RunProgram(PAGEMELD_CHECK_PROGRAM, arguments).standardOutput);
        EXPECT_EQ(0, RunProgram(PAGEMELD_PROGRAM, roots).status);

        const std::string combined = Docdata(roots.back());
        const bool isWritten = std::filesystem::exists(combined + "/global_toc.js");
        EXPECT_EQ(isWritten, !findings.Has({"nothing-to-combine"})) << "seed " << seed;
        if (!isWritten)
        {
            continue;
        }
        ++writtenCount;
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
    }
    EXPECT_GT(writtenCount, 60);
    EXPECT_GT(scripts.size(), 20U);
    EXPECT_EQ(std::vector<std::string>(scripts.size(), "evaluates"),
              AnswersOfNode(kEvaluatesInNode, scripts));
}

TEST(CheckerAgreement, TellsWhenARunWouldChangeItsOutputs)
{
    const char* const changes[] = {
        "mkdir up && mv second up",
        "rm -r third",
        "cp -r first fourth",
        "mv first fourth",
        "rm -r second/Manual/docdata/[it]*.json",
        "rm -r */Manual/docdata/[it]*.json",
        "sed -i '/^var p0/d' third/Manual/docdata/global_index.js",
        "sed -i 's/^var p0.*/var p0 = \"nonsense\";/' first/Manual/docdata/global_toc.js",
        "truncate -s -1 third/Manual/docdata/global_toc.js",
    };
    std::map<std::string, int> toldCounts;
    for (unsigned seed = 0; seed < 10 * std::size(changes); ++seed)
    {
        const std::string change = changes[seed % std::size(changes)];
        const TemporaryDirectory directory;
        (void)MakeTree(directory, seed);
        const auto run = [&] { (void)RunProgram(PAGEMELD_PROGRAM, {"-autopaths", directory.Path()}); };
        const auto isTold = [&]
        {
            const ProgramResult result = RunProgram(
                PAGEMELD_CHECK_PROGRAM, {"--format=json", "--outputs", "--discover", directory.Path()});
            return Findings(result.standardOutput).Has(kOfOutputs);
        };
        run();
        if (OutputsBelow(directory).empty())
        {
            continue;
        }
        EXPECT_FALSE(isTold()) << "seed " << seed;
        EXPECT_EQ(0, RunProgram("sh", {"-c", "cd '" + directory.Path() + "' && " + change}).status);
        const bool wasTold = isTold();
        const auto changedOutputs = OutputsBelow(directory);
        run();
        EXPECT_TRUE(wasTold || OutputsBelow(directory) == changedOutputs) << change << ", seed " << seed;
        toldCounts[change] += wasTold ? 1 : 0;
    }
    for (const char* change : changes)
    {
        EXPECT_GT(toldCounts[change], 1) << change;
    }
}
