#include "Tools/DocTools/PagemeldCheck/OutputCheck.h"

#include "Tools/DocTools/PagemeldCheck/Explain/ShownText.h"
#include "Tools/DocTools/VantorPagemeld/Read/InputFile.h"
#include "Tools/DocTools/VantorPagemeld/Read/JsonReader.h"

#include <algorithm>
#include <cstring>
#include <functional>
#include <string_view>
#include <tuple>

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

namespace
{

/// One of the four outputs, in the order in which they are written.
struct OutputForm
{
    const char* name;
    bool endsRun;               ///< whether a run ends where it can't be created
    std::string_view bodyStart; ///< of a script, after the prefix lines; empty for JSON
    std::string_view lastPart;  ///< of a script, where its last statement or line begins
    std::string_view bodyEnd;
};

constexpr OutputForm kOutputs[] = {
    {kIndexJsonOutput, false, "", "", ""},
    {kIndexScriptOutput, true, "pages = [\n", "\nsearchIndex = {", "};\n"},
    {kTocJsonOutput, false, "", "", ""},
    {kTocScriptOutput, false, "toc = {\n", "\n\"link\": ", "]};\n"},
};

/// Returns the mode of what is at path, or 0 if nothing is.
mode_t ModeOf(const std::string& path)
{
    struct stat status = {};
    return ::stat(path.c_str(), &status) == 0 ? status.st_mode : 0;
}

std::string EndOfRun(std::size_t laterModules, std::size_t set)
{
    std::string unwritten = laterModules == 0   ? ""
                            : laterModules == 1 ? "1 later module"
                                                : std::to_string(laterModules) + " later modules";
    if (set == 0)
    {
        unwritten += (unwritten.empty() ? "" : " and ") + std::string(kSetNames[1]);
    }
    return "the run ends here with status 255" +
           (unwritten.empty() ? "" : ", and leaves " + unwritten + " unwritten");
}

/// Returns why nothing can be written into the directory, or an empty text.
std::string ProblemOf(const std::string& docdata)
{
    const mode_t mode = ModeOf(docdata);
    if (mode == 0)
    {
        return "is missing";
    }
    if (!S_ISDIR(mode))
    {
        return "is not a directory";
    }
    return ::faccessat(AT_FDCWD, docdata.c_str(), W_OK | X_OK, AT_EACCESS) == 0 ? "" : "can't be written to";
}

/// Whether a directory itself has the path. A link to one is not an obstacle: the rename replaces it.
bool IsDirectoryItself(const std::string& path)
{
    struct stat status = {};
    return ::lstat(path.c_str(), &status) == 0 && S_ISDIR(status.st_mode);
}

void CheckPlaces(std::size_t module, std::size_t set, const SetModule& place, const std::string& endOfRun,
                 Report& report)
{
    for (const OutputForm& output : kOutputs)
    {
        const std::string path = place.path.File(output.name);
        const mode_t temporary = ModeOf(path + ".tmp");
        if (IsDirectoryItself(path))
        {
            report.Add({"output-blocked", module, set, path,
                        "a directory is in the place of the output: the new one stays as .tmp"});
        }
        if (S_ISDIR(temporary) || S_ISFIFO(temporary))
        {
            const std::string what = S_ISDIR(temporary) ? "a directory" : "a pipe";
            report.Add({"output-blocked", module, set, path + ".tmp",
                        what + " is in the place of the temporary file: " +
                            (output.endsRun ? endOfRun : "the run keeps the old output")});
        }
    }
}

timespec NewestInput(const std::vector<SetModule>& modules)
{
    timespec newest = {};
    for (const SetModule& module : modules)
    {
        for (const char* name : {kIndexInput, kTocInput})
        {
            struct stat status = {};
            if (::stat(module.path.File(name).c_str(), &status) == 0)
            {
                newest = std::max(newest, status.st_mtim,
                                  [](const timespec& a, const timespec& b)
                                  { return std::tie(a.tv_sec, a.tv_nsec) < std::tie(b.tv_sec, b.tv_nsec); });
            }
        }
    }
    return newest;
}

bool IsOlder(const std::string& path, const timespec& time)
{
    struct stat status = {};
    return ::stat(path.c_str(), &status) == 0 &&
           std::tie(status.st_mtim.tv_sec, status.st_mtim.tv_nsec) < std::tie(time.tv_sec, time.tv_nsec);
}

/// Returns what all modules' copies share, or nothing if the output is not whole.
std::optional<std::string_view> BodyOf(const OutputForm& output, const InputText& text)
{
    const std::string_view whole(text.bytes.get(), text.bytesRead);
    if (output.bodyStart.empty())
    {
        rapidjson::Document document;
        return ParseJson(text.bytes.get(), document).IsError() ? std::nullopt : std::optional(whole);
    }
    std::size_t start = 0;
    if (whole.substr(0, output.bodyStart.size()) != output.bodyStart)
    {
        start = whole.find("\n" + std::string(output.bodyStart));
        if (start == std::string_view::npos)
        {
            return std::nullopt;
        }
        ++start;
    }
    const bool isWhole = whole.size() >= output.bodyEnd.size() &&
                         whole.find(output.lastPart, start) != std::string_view::npos &&
                         whole.substr(whole.size() - output.bodyEnd.size()) == output.bodyEnd;
    return isWhole ? std::optional(whole.substr(start)) : std::nullopt;
}

/// The first whole copy of an output: a fingerprint of its body, and where it is.
struct FirstCopy
{
    std::size_t size = 0;
    std::size_t hash = 0;
    const std::string* root = nullptr;
};

void CheckCopy(const OutputForm& output, std::size_t module, std::size_t set, const SetModule& place,
               const timespec& newestInput, FirstCopy& first, Report& report)
{
    const std::string path = place.path.File(output.name);
    const InputText text = ReadInputFile(path.c_str());
    if (text.outcome != InputText::Outcome::Read)
    {
        report.Add({"output-missing", module, set, path,
                    "is not there, or can't be read: readers of the module can't use it"});
        return;
    }
    if (IsOlder(path, newestInput))
    {
        report.Add({"output-stale", module, set, path,
                    "is older than an input of the set: readers see an earlier build"});
    }
    const std::optional<std::string_view> body = BodyOf(output, text);
    if (!body)
    {
        report.Add({"output-broken", module, set, path,
                    "is cut short or broken: readers of the module can't use it"});
        return;
    }
    const std::size_t hash = std::hash<std::string_view>()(*body);
    if (first.root == nullptr)
    {
        first = {body->size(), hash, &place.root};
    }
    else if (first.size != body->size() || first.hash != hash)
    {
        report.Add({"output-differs", module, set, path,
                    "has other content than in " + Visible(*first.root) +
                        ": a run ended early, and readers find different things"});
    }
}

} // namespace

