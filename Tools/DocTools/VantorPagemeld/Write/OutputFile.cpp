#include "Tools/DocTools/VantorPagemeld/Write/OutputFile.h"

#include "Tools/DocTools/VantorPagemeld/ModuleLayout.h"
#include "Tools/DocTools/VantorPagemeld/System/FileStatus.h"
#include "Tools/DocTools/VantorPagemeld/System/ScopedFile.h"

#include <cstdio>
#include <utility>

#include <unistd.h>

namespace
{

/// Returns null when the open fails or a named pipe is at path. A pipe would store nothing, and its reader
/// could block the run.
ScopedFile OpenForWriting(const char* path)
{
    ScopedFile file(std::fopen(path, "w+b")); // does not wait: it opens both ends of a pipe
    return file != nullptr && FileStatus::Of(file.get()).IsPipe() ? nullptr : std::move(file);
}

} // namespace

bool WriteOutput(const char* path, std::string_view head, SharedText& body, const OutputKind& kind)
{
    ScopedFile file = OpenForWriting(path);
    if (file == nullptr)
    {
        kind.reportUnopened(path);
        return false;
    }
    const bool isComplete = body.WriteTo(std::move(file), head);
    if (isComplete || kind.keepsIncomplete)
    {
        return true;
    }
    (void)::unlink(path);
    return false;
}

void ReplaceOutput(const std::string& path, std::string_view head, SharedText& body, const OutputKind& kind)
{
    const std::string temporaryPath = TemporaryPathOf(path);
    const bool isReplaced = WriteOutput(temporaryPath.c_str(), head, body, kind) &&
                            std::rename(temporaryPath.c_str(), path.c_str()) == 0;
    if (isReplaced && head.empty())
    {
        body.SetOriginal(path);
    }
}
