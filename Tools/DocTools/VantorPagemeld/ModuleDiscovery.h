#pragma once

#include <list>
#include <string>

/// Appends every documentation module below a directory to the list: each directory that holds the directory
/// Manual/docdata.
///
/// Walks depth first, siblings in the byte order of their names, and does not look inside a module. The
/// directory itself is no candidate. Hidden directories and symbolic links are passed over, and what can't be
/// listed counts as empty; silent.
void GetPathsOfDocs(const std::string& directory, std::list<std::string>& moduleRoots);
