#include "Tools/DocTools/PagemeldCheck/SetCheck.h"

#include "Tools/DocTools/PagemeldCheck/Explain/ShownText.h"
#include "Tools/DocTools/PagemeldCheck/OutputCheck.h"
#include "Tools/DocTools/PagemeldCheck/SetModule.h"

#include <algorithm>
#include <cerrno>

#include <sys/stat.h>

namespace
{

bool IsDirectory(const std::string& path)
{
    struct stat status = {};
    return ::stat(path.c_str(), &status) == 0 && S_ISDIR(status.st_mode);
}

/// Whether something is at path, or may be: a directory may hide what is in it.
bool IsThere(const std::string& path)
{
    struct stat status = {};
    return ::lstat(path.c_str(), &status) == 0 || errno == EACCES;
}

/// Checks one set. Each step uses what the steps before it found out.
class SetCheck
{
public:
    SetCheck(std::size_t set, const std::vector<std::string>& roots, const SetChecks& checks, Report& report)
        : m_set(set), m_checks(checks), m_report(report)
    {
        for (const std::string& root : roots)
        {
            SetModule& module = m_modules.emplace_back(root, kSetNames[set]);
            module.hasDocdata = IsDirectory(module.docdata);
        }
    }

    void Run()
    {
        for (std::size_t i = 0; i < m_modules.size(); ++i)
        {
            if (m_modules[i].hasDocdata)
            {
                CheckModule(i);
            }
        }
        CheckContentRoots();
        CheckCommonWords();
        const bool isWritten = CheckWhetherWritten();
        if (isWritten)
        {
            CheckWritable(m_set, m_modules, m_report);
        }
        if (m_checks.checksOutputs)
        {
            if (isWritten)
            {
                CheckOutputs(m_set, m_modules, m_report);
            }
            CheckLeftovers(m_set, m_modules, m_report);
        }
        NoteMissing();
    }

private:
    void CheckModule(std::size_t i)
    {
        SetModule& module = m_modules[i];
        module.index = CheckFile(InputKind::Index, i);
        module.toc = CheckFile(InputKind::Toc, i);
        if (!module.HasFiles())
        {
            m_report.Add({"set-empty", i, m_set, module.docdata,
                          std::string("has neither index.json nor toc.json: the module adds nothing to ") +
                              kSetNames[m_set]});
            return;
        }
        ReportUnreadable(i, InputKind::Index);
        ReportUnreadable(i, InputKind::Toc);
    }

    [[nodiscard]] static std::string PathOf(const SetModule& module, InputKind kind)
    {
        return module.path.File(kind == InputKind::Index ? kIndexInput : kTocInput);
    }

    InputFacts CheckFile(InputKind kind, std::size_t i)
    {
        const SetModule& module = m_modules[i];
        const std::string path = PathOf(module, kind);
        InputFacts facts =
            CheckInput(kind, {i, m_set, path, m_checks.limit, m_checks.quoteSize}, NameOfRoot(module.root),
                       {m_checks.checksTargets, module.path.Text()}, m_report);
        if (facts.state == InputFacts::State::Unreadable && !IsThere(path))
        {
            facts.state = InputFacts::State::Missing;
        }
        return facts;
    }

    void ReportUnreadable(std::size_t i, InputKind kind)
    {
        const SetModule& module = m_modules[i];
        const bool isIndex = kind == InputKind::Index;
        const InputFacts& facts = isIndex ? module.index : module.toc;
        if (facts.state != InputFacts::State::Missing && facts.state != InputFacts::State::Unreadable)
        {
            return;
        }
        const std::string reason =
            facts.state == InputFacts::State::Unreadable
                ? "can't be read"
                : std::string("is missing beside ") + (isIndex ? "toc.json" : "index.json");
        m_report.Add({"unreadable", i, m_set, PathOf(module, kind),
                      reason + "; " + Quoted(NameOfRoot(module.root), m_checks.quoteSize) +
                          " will be missing from the " + (isIndex ? "search" : "contents") + " of " +
                          kSetNames[m_set]});
    }

    [[nodiscard]] std::vector<std::size_t> SoundContents() const
    {
        std::vector<std::size_t> sound;
        for (std::size_t i = 0; i < m_modules.size(); ++i)
        {
            if (m_modules[i].toc.IsSound())
            {
                sound.push_back(i);
            }
        }
        return sound;
    }

    [[nodiscard]] bool HasSameRoot(std::size_t a, std::size_t b) const
    {
        const InputFacts& first = m_modules[a].toc;
        const InputFacts& second = m_modules[b].toc;
        return first.rootLink == second.rootLink && first.rootTitle == second.rootTitle;
    }