void CheckWritable(std::size_t set, const std::vector<SetModule>& modules, Report& report)
{
    for (std::size_t i = 0; i < modules.size(); ++i)
    {
        const std::string endOfRun = EndOfRun(modules.size() - 1 - i, set);
        const std::string problem = ProblemOf(modules[i].docdata);
        if (problem.empty())
        {
            CheckPlaces(i, set, modules[i], endOfRun, report);
        }
        else
        {
            report.Add({"output-blocked", i, set, modules[i].docdata, problem + ": " + endOfRun});
        }
    }
}

void CheckOutputs(std::size_t set, const std::vector<SetModule>& modules, Report& report)
{
    const timespec newestInput = NewestInput(modules);
    for (const OutputForm& output : kOutputs)
    {
        FirstCopy first;
        for (std::size_t i = 0; i < modules.size(); ++i)
        {
            if (modules[i].hasDocdata) // otherwise output-blocked reports it
            {
                CheckCopy(output, i, set, modules[i], newestInput, first, report);
            }
        }
    }
}

void CheckLeftovers(std::size_t set, const std::vector<SetModule>& modules, Report& report)
{
    for (std::size_t i = 0; i < modules.size(); ++i)
    {
        for (const OutputForm& output : kOutputs)
        {
            const std::string path = modules[i].path.File(output.name) + ".tmp";
            if (S_ISREG(ModeOf(path)))
            {
                report.Add({"leftover", i, set, path,
                            "a temporary file is left over: a run was ended, and the output beside it may "
                            "be old"});
            }
        }
    }
}
