#include "Tools/DocTools/VantorPagemeld/Verification.h"

#include "Tools/DocTools/VantorPagemeld/RapidJsonIoUtil.h"
#include "Tools/DocTools/VantorPagemeld/System/Messages.h"

#include <rapidjson/document.h>

#include <sys/stat.h>

namespace
{

constexpr const char* kInputFiles[] = {
    "/en/Manual/docdata/toc.json",
    "/en/Manual/docdata/index.json",
    "/en/ScriptReference/docdata/toc.json",
    "/en/ScriptReference/docdata/index.json",
};

bool Exists(const std::string& path)
{
    struct stat status = {};
    return ::stat(path.c_str(), &status) == 0;
}

} // namespace

bool VerifyTocAndIndex(const std::string& rootDocPath)
{
    for (const char* inputFile : kInputFiles)
    {
        const std::string path = rootDocPath + inputFile;
        if (!Exists(path))
        {
            ReportProgress("Skipping %s\n", path.c_str());
            continue;
        }
        ReportProgress("Verifying %s\n", path.c_str());
        rapidjson::Document document;
        if (!RapidJsonIoUtil::TryGetJsonDocFromFile(path.c_str(), document))
        {
            return false;
        }
    }
    return true;
}
