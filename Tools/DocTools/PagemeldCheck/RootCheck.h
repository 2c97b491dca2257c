#pragma once

#include "Tools/DocTools/PagemeldCheck/Report/Report.h"

#include <string>
#include <vector>

/// Whether there is anything at a root. The empty one is that of the file system: its set is /Manual.
[[nodiscard]] bool RootExists(const std::string& root);

/// Whether a root has a set: pagemeld reads and writes its docdata directory only.
[[nodiscard]] bool HasSet(const std::string& root, DocSet set);

/// Whether a root has any set.
[[nodiscard]] bool IsModule(const std::string& root);

/// Reports roots that do not exist, if none of the roots is a module, and roots or sets that are the same
/// directory.
void CheckRoots(const std::vector<std::string>& roots, Report& report);
