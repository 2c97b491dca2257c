#pragma once

#include <list>
#include <string>

/// Appends every documentation module below a directory to the list: each directory that IsModuleRoot.
///
/// Walks depth first, siblings in the byte order of their names, and does not look inside a module. The
/// directory itself is not a candidate. Hidden directories and symbolic links are passed over, and what can't
/// be listed counts as empty. Prints nothing.
void GetPathsOfDocs(const std::string& directory, std::list<std::string>& moduleRoots);

/// Whether path has Manual/docdata with the directory bit set. Sockets and block devices have it too; that
/// only this bit is tested is intentional.
bool IsModuleRoot(const std::string& path);
