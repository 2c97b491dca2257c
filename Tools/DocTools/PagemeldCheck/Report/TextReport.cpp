#include "Tools/DocTools/PagemeldCheck/Report/TextReport.h"

#include "Tools/DocTools/PagemeldCheck/Explain/ShownText.h"

#include <iterator>

namespace
{

const char* ColorOf(Level level)
{
    switch (level)
    {
    case Level::Error:
        return "\033[1;31m";
    case Level::Warning:
        return "\033[1;35m";
    default:
        return "\033[1;36m";
    }
}

/// Returns a pointer after a space, cut if it is long; nothing for the root.
std::string ShownPointer(const std::string& pointer)
{
    constexpr std::size_t kLongPointer = 200;
    const std::string shown = pointer.empty() ? "" : " " + Visible(pointer.substr(0, kLongPointer));
    return pointer.size() > kLongPointer ? shown + "..." : shown;
}

/// Returns the names of modules with commas between them.
std::string Joined(const std::vector<std::string>& roots)
{
    std::string text;
    for (const std::string& name : roots)
    {
        text += (text.empty() ? "" : ", ") + Visible(NameOfRoot(name));
    }
    return text;
}

std::string Counted(std::size_t count, const char* noun)
{
    return std::to_string(count) + " " + noun + (count == 1 ? "" : "s");
}

} // namespace

std::string TextLine(const Finding& finding, bool isColored)
{
    std::string line = finding.file.empty() && finding.set ? kSetNames[*finding.set] : Visible(finding.file);
    if (finding.place)
    {
        line += ":" + std::to_string(finding.place->line) + ":" + std::to_string(finding.place->column);
    }
    const std::string level = NameOf(finding.rule->level);
    line += line.empty() ? "" : ": ";
    line += isColored ? ColorOf(finding.rule->level) + level + ":\033[0m " : level + ": ";
    line += finding.message + " [" + finding.rule->id + "]";
    return line + ShownPointer(finding.pointer.value_or(""));
}

std::string TextSummary(const Summary& summary)
{
    std::string counts = Counted(summary.modules, "module") + ", " +
                         Counted(summary.CountOf(Level::Error), "error") + ", " +
                         Counted(summary.CountOf(Level::Warning), "warning");
    std::string missing;
    for (std::size_t set = 0; set < std::size(kSetNames); ++set)
    {
        const auto& [search, contents] = summary.missing[set];
        const std::string setName = kSetNames[set];
        if (!search.empty())
        {
            missing += (missing.empty() ? "; missing from the search of " : "; from the search of ") +
                       setName + ": " + Joined(search);
        }
        if (!contents.empty())
        {
            const std::string of = search.empty() ? "the contents of " + setName : "its contents";
            missing += (missing.empty() ? "; missing from " : "; from ") + of + ": " + Joined(contents);
        }
    }
    return counts + missing;
}
