#include "Tools/DocTools/PagemeldCheck/TargetCheck.h"

#include "Tools/DocTools/PagemeldCheck/Browse/WebPath.h"
#include "Tools/DocTools/VantorPagemeld/Read/JsonDocument.h"
#include "Tools/DocTools/VantorPagemeld/System/DirectoryListing.h"

#include <algorithm>
#include <vector>

// A path is the name of a file, in which only "#" has a meaning. Nothing in it is encoded: the page script
// does that.

namespace
{

/// Returns the name of the file that was meant, if the path was written as a part of a URL.
std::string NameInUrl(std::string_view path)
{
    return PercentDecoded(path.substr(0, path.find_first_of("#?")));
}

bool IsPage(std::string_view name)
{
    const std::string_view end = name.substr(std::min(name.rfind('.'), name.size()));
    return end == ".html" || end == ".htm";
}

bool IsFile(const FileStatus& status)
{
    return status.Exists() && !status.IsDirectory();
}

/// Calls visit with the path of every HTML file below a directory. Takes no hidden names and follows no links
/// to directories.
template <typename Visit>
void VisitPages(const std::string& directory, const Visit& visit)
{
    std::vector<std::string> left = {directory};
    while (!left.empty())
    {
        const std::string current = std::move(left.back());
        left.pop_back();
        for (const dirent* entry : SortedListing(current.c_str()))
        {
            const std::string path = current + "/" + entry->d_name;
            if (entry->d_name[0] == '.')
            {
                continue;
            }
            if (IsDirectoryItself(*entry, path))
            {
                left.push_back(path);
            }
            else if (IsPage(entry->d_name))
            {
                visit(path);
            }
        }
    }
}

} // namespace

void TargetCheck::Check(const char* name, const rapidjson::Value& link, const JsonPointer& pointer,
                        std::string_view path)
{
    if (!m_findings.Scope().options.checksTargets)
    {
        return;
    }
    const std::string problem = ProblemOf(path);
    if (!problem.empty())
    {
        m_findings.AddAtValue(
            Rule::MissingTarget, link, pointer,
            [&] { return std::string(name) + " " + m_findings.Quote(BytesOf(link)) + " " + problem; });
    }
}

void TargetCheck::ReportUnreached()
{
    if (!m_findings.Scope().options.checksTargets)
    {
        return;
    }
    std::string first;
    std::size_t count = 0;
    const std::string& directory = m_findings.Scope().directory.Text();
    VisitPages(directory,
               [&](const std::string& path)
               {
                   if (m_reached.count(FileStatus::Of(path).Id()) == 0 && count++ == 0)
                   {
                       first = path.substr(directory.size() + 1);
                   }
               });
    if (count > 0)
    {
        m_findings.Add(Rule::UnlistedPage,
                       "pages of the set without an entry, which the search does not find: " +
                           std::to_string(count) + ", first " + m_findings.Quote(first));
    }
}

/// Returns why readers don't get to a file by the path, or an empty text.
std::string TargetCheck::ProblemOf(std::string_view path)
{
    const std::string file(path.substr(0, path.find('#')));
    const std::string inUrl = NameInUrl(path);
    if (Reach(file))
    {
        return inUrl == file
                   ? ""
                   : "leads to " + m_findings.Quote(inUrl) + " without the page script, which encodes names";
    }
    const std::string lost = "leads to no file: ";
    if (IsFile(StatusOf(inUrl)))
    {
        return lost + "the page script asks for " + m_findings.Quote(PercentEncoded(file)) +
               "; the file is " + m_findings.Quote(inUrl);
    }
    return lost + (IsFile(StatusOf(path)) ? "\"#\" ends its name; rename it" : "the link is dead");
}

bool TargetCheck::Reach(std::string_view name)
{
    const FileStatus status = StatusOf(name);
    if (IsFile(status))
    {
        m_reached.insert(status.Id());
    }
    return IsFile(status);
}

/// Returns what is at the name below the set's directory.
FileStatus TargetCheck::StatusOf(std::string_view name) const
{
    return FileStatus::Of(m_findings.Scope().directory.File(std::string(name)));
}
