#include "Tools/DocTools/VantorPagemeld/DocumentationSet.h"

#include "Tools/DocTools/VantorPagemeld/IndexCombiner.h"
#include "Tools/DocTools/VantorPagemeld/RapidJsonIoUtil.h"
#include "Tools/DocTools/VantorPagemeld/Script/IndexScript.h"
#include "Tools/DocTools/VantorPagemeld/TocCombiner.h"

#include <cstdio>
#include <functional>
#include <optional>

namespace
{

/// Writes one output of the module at modulePath to the file at outputPath. Returns whether it was written.
using OutputWriter = std::function<bool(const char* modulePath, const char* outputPath)>;

struct Output
{
    const char* name; ///< the file, behind a module path
    OutputWriter write;
};

void WriteAndRename(const std::string& modulePath, const Output& output)
{
    const std::string finalPath = modulePath + output.name;
    const std::string temporaryPath = finalPath + ".tmp";
    if (output.write(modulePath.c_str(), temporaryPath.c_str()))
    {
        // A rename that fails is deliberately not reported.
        (void)std::rename(temporaryPath.c_str(), finalPath.c_str());
    }
}

/// Renders each output once, and writes all of them for each module in turn.
void WriteOutputs(const std::list<std::string>& modulePaths, const IndexCombiner& index,
                  const TocCombiner& toc)
{
    RepeatedText indexJson(RapidJsonIoUtil::RenderPrettyJson(index.combinedDocument));
    const RenderedText indexScript = RenderIndexScript(index.combinedDocument);
    RepeatedText tocJson(RapidJsonIoUtil::RenderPrettyJson(toc.combinedDocument));
    const std::optional<RenderedText> tocScript = toc.RenderScript(toc.combinedDocument);

    const Output outputs[] = {
        {"/docdata/global_index.json", [&](const char*, const char* path)
         { return RapidJsonIoUtil::OutputJsonTextToFile(indexJson, path); }},
        {"/docdata/global_index.js",
         [&](const char* module, const char* path) { return index.OutputScript(module, indexScript, path); }},
        {"/docdata/global_toc.json",
         [&](const char*, const char* path) { return RapidJsonIoUtil::OutputJsonTextToFile(tocJson, path); }},
        {"/docdata/global_toc.js",
         [&](const char* module, const char* path) { return toc.OutputScript(module, tocScript, path); }},
    };
    for (const std::string& modulePath : modulePaths)
    {
        for (const Output& output : outputs)
        {
            WriteAndRename(modulePath, output);
        }
    }
}

} // namespace

int CombineAllTocAndIndex(const std::list<std::string>& moduleRoots, const std::string& setName)
{
    std::list<std::string> modulePaths;
    for (const std::string& root : moduleRoots)
    {
        modulePaths.push_back(root + "/" + setName);
    }

    IndexCombiner index;
    if (!index.CombineJson(modulePaths, "docdata/index.json"))
    {
        return -1;
    }
    TocCombiner toc;
    if (!toc.CombineJson(modulePaths, "docdata/toc.json"))
    {
        return -1;
    }
    WriteOutputs(modulePaths, index, toc);
    return 0;
}
