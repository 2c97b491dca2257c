#include "Tools/DocTools/VantorPagemeld/Verification.h"

#include "Tools/DocTools/VantorPagemeld/ModuleLayout.h"
#include "Tools/DocTools/VantorPagemeld/RapidJsonIoUtil.h"
#include "Tools/DocTools/VantorPagemeld/System/Diagnostics.h"
#include "Tools/DocTools/VantorPagemeld/System/FileStatus.h"

#include <rapidjson/document.h>

namespace
{

/// Returns whether the file is missing, or can be read and is JSON.
bool Verify(const std::string& path)
{
    if (!FileStatus::Of(path).Exists())
    {
        ReportProgress("Skipping %s\n", path.c_str());
        return true;
    }
    ReportProgress("Verifying %s\n", path.c_str());
    rapidjson::Document document;
    return RapidJsonIoUtil::TryGetJsonDocFromFile(path.c_str(), document);
}

} // namespace

bool VerifyTocAndIndex(const std::string& rootDocPath)
{
    for (const auto& set : kDocSets)
    {
        const ModulePath directory(rootDocPath + "/en", set.id);
        if (!Verify(directory.PathOf(Input::Toc)) || !Verify(directory.PathOf(Input::Index)))
        {
            return false;
        }
    }
    return true;
}
