#include "Tools/DocTools/PagemeldCheck/LinkCheck.h"

#include "Tools/DocTools/PagemeldCheck/Browse/ScriptLiteral.h"
#include "Tools/DocTools/PagemeldCheck/Browse/WebPath.h"
#include "Tools/DocTools/PagemeldCheck/Explain/ShownText.h"
#include "Tools/DocTools/PagemeldCheck/RootCheck.h"
#include "Tools/DocTools/VantorPagemeld/Render/ModulePrefix.h"

#include <algorithm>
#include <map>

namespace
{

/// The directory of a root's set as the scripts and the web see it.
struct SetPath
{
    SetPath(std::size_t rootPosition, const std::string& rootAsTyped, DocSet set)
        : position(rootPosition),
          root(rootAsTyped),
          module(root, set),
          target(module.AsLinkTarget()),
          webPath(WebPathOf(module.Text())),
          plainFrom(FindPlainRest(module.Text()))
    {
    }

    /// Whether a name is itself in a URL and in a script, where empty ones are dropped. A space that begins a
    /// URL is lost.
    static bool IsPlain(std::string_view name)
    {
        return name != "." && name != ".." && name.substr(0, 1) != " " &&
               std::none_of(name.begin(), name.end(), [](char c) { return c >= '\0' && c < ' '; }) &&
               name.find_first_of("%#?:\"\\") == std::string_view::npos &&
               FindInvalidUtf8(name) == std::string_view::npos;
    }

    /// Returns where the rest of a path begins that consists of plain names.
    static std::size_t FindPlainRest(std::string_view path)
    {
        std::size_t rest = path.size() + 1;
        while (rest > 0)
        {
            const std::string_view before = path.substr(0, rest - 1);
            const std::size_t name = before.rfind('/') + 1; // 0 if there is no '/'
            if (!IsPlain(before.substr(name)))
            {
                break;
            }
            rest = name;
        }
        return rest;
    }

    std::size_t position;
    const std::string& root;
    ModulePath module;
    std::string target;
    std::string webPath;
    std::size_t plainFrom;
};

/// Returns the length of what both share, to the last '/', if the rest of "to" is plain. It then ends the
/// prefix as well, so that all prefixes from one path with this length are right, or none. Returns nothing if
/// a name in "to" is the beginning of the other's, since the walk then ends within that name.
std::optional<std::size_t> SharedBeforePlainRest(const SetPath& from, const SetPath& to)
{
    const std::string& source = from.module.Text();
    const auto difference = std::mismatch(source.begin(), source.end(), to.target.begin(), to.target.end());
    const auto length = static_cast<std::size_t>(difference.first - source.begin());
    const std::size_t shared = std::string_view(source).substr(0, length).rfind('/') + 1;
    const bool endsWithin = difference.second != to.target.end() && *difference.second == '/';
    return endsWithin || shared < to.plainFrom ? std::nullopt : std::optional(shared);
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
    const SetPath* first = nullptr; ///< that is not reached
    std::size_t count = 0;
    std::string reached;    ///< instead of the first; empty if it is not a directory at all
    bool isHandled = false; ///< whether the page script, which encodes prefixes, gets to the first
};

WrongLinks FindWrongLinks(const std::vector<SetPath>& paths, const SetPath& from)
{
    WrongLinks wrong;
    std::map<std::size_t, bool> areWrong; // by the length that is shared
    for (const SetPath& to : paths)
    {
        const std::optional<std::size_t> shared = SharedBeforePlainRest(from, to);
        const auto known = shared ? areWrong.find(*shared) : areWrong.end();
        if (known != areWrong.end())
        {
            wrong.count += known->second ? 1 : 0;
            continue;
        }
        const std::optional<std::string> prefix = PrefixInScripts(from, to);
        const std::optional<std::string> reached =
            prefix ? FollowPrefix(from, *prefix) : to.webPath; // the other's fault
        const bool isWrong = reached != to.webPath;
        if (isWrong && wrong.count++ == 0)
        {
            wrong.first = &to;
            wrong.reached = reached.value_or("");
            wrong.isHandled = FollowPrefix(from, EncodedPrefix(*prefix)) == to.webPath;
        }
        if (shared)
        {
            areWrong[*shared] = isWrong;
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

/// Returns what a path has after the last '/' that it shares with another; all of it if it shares none.
std::string RestOf(const std::string& path, const std::string& other)
{
    const auto difference = std::mismatch(path.begin(), path.end(), other.begin(), other.end()).first;
    return path.substr(std::string(path.begin(), difference).rfind('/') + 1);
}

/// Whether the path has a step that leads nowhere, or back, as a slash at the end of a root makes.
bool HasEmptySteps(const std::string& path)
{
    const std::string steps = "/" + path;
    return steps.find("/./") != std::string::npos || steps.find("/../") != std::string::npos ||
           steps.find("//") != std::string::npos;
}

std::string Remedy(const SetPath& from, const SetPath& to)
{
    const std::string fromRest = RestOf(from.module.Text(), to.module.Text());
    const std::string toRest = RestOf(to.module.Text(), from.module.Text());
    const std::string fromName = fromRest.substr(0, fromRest.find('/'));
    const std::string toName = toRest.substr(0, toRest.find('/'));
    if (fromName != toName && !toName.empty() && fromName.compare(0, toName.size(), toName) == 0)
    {
        return "rename " + Visible(fromName) + ", which begins with " + Visible(toName);
    }
    if (toRest == to.module.Text())
    {
        return "give absolute paths";
    }
    return HasEmptySteps(fromRest) || HasEmptySteps(toRest)
               ? "give the roots without \"/./\", \"/../\", \"//\" and a slash at the end"
               : "rename the directory";
}

std::string DescribeWrongLinks(const SetPath& from, const WrongLinks& wrong)
{
    const std::string others = wrong.count > 1 ? " and " + std::to_string(wrong.count - 1) + " more" : "";
    const std::string lead =
        wrong.reached.empty() ? " will lead elsewhere" : " will lead to " + DisplayedWebPath(wrong.reached);
    return "links to " + Visible(wrong.first->root) + others + lead +
           (wrong.isHandled ? " without the page script" : "") + ": " + Remedy(from, *wrong.first);
}

/// Returns the first set directory in whose scripts the prefix to another one breaks the string, or null.
const SetPath* FindBroken(const std::vector<SetPath>& paths, const SetPath& to)
{
    if (to.module.Text().find_first_of("\"\\\n\r") == std::string::npos)
    {
        return nullptr;
    }
    const auto broken = std::find_if(paths.begin(), paths.end(),
                                     [&](const SetPath& from) { return !PrefixInScripts(from, to); });
    return broken == paths.end() ? nullptr : &*broken;
}

/// Returns what is wrong with the links from or to one set directory, or an empty text.
std::string FindFault(const std::vector<SetPath>& paths, const SetPath& path)
{
    if (const SetPath* const from = FindBroken(paths, path))
    {
        return "a quote, backslash or line break in the path breaks both scripts of " + Visible(from->root) +
               ": rename the directory";
    }
    const WrongLinks wrong = FindWrongLinks(paths, path);
    return wrong.count == 0 ? "" : DescribeWrongLinks(path, wrong);
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
            const std::string fault = isReported[path.position] ? "" : FindFault(paths, path);
            if (!fault.empty())
            {
                isReported[path.position] = true;
                report.Add(Finding::OfRoot(Rule::WrongLinkPath, path.position, path.root, fault));
            }
        }
    }
}
