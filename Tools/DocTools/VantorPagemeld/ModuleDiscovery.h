#pragma once

#include <functional>
#include <list>
#include <string>

/// Appends every documentation module below a directory to the list: each directory that holds the directory
/// Manual/docdata.
///
/// Walks depth first, siblings in the byte order of their names, and does not look inside a module. The
/// directory itself is no candidate. Hidden directories and symbolic links are passed over, and what can't be
/// listed counts as empty; silent.
void GetPathsOfDocs(const std::string& directory, std::list<std::string>& moduleRoots);

/// Why a directory that looks like a module is passed over.
enum class PassedOver
{
    Link,
    Hidden,
    WithoutManual, ///< it holds ScriptReference/docdata alone
};

using PassedOverHandler = std::function<void(const std::string& path, PassedOver reason)>;

/// The same as GetPathsOfDocs, and tells what looks like a module and is not taken, where the walk comes by.
/// That takes further questions to the file system.
void FindModules(const std::string& directory, std::list<std::string>& moduleRoots,
                 const PassedOverHandler& onPassedOver);
