#include "Tools/DocTools/VantorPagemeld/DocumentationSet.h"

#include "Tools/DocTools/VantorPagemeld/IndexCombiner.h"
#include "Tools/DocTools/VantorPagemeld/ModuleLayout.h"
#include "Tools/DocTools/VantorPagemeld/RapidJsonIoUtil.h"
#include "Tools/DocTools/VantorPagemeld/Render/IndexScript.h"
#include "Tools/DocTools/VantorPagemeld/TocCombiner.h"

#include <vector>

namespace
{

/// What is written under the name of a row of kOutputs.
struct Content
{
    const OutputKind& kind;
    const JsonCombiner& combiner;
    SharedText body;
};

Content Render(Output output, const IndexCombiner& index, const TocCombiner& toc)
{
    switch (output)
    {
    case Output::IndexJson:
        return {RapidJsonIoUtil::kJsonFile, index, SharedText(RenderPrettyJson(index.combinedDocument))};
    case Output::IndexScript:
        return {IndexCombiner::kScriptFile, index, SharedText(RenderIndexScript(index.combinedDocument))};
    case Output::TocJson:
        return {RapidJsonIoUtil::kJsonFile, toc, SharedText(RenderPrettyJson(toc.combinedDocument))};
    case Output::TocScript:
    case Output::Count:
        break;
    }
    return {TocCombiner::kScriptFile, toc, SharedText(RenderTocScript(toc.combinedDocument))};
}

/// Writes all outputs for each module in turn. Each body is rendered only once.
void WriteOutputs(const std::list<std::string>& modulePaths, const IndexCombiner& index,
                  const TocCombiner& toc)
{
    std::vector<Content> contents;
    for (const OutputRow& output : kOutputs)
    {
        contents.push_back(Render(output.id, index, toc));
    }
    for (const std::string& path : modulePaths)
    {
        for (const OutputRow& output : kOutputs)
        {
            auto& [kind, combiner, body] = contents[static_cast<std::size_t>(output.id)];
            const bool hasPrefixes = output.form == OutputRow::Form::Script;
            const std::string head = hasPrefixes ? combiner.PrefixLines(path.c_str()) : "";
            ReplaceOutput(ModulePath(path).PathOf(output), head, body, kind);
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
    if (!index.CombineJson(modulePaths, PathInSet(Input::Index)))
    {
        return -1;
    }
    TocCombiner toc;
    if (!toc.CombineJson(modulePaths, PathInSet(Input::Toc)))
    {
        return -1;
    }
    WriteOutputs(modulePaths, index, toc);
    return 0;
}
