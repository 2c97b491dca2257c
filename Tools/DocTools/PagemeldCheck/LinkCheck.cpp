#include "Tools/DocTools/PagemeldCheck/LinkCheck.h"

#include "Tools/DocTools/PagemeldCheck/Browse/ScriptLiteral.h"
#include "Tools/DocTools/PagemeldCheck/Browse/WebPath.h"
#include "Tools/DocTools/PagemeldCheck/Explain/ShownText.h"
#include "Tools/DocTools/VantorPagemeld/Render/ModulePrefix.h"

#include <algorithm>

namespace
{

/// One root as the scripts and the web see it, by the links of Manual.
struct RootPath
{
    explicit RootPath(const std::string& root)
        : module(root, DocSet::Manual), webPath(WebPathOf(module.Text()))
    {
    }

    ModulePath module;
    std::string webPath;
};

/// Where the links from a root lead, if it is not where they should.
struct WrongLinks
{
    std::size_t first = 0; ///< the first root that is not reached
    std::size_t count = 0;
    std::string reached;    ///< instead of the first; empty if it is not a directory at all
    bool isHandled = false; ///< whether the page script, which encodes prefixes, gets to the first
};

/// Returns the prefix from one root to another as the scripts have it, or nothing if it breaks them.
std::optional<std::string> PrefixInScripts(const RootPath& from, const RootPath& to)
{
    return ValueOfScriptLiteral("\"" + RelativePrefix(from.module.Text(), to.module.AsLinkTarget()) + "\"");
}

/// Returns the prefix as the page script asks for it.
std::string EncodedPrefix(const std::string& prefix)
{
    std::string encoded;
    for (const char c : PercentEncoded(prefix))
    {
        encoded += c == '#' ? std::string("%23") : std::string(1, c);
    }
    return encoded;
}

WrongLinks FindWrongLinksFromRoot(const std::vector<RootPath>& paths, std::size_t from)
{
    WrongLinks wrong;
    for (std::size_t to = 0; to < paths.size(); ++to)
    {
        const std::optional<std::string> prefix = PrefixInScripts(paths[from], paths[to]);
        if (to == from || !prefix) // which is a fault of the other root
        {
            continue;
        }
        const std::optional<std::string> reached = FollowLink(paths[from].module.Text(), *prefix);
        if (reached == paths[to].webPath)
        {
            continue;
        }
        if (wrong.count++ == 0)
        {
            wrong.first = to;
            wrong.reached = reached.value_or("");
            wrong.isHandled =
                FollowLink(paths[from].module.Text(), EncodedPrefix(*prefix)) == paths[to].webPath;
        }
    }
    return wrong;
}

/// Returns a web path as people write it: without "./" before it and "/" after it.
std::string DisplayedWebPath(std::string_view webPath)
{
    if (webPath.substr(0, 2) == "./")
    {
        webPath.remove_prefix(2);
    }
    return Visible(webPath.substr(0, webPath.find_last_not_of('/') + 1));
}

bool EndsInSlash(const std::string& root)
{
    return !root.empty() && root.back() == '/';
}

/// Whether one of the paths begins with all bytes of the other.
bool IsBeginning(const std::string& a, const std::string& b)
{
    const std::size_t length = std::min(a.size(), b.size());
    return a.compare(0, length, b, 0, length) == 0;
}

std::string Remedy(const std::string& from, const std::string& to)
{
    if (EndsInSlash(from) || EndsInSlash(to))
    {
        return "give the roots without a slash at the end";
    }
    if (IsBeginning(from, to))
    {
        return "one name begins with the other: rename one";
    }
    const bool isSpecial = to.find_first_of("%#?\\\n\r\t") != std::string::npos;
    return isSpecial || (from[0] == '/' && to[0] == '/') ? "rename the directory" : "give absolute paths";
}

std::string DescribeWrongLinks(const std::vector<std::string>& roots, std::size_t from,
                               const WrongLinks& wrong)
{
    const std::string& to = roots[wrong.first];
    const std::string others = wrong.count > 1 ? " and " + std::to_string(wrong.count - 1) + " more" : "";
    const std::string lead =
        wrong.reached.empty() ? " will lead elsewhere" : " will lead to " + DisplayedWebPath(wrong.reached);
    return "links to " + Visible(to) + others + lead + (wrong.isHandled ? " without the page script" : "") +
           ": " + Remedy(roots[from], to);
}

/// Returns the first root in whose scripts the prefix to another one breaks the string, or nothing.
std::optional<std::size_t> FindUnnamable(const std::vector<RootPath>& paths, std::size_t to)
{
    for (std::size_t from = 0; from < paths.size(); ++from)
    {
        if (!PrefixInScripts(paths[from], paths[to]))
        {
            return from;
        }
    }
    return std::nullopt;
}

} // namespace

void CheckLinks(const std::vector<std::string>& roots, Report& report)
{
    const std::vector<RootPath> paths(roots.begin(), roots.end());
    for (std::size_t i = 0; i < roots.size(); ++i)
    {
        if (const std::optional<std::size_t> from = FindUnnamable(paths, i))
        {
            report.Add(
                Finding::OfRoot(Rule::WrongLinkPath, i, roots[i],
                                "a quote, backslash or line break in the path breaks both scripts of " +
                                    Visible(roots[*from]) + ": rename the directory"));
            continue;
        }
        const WrongLinks wrong = FindWrongLinksFromRoot(paths, i);
        if (wrong.count > 0)
        {
            report.Add(
                Finding::OfRoot(Rule::WrongLinkPath, i, roots[i], DescribeWrongLinks(roots, i, wrong)));
        }
    }
}
