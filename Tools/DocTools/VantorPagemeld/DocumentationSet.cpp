#include "Tools/DocTools/VantorPagemeld/DocumentationSet.h"

#include "Tools/DocTools/VantorPagemeld/IndexCombiner.h"
#include "Tools/DocTools/VantorPagemeld/ModulePath.h"
#include "Tools/DocTools/VantorPagemeld/RapidJsonIoUtil.h"
#include "Tools/DocTools/VantorPagemeld/Render/IndexScript.h"
#include "Tools/DocTools/VantorPagemeld/TocCombiner.h"

namespace
{

/// One of the files that every module receives.
struct Output
{
    const char* name;
    const OutputKind& kind;
    const JsonCombiner* prefixes; ///< whose prefix lines come before the body; null for JSON
    SharedText body;
};

/// Writes all outputs for each module in turn. Each body is rendered only once.
void WriteOutputs(const std::list<std::string>& modulePaths, const IndexCombiner& index,
                  const TocCombiner& toc)
{
    Output outputs[] = {
        {kIndexJsonOutput, RapidJsonIoUtil::kJsonFile, nullptr,
         SharedText(RenderPrettyJson(index.combinedDocument))},
        {kIndexScriptOutput, IndexCombiner::kScriptFile, &index,
         SharedText(RenderIndexScript(index.combinedDocument))},
        {kTocJsonOutput, RapidJsonIoUtil::kJsonFile, nullptr,
         SharedText(RenderPrettyJson(toc.combinedDocument))},
        {kTocScriptOutput, TocCombiner::kScriptFile, &toc, SharedText(RenderTocScript(toc.combinedDocument))},
    };
    for (const std::string& path : modulePaths)
    {
        for (Output& output : outputs)
        {
            const std::string head =
                output.prefixes == nullptr ? "" : output.prefixes->PrefixLines(path.c_str());
            ReplaceOutput(ModulePath(path).File(output.name), head, output.body, output.kind);
        }
    }
}

} // namespace

int CombineAllTocAndIndex(const std::list<std::string>& moduleRoots, const std::string& setName)
{
    std::list<std::string> modulePaths;
    for (const std::string& root : moduleRoots)
    {
        modulePaths.push_back(ModulePath(root, setName).Text());
    }

    IndexCombiner index;
    if (!index.CombineJson(modulePaths, kIndexInput))
    {
        return -1;
    }
    TocCombiner toc;
    if (!toc.CombineJson(modulePaths, kTocInput))
    {
        return -1;
    }
    WriteOutputs(modulePaths, index, toc);
    return 0;
}
