#include "Tools/DocTools/PagemeldCheck/LinkCheck.h"

#include "Tools/DocTools/PagemeldCheck/Browse/ScriptLiteral.h"
#include "Tools/DocTools/PagemeldCheck/Browse/WebPath.h"
#include "Tools/DocTools/PagemeldCheck/Explain/ShownText.h"
#include "Tools/DocTools/PagemeldCheck/RootCheck.h"
#include "Tools/DocTools/VantorPagemeld/Render/ModulePrefix.h"

#include <algorithm>

namespace
{

/// The directory of a root's set as the scripts and the web see it.
struct SetPath
{
    SetPath(std::size_t rootPosition, const std::string& root, DocSet set)
        : position(rootPosition),
          module(root, set),
          target(module.AsLinkTarget()),
          webPath(WebPathOf(module.Text())),
          isPlain(IsPlain(module.Text()))
    {
    }

    /// Whether every name in the path is itself in a URL and in a script, and no step can be left out.
    /// A space that begins a URL is lost.
    static bool IsPlain(const std::string& path)
    {
        const std::string steps = "/" + path + "/";
        return std::none_of(path.begin(), path.end(), [](char c) { return c >= '\0' && c < ' '; }) &&
               steps.find("/ ") == std::string::npos && path.find_first_of("%#?:\"\\") == std::string::npos &&
               FindInvalidUtf8(path) == std::string::npos && steps.find("/./") == std::string::npos &&
               steps.find("/../") == std::string::npos && path.find("//") == std::string::npos;
    }

    std::size_t position;
    ModulePath module;
    std::string target;
    std::string webPath;
    bool isPlain;
};

/// Returns whether the prefix from one plain path to another is right for what RelativePrefix is: "../" for
/// every step after the last '/' that both share, then the rest. It is wrong if they share no '/'. Returns
/// nothing if a name in "to" is the beginning of the other's, since the walk then ends within that name, or
/// if a path is not plain.
std::optional<bool> IsPlainlyRight(const SetPath& from, const SetPath& to)
{
    if (!from.isPlain || !to.isPlain)
    {
        return std::nullopt;
    }
    const std::string& source = from.module.Text();
    const auto difference = std::mismatch(source.begin(), source.end(), to.target.begin(), to.target.end());
    if (difference.first != source.end() && difference.second != to.target.end() && *difference.second == '/')
    {
        return std::nullopt;
    }
    return std::find(source.begin(), difference.first, '/') != difference.first;
}

/// Returns the prefix from one set directory to another as the scripts have it, or nothing if it breaks them.
std::optional<std::string> PrefixInScripts(const SetPath& from, const SetPath& to)
{
    return ValueOfScriptLiteral("\"" + RelativePrefix(from.module.Text(), to.target) + "\"");
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

/// Returns where the prefix leads, in the form of WebPathOf, or nothing if no directory can be named so: a
/// script is text, so it can't hold a name that is not UTF-8.
std::optional<std::string> FollowPrefix(const SetPath& from, const std::string& prefix)
{
    return FindInvalidUtf8(prefix) == std::string::npos ? FollowLink(from.module.Text(), prefix)
                                                        : std::nullopt;
}

/// Where the links from a root lead, if it is not where they should.
struct WrongLinks
{
    std::size_t first = 0; ///< the position of the first root that is not reached
    std::size_t count = 0;
    std::string reached;    ///< instead of the first; empty if it is not a directory at all
    bool isHandled = false; ///< whether the page script, which encodes prefixes, gets to the first
};

WrongLinks FindWrongLinks(const std::vector<SetPath>& paths, const SetPath& from)
{
    WrongLinks wrong;
    for (const SetPath& to : paths)
    {
        const std::optional<bool> isRight = IsPlainlyRight(from, to);
        if (to.position == from.position || isRight == true)
        {
            continue;
        }
        if (isRight == false && wrong.count > 0)
        {
            ++wrong.count;
            continue;
        }
        const std::optional<std::string> prefix = PrefixInScripts(from, to);
        const std::optional<std::string> reached =
            prefix ? FollowPrefix(from, *prefix) : to.webPath; // the other's fault
        if (reached != to.webPath && wrong.count++ == 0)
        {
            wrong.first = to.position;
            wrong.reached = reached.value_or("");
            wrong.isHandled = FollowPrefix(from, EncodedPrefix(*prefix)) == to.webPath;
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

/// Whether the path has a step that leads nowhere, or back.
bool HasEmptySteps(const std::string& root)
{
    return ("/" + root).find("/./") != std::string::npos || root.find("/../") != std::string::npos ||
           root.find("//") != std::string::npos;
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
    const bool isSpecial =
        to.find_first_of("%#?\"\\\n\r\t") != std::string::npos || FindInvalidUtf8(to) != std::string::npos;
    if (!isSpecial && (HasEmptySteps(from) || HasEmptySteps(to)))
    {
        return "give the roots without \"/./\", \"/../\" and \"//\"";
    }
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

/// Returns the first set directory in whose scripts the prefix to another one breaks the string, or null.
const SetPath* FindBroken(const std::vector<SetPath>& paths, const SetPath& to)
{
    if (to.isPlain)
    {
        return nullptr;
    }
    const auto broken = std::find_if(paths.begin(), paths.end(),
                                     [&](const SetPath& from) { return !PrefixInScripts(from, to); });
    return broken == paths.end() ? nullptr : &*broken;
}

/// Returns what is wrong with the links from or to one set directory, or an empty text.
std::string FindFault(const std::vector<std::string>& roots, const std::vector<SetPath>& paths,
                      const SetPath& path)
{
    if (const SetPath* const from = FindBroken(paths, path))
    {
        return "a quote, backslash or line break in the path breaks both scripts of " +
               Visible(roots[from->position]) + ": rename the directory";
    }
    const WrongLinks wrong = FindWrongLinks(paths, path);
    return wrong.count == 0 ? "" : DescribeWrongLinks(roots, path.position, wrong);
}

std::vector<SetPath> PathsOf(DocSet set, const std::vector<std::string>& roots)
{
    std::vector<SetPath> paths;
    for (std::size_t i = 0; i < roots.size(); ++i)
    {
        if (HasSet(roots[i], set))
        {
            paths.emplace_back(i, roots[i], set);
        }
    }
    return paths;
}

} // namespace

void CheckLinks(const std::vector<std::string>& roots, Report& report)
{
    std::vector<bool> isReported(roots.size());
    for (const auto& set : kDocSets)
    {
        const std::vector<SetPath> paths = PathsOf(set.id, roots);
        for (const SetPath& path : paths)
        {
            const std::string fault = isReported[path.position] ? "" : FindFault(roots, paths, path);
            if (!fault.empty())
            {
                isReported[path.position] = true;
                report.Add(Finding::OfRoot(Rule::WrongLinkPath, path.position, roots[path.position], fault));
            }
        }
    }
}
