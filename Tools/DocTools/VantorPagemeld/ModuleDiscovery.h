#pragma once

#include <functional>
#include <list>
#include <string>

/// Appends every documentation module below a directory to the list: each directory that holds the directory
/// Manual/docdata.
///
/// Walks depth first, siblings in the byte order of their names, and does not look inside a module. The
/// directory itself is not a candidate. Hidden directories and symbolic links are passed over, and what can't
/// be listed counts as empty. Prints nothing.
void GetPathsOfDocs(const std::string& directory, std::list<std::string>& moduleRoots);

/// Why a directory that looks like a module is passed over.
enum class PassedOver
{
    Link,
    Hidden,
    WithoutManual, ///< it holds ScriptReference/docdata alone
};

using PassedOverHandler = std::function<void(const std::string& path, PassedOver reason)>;

/// The same as GetPathsOfDocs. Also calls onPassedOver, unless it is empty, for what the walk passes over
/// although it looks like a module, which takes more file system calls.
void FindModules(const std::string& directory, std::list<std::string>& moduleRoots,
                 const PassedOverHandler& onPassedOver);
