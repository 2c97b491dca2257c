#include "Tools/DocTools/PagemeldCheck/WriteCheck.h"

#include "Tools/DocTools/PagemeldCheck/Explain/FileProblem.h"
#include "Tools/DocTools/PagemeldCheck/RootCheck.h"

#include <algorithm>

namespace
{

/// A run ends where it can't open the temporary file of this output; without any other, it goes on.
constexpr Output kEndsRun = Output::IndexScript;

/// Whether any of the modules has a directory for the outputs of the set after this one.
bool IsSetAfter(const std::vector<SetModule>& modules)
{
    return modules.front().docdata.set == DocSet::Manual &&
           std::any_of(modules.begin(), modules.end(),
                       [](const SetModule& module) { return HasSet(module.root, DocSet::ScriptReference); });
}

/// The places of the outputs of one set, in the order in which a run comes to them.
class WriteCheck
{
public:
    WriteCheck(const std::vector<SetModule>& modules, bool runEnds, Report& report)
        : m_modules(modules), m_runEnds(runEnds), m_report(report)
    {
    }

    bool Run()
    {
        for (const SetModule& module : m_modules)
        {
            CheckModule(module);
        }
        return m_runEnds;
    }

private:
    void CheckModule(const SetModule& module)
    {
        const std::string problem = DescribeUnwritableDirectory(module.docdata.path);
        if (!RootExists(module.root))
        {
            m_runEnds = true;
        }
        else if (!problem.empty())
        {
            Add(module.docdata, problem + ": " + OutcomeOfDirectory(module));
        }
        else
        {
            for (const OutputRow& output : kOutputs)
            {
                CheckOutput(module, output);
                CheckTemporary(module, output);
            }
        }
    }

    /// Returns what follows if no file can be made in docdata, where one may be left over.
    std::string OutcomeOfDirectory(const SetModule& module)
    {
        const std::string temporary = TemporaryPathOf(module.path.PathOf(RowOf(kOutputs, kEndsRun)));
        return FileStatus::OfEntry(temporary).Exists() && DescribeObstacle(temporary).empty()
                   ? "the run keeps the old outputs"
                   : EndOfRun(module);
    }

    void CheckOutput(const SetModule& module, const OutputRow& output)
    {
        const ModuleFile file = module.File(output);
        // A link to a directory is not an obstacle: the rename replaces it.
        const char* const obstacle =
            FileStatus::OfEntry(file.path).IsDirectory() ? "a directory is in the place of the output"
            : IsReservedForOwner(module.docdata.path, file.path)
                ? "the output of another user in a sticky directory can't be replaced"
                : nullptr;
        if (obstacle != nullptr)
        {
            Add(file, obstacle + (": the new one stays as " + TemporaryPathOf("")));
        }
    }

    void CheckTemporary(const SetModule& module, const OutputRow& output)
    {
        const ModuleFile file = module.File(TemporaryPathOf(module.path.PathOf(output)));
        const std::string obstacle = DescribeObstacle(file.path);
        if (!obstacle.empty())
        {
            Add(file, obstacle + " is in the place of the temporary file: " +
                          (output.id == kEndsRun ? EndOfRun(module) : "the run keeps the old output"));
        }
        else if (const std::string name = OverwrittenBy(file.path, module); !name.empty())
        {
            Add(file, "is a link to " + name + ", which the run overwrites");
        }
        else if (FileStatus::Of(file.path).IsDevice())
        {
            Add(file,
                "a device is in the place of the temporary file: the run writes into it, and it becomes the "
                "output: readers get nothing");
        }
        else if (IsReservedForOwner(module.docdata.path, file.path))
        {
            Add(file,
                "the temporary file of another user in a sticky directory can't be renamed: the run keeps "
                "the old output");
        }
    }

    /// Returns the name of the file that a run overwrites by a link at path, or an empty text. An output is
    /// replaced, which leaves hard links to it alone.
    static std::string OverwrittenBy(const std::string& path, const SetModule& module)
    {
        const FileStatus status = FileStatus::Of(path);
        const auto nameIn = [&](const auto& rows) -> std::string
        {
            const auto isSame = [&](const auto& row)
            { return FileStatus::Of(module.docdata.path + "/" + row.name).Id() == status.Id(); };
            const auto same = std::find_if(std::begin(rows), std::end(rows), isSame);
            return status.Exists() && same != std::end(rows) ? same->name : "";
        };
        return nameIn(kInputs) + (FileStatus::OfEntry(path).IsLink() ? nameIn(kOutputs) : "");
    }

    /// Returns what follows where the run ends, or would end if it came that far.
    std::string EndOfRun(const SetModule& module)
    {
        if (m_runEnds)
        {
            return "a run that came so far would end here with status 255";
        }
        m_runEnds = true;
        const std::size_t laterModules = m_modules.size() - 1 - module.docdata.module;
        std::string unwritten = laterModules == 0 ? "" : Counted(laterModules, "later module");
        if (IsSetAfter(m_modules))
        {
            unwritten += (unwritten.empty() ? "" : " and ") + std::string(NameOf(DocSet::ScriptReference));
        }
        return "the run ends here with status 255" +
               (unwritten.empty() ? "" : ", and leaves " + unwritten + " unwritten");
    }

    void Add(const ModuleFile& file, std::string message)
    {
        m_report.Add(Finding::OfFile(Rule::OutputBlocked, file, std::move(message)));
    }

    const std::vector<SetModule>& m_modules;
    bool m_runEnds;
    Report& m_report;
};

} // namespace

bool CheckWritable(const std::vector<SetModule>& modules, bool runEnds, Report& report)
{
    return WriteCheck(modules, runEnds, report).Run();
}
