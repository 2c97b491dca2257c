#include "Tools/DocTools/PagemeldCheck/Report/TextReport.h"

#include "Tools/DocTools/PagemeldCheck/Explain/ShownText.h"

namespace
{

/// Returns a pointer after a space, cut if it is long; nothing for the root.
std::string ShownPointer(const std::string& pointer)
{
    constexpr std::size_t kLongPointer = 200;
    const std::string shown = pointer.empty() ? "" : " " + Visible(pointer.substr(0, kLongPointer));
    return pointer.size() > kLongPointer ? shown + "..." : shown;
}

std::string NamesOf(const std::vector<std::string>& roots)
{
    std::vector<std::string> names;
    names.reserve(roots.size());
    for (const std::string& root : roots)
    {
        names.push_back(Visible(NameOfRoot(root)));
    }
    return Listed(names);
}

} // namespace

std::string TextLine(const Finding& finding, bool isColored)
{
    std::string line = finding.file.empty() && finding.set ? NameOf(*finding.set) : Visible(finding.file);
    if (finding.place)
    {
        line += ":" + std::to_string(finding.place->line) + ":" + std::to_string(finding.place->column);
    }
    const RuleRow& rule = RowOf(finding.rule);
    const std::string level = NameOf(rule.level);
    line += line.empty() ? "" : ": ";
    line += isColored ? RowOf(kLevels, rule.level).color + level + ":\033[0m " : level + ": ";
    line += finding.message + " [" + rule.name + "]";
    return line + ShownPointer(finding.pointer.value_or(""));
}

std::string TextSummary(const Summary& summary)
{
    std::string counts = Counted(summary.modules, "module") + ", " +
                         Counted(summary.CountOf(Level::Error), "error") + ", " +
                         Counted(summary.CountOf(Level::Warning), "warning");
    std::string missing;
    for (const auto& set : kDocSets)
    {
        const auto& [search, contents] = summary.missing[static_cast<std::size_t>(set.id)];
        const std::string setName = set.name;
        if (!search.empty())
        {
            missing += (missing.empty() ? "; missing from the search of " : "; from the search of ") +
                       setName + ": " + NamesOf(search);
        }
        if (!contents.empty())
        {
            const std::string of = search.empty() ? "the contents of " + setName : "its contents";
            missing += (missing.empty() ? "; missing from " : "; from ") + of + ": " + NamesOf(contents);
        }
    }
    return counts + missing;
}
