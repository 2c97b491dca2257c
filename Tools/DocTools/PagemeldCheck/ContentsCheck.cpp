#include "Tools/DocTools/PagemeldCheck/ContentsCheck.h"

namespace
{

using Modules = std::vector<const SetModule*>;

/// Reports the root of a module, which differs from that of another one.
void ReportRoot(const SetModule& module, const SetModule& other, const std::string& consequence,
                Report& report)
{
    const bool linkDiffers = module.toc.rootLink != other.toc.rootLink;
    const std::string& own = linkDiffers ? module.toc.rootLink : module.toc.rootTitle;
    const std::string& others = linkDiffers ? other.toc.rootLink : other.toc.rootTitle;
    const std::string member = linkDiffers ? "link" : "title";
    Finding finding =
        Finding::OfFile(Rule::RootDiffers, module.File(module.path.PathOf(Input::Toc)),
                        "root " + member + " " + Quoted(own, module.options.quoteSize) + " differs from " +
                            Quoted(others, module.options.quoteSize) + " " + consequence);
    finding.place = module.toc.rootPlaces[linkDiffers ? 0 : 1];
    finding.pointer = "/" + member;
    report.Add(std::move(finding));
}

void ReportOddFirst(const SetModule& first, const Modules& dropped, Report& report)
{
    std::vector<std::string> names;
    names.reserve(dropped.size());
    for (const SetModule* module : dropped)
    {
        names.push_back(module->name);
    }
    ReportRoot(first, *dropped.front(),
               "of " + std::to_string(dropped.size()) +
                   " other modules; it comes first, so they are dropped from the contents of " +
                   NameOf(first.docdata.set) + ": " + Listed(names),
               report);
}

} // namespace

void CheckContentRoots(std::vector<SetModule>& modules, Report& report)
{
    const SetModule* first = nullptr;
    std::size_t sameCount = 0;
    Modules dropped;
    for (SetModule& module : modules)
    {
        if (!module.toc.IsSound())
        {
            continue;
        }
        first = first == nullptr ? &module : first;
        if (module.toc.Root() == first->toc.Root())
        {
            ++sameCount;
            continue;
        }
        module.isDropped = true;
        dropped.push_back(&module);
    }
    if (first == nullptr)
    {
        return;
    }
    // One that differs is odd itself. If two or more differ and none is like the first, the first is.
    if (dropped.size() >= 2 && sameCount == 1)
    {
        ReportOddFirst(*first, dropped, report);
        return;
    }
    for (const SetModule* module : dropped)
    {
        ReportRoot(*module, *first, "of " + Visible(first->root) + "; " + module->ScopeOf(Input::Toc).Loss(),
                   report);
    }
}
