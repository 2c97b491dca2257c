#include "Tools/DocTools/PagemeldCheck/WriteCheck.h"

#include <fcntl.h>
#include <unistd.h>

namespace
{

std::string EndOfRun(std::size_t laterModules, DocSet set)
{
    std::string unwritten = laterModules == 0 ? "" : Counted(laterModules, "later module");
    if (set == DocSet::Manual)
    {
        unwritten += (unwritten.empty() ? "" : " and ") + std::string(NameOf(DocSet::ScriptReference));
    }
    return "the run ends here with status 255" +
           (unwritten.empty() ? "" : ", and leaves " + unwritten + " unwritten");
}

/// Returns why nothing can be written into the directory, or an empty text.
std::string ProblemOf(const std::string& docdata)
{
    const FileStatus status = FileStatus::Of(docdata);
    if (!status.Exists())
    {
        return "is missing";
    }
    if (!status.IsDirectory())
    {
        return "is not a directory";
    }
    return ::faccessat(AT_FDCWD, docdata.c_str(), W_OK | X_OK, AT_EACCESS) == 0 ? "" : "can't be written to";
}

void CheckPlace(const SetModule& module, const OutputRow& output, const std::string& endOfRun, Report& report)
{
    const ModuleFile file = module.File(output);
    const ModuleFile temporary = module.File(TemporaryPathOf(file.path));
    const FileStatus status = FileStatus::Of(temporary.path);
    // A link to a directory is not an obstacle: the rename replaces it.
    if (FileStatus::OfEntry(file.path).IsDirectory())
    {
        report.Add(Finding::OfFile(Rule::OutputBlocked, file,
                                   "a directory is in the place of the output: the new one stays as .tmp"));
    }
    if (status.IsDirectory() || status.IsPipe())
    {
        const bool endsRun = output.ifUnopened == OutputRow::IfUnopened::EndRun;
        const std::string what = status.IsDirectory() ? "a directory" : "a pipe";
        report.Add(Finding::OfFile(Rule::OutputBlocked, temporary,
                                   what + " is in the place of the temporary file: " +
                                       (endsRun ? endOfRun : "the run keeps the old output")));
    }
}

} // namespace

void CheckWritable(const std::vector<SetModule>& modules, Report& report)
{
    for (const SetModule& module : modules)
    {
        const ModuleFile& docdata = module.docdata;
        const std::string endOfRun = EndOfRun(modules.size() - 1 - docdata.module, docdata.set);
        const std::string problem = ProblemOf(docdata.path);
        if (!problem.empty())
        {
            report.Add(Finding::OfFile(Rule::OutputBlocked, docdata, problem + ": " + endOfRun));
            continue;
        }
        for (const OutputRow& output : kOutputs)
        {
            CheckPlace(module, output, endOfRun, report);
        }
    }
}