    void CheckContentRoots()
    {
        const std::vector<std::size_t> sound = SoundContents();
        std::vector<std::size_t> dropped;
        for (const std::size_t i : sound)
        {
            if (!HasSameRoot(i, sound.front()))
            {
                dropped.push_back(i);
                m_modules[i].isDropped = true;
            }
        }
        const bool isFirstOdd = dropped.size() >= 2 && dropped.size() + 1 == sound.size();
        if (isFirstOdd)
        {
            ReportOddFirst(sound.front(), dropped);
            return;
        }
        for (const std::size_t i : dropped)
        {
            ReportDropped(i, sound.front());
        }
    }

    void ReportDropped(std::size_t i, std::size_t first)
    {
        ReportRoot(i, first,
                   "of " + Visible(m_modules[first].root) + "; " + NameInText(i) +
                       " will be missing from the contents of " + kSetNames[m_set]);
    }

    void ReportOddFirst(std::size_t first, const std::vector<std::size_t>& dropped)
    {
        std::string names;
        for (const std::size_t i : dropped)
        {
            names += (names.empty() ? "" : ", ") + NameInText(i);
        }
        ReportRoot(first, dropped.front(),
                   "of " + std::to_string(dropped.size()) +
                       " other modules; it comes first, so they are dropped from the contents of " +
                       kSetNames[m_set] + ": " + names);
    }

    /// Reports the root of module i, which differs from that of another one.
    void ReportRoot(std::size_t i, std::size_t other, const std::string& consequence)
    {
        const InputFacts& facts = m_modules[i].toc;
        const InputFacts& otherFacts = m_modules[other].toc;
        const bool linkDiffers = facts.rootLink != otherFacts.rootLink;
        const auto& own = linkDiffers ? facts.rootLink : facts.rootTitle;
        const auto& others = linkDiffers ? otherFacts.rootLink : otherFacts.rootTitle;
        const char* const member = linkDiffers ? "link" : "title";
        Finding finding("root-differs", i, m_set, PathOf(m_modules[i], InputKind::Toc),
                        std::string("root ") + member + " " + Quoted(own, m_checks.quoteSize) +
                            " differs from " + Quoted(others, m_checks.quoteSize) + " " + consequence);
        const std::vector<ValuePlace> places = LocateRoot(finding.file);
        if (!places.empty())
        {
            finding.place = places[linkDiffers ? 0 : 1];
        }
        finding.pointer = std::string("/") + member;
        m_report.Add(std::move(finding));
    }

    [[nodiscard]] std::string NameInText(std::size_t i) const
    {
        return Quoted(NameOfRoot(m_modules[i].root), m_checks.quoteSize);
    }

    void CheckCommonWords()
    {
        const auto counts =
            std::find_if(m_modules.begin(), m_modules.end(),
                         [](const SetModule& module) { return !module.index.commonWords.empty(); });
        std::string differing;
        for (auto module = counts; module != m_modules.end(); ++module)
        {
            if (!module->index.commonWords.empty() && module->index.commonWords != counts->index.commonWords)
            {
                differing +=
                    (differing.empty() ? "" : ", ") + Quoted(NameOfRoot(module->root), m_checks.quoteSize);
            }
        }
        if (!differing.empty())
        {
            m_report.Add({"common-ignored", std::nullopt, m_set, "",
                          "the common words of " + Quoted(NameOfRoot(counts->root), m_checks.quoteSize) +
                              " count for all modules; those that differ are ignored, of " + differing});
        }
    }

    /// Returns whether a run writes the set, and reports if it does not though it has files.
    bool CheckWhetherWritten()
    {
        const auto has = [&](auto test) { return std::any_of(m_modules.begin(), m_modules.end(), test); };
        const bool hasIndex = has([](const SetModule& module) { return module.index.IsSound(); });
        const bool hasToc = has([](const SetModule& module) { return module.toc.IsSound(); });
        if (has([](const SetModule& module) { return module.HasFiles(); }) && !(hasIndex && hasToc))
        {
            m_report.Add({"nothing-to-combine", std::nullopt, m_set, "",
                          std::string("no module has ") +
                              (hasIndex ? "a sound toc.json"
                               : hasToc ? "a sound index.json"
                                        : "a sound index.json, and none a sound toc.json") +
                              ": nothing will be written, and earlier outputs stay"});
        }
        return hasIndex && hasToc;
    }

    void NoteMissing()
    {
        MissingModules& missing = m_report.MissingOf(m_set);
        for (const SetModule& module : m_modules)
        {
            if (module.HasFiles() && !module.index.IsSound())
            {
                missing.search.push_back(module.root);
            }
            if (module.HasFiles() && (!module.toc.IsSound() || module.isDropped))
            {
                missing.contents.push_back(module.root);
            }
        }
    }

    std::size_t m_set;
    const SetChecks& m_checks;
    Report& m_report;
    std::vector<SetModule> m_modules;
};

} // namespace

void CheckSet(std::size_t set, const std::vector<std::string>& roots, const SetChecks& checks, Report& report)
{
    SetCheck(set, roots, checks, report).Run();
}
