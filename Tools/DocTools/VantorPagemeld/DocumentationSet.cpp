#include "Tools/DocTools/VantorPagemeld/DocumentationSet.h"

#include "Tools/DocTools/VantorPagemeld/IndexCombiner.h"
#include "Tools/DocTools/VantorPagemeld/ModuleLayout.h"
#include "Tools/DocTools/VantorPagemeld/RapidJsonIoUtil.h"
#include "Tools/DocTools/VantorPagemeld/TocCombiner.h"

#include <iterator>

namespace
{

/// What is written under the name of an output.
struct Content
{
    const OutputRow& output;
    const JsonCombiner& combiner;
    SharedOutput file;
};

/// Writes all outputs for each module in turn. Each body is rendered only once.
void WriteOutputs(const std::list<std::string>& modulePaths, const IndexCombiner& index,
                  const TocCombiner& toc)
{
    using RapidJsonIoUtil::JsonOutput;
    Content contents[std::size(kOutputs)] = {
        {RowOf(kOutputs, Output::IndexJson), index, JsonOutput(index.combinedDocument)},
        {RowOf(kOutputs, Output::IndexScript), index, index.ScriptOutput(index.combinedDocument)},
        {RowOf(kOutputs, Output::TocJson), toc, JsonOutput(toc.combinedDocument)},
        {RowOf(kOutputs, Output::TocScript), toc, toc.ScriptOutput(toc.combinedDocument)},
    };
    for (const std::string& path : modulePaths)
    {
        for (auto& [output, combiner, file] : contents)
        {
            const bool hasPrefixes = output.form == OutputRow::Form::Script;
            file.Replace(ModulePath(path).PathOf(output),
                         hasPrefixes ? combiner.PrefixLines(path.c_str()) : "");
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
