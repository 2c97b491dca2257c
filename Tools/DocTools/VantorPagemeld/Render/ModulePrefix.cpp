#include "Tools/DocTools/VantorPagemeld/Render/ModulePrefix.h"

#include <algorithm>
#include <cstddef>

namespace
{

/// Returns where the paths diverge: the position of a '/' in toModule, or its start.
std::size_t FindSplit(std::string_view fromModule, std::string_view toModule)
{
    const auto difference =
        std::mismatch(fromModule.begin(), fromModule.end(), toModule.begin(), toModule.end());
    const auto common = static_cast<std::size_t>(difference.second - toModule.begin());
    if (common == toModule.size() || toModule[common] != '/')
    {
        // The names diverge within, as "charts" and "chapters" do: the directory that holds both counts.
        const std::size_t slash = toModule.substr(0, common).rfind('/');
        return slash == std::string_view::npos ? 0 : slash;
    }
    return common;
}

/// Returns toModule after the split and after every '/' that is there.
std::string_view TailAfter(std::string_view toModule, std::size_t split)
{
    // There are two in a row where a root was typed with a '/' at its end.
    std::string_view tail = toModule.substr(split);
    tail.remove_prefix(std::min(tail.find_first_not_of('/'), tail.size()));
    return tail;
}

} // namespace

std::string PrefixVariable(int moduleIndex)
{
    return "p" + std::to_string(moduleIndex);
}

std::string RelativePrefix(std::string_view fromModule, std::string_view toModule)
{
    const std::size_t split = FindSplit(fromModule, toModule);
    const std::string_view below = fromModule.substr(split);

    std::string prefix;
    for (auto climbs = std::count(below.begin(), below.end(), '/'); climbs > 0; --climbs)
    {
        prefix += "../";
    }
    return prefix.append(TailAfter(toModule, split));
}

std::string RenderPrefixLines(std::string_view fromModule, const std::map<int, std::string>& modulePathTable)
{
    std::string lines;
    for (const auto& [moduleIndex, path] : modulePathTable)
    {
        lines += "var " + PrefixVariable(moduleIndex) + " = \"" + RelativePrefix(fromModule, path) + "\";\n";
    }
    return lines;
}
