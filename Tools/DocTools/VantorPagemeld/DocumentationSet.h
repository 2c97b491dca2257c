#pragma once

#include <list>
#include <string>

/// Combines one documentation set, "Manual" or "ScriptReference", of all module roots.
///
/// Reads docdata/index.json and docdata/toc.json of every module, and writes the merged search index and
/// table of contents into every module's docdata directory, as JSON and as scripts: even into those whose own
/// files were skipped. Paths are used as they are. Each output is written under a temporary name and renamed
/// into place only if it counts as written; a failed rename is not reported.
///
/// Returns 0, or -1 with nothing written when there was no search index or no table of contents to merge.
/// Failed writes do not change the result, but a search-index script that can't be opened ends the process
/// with status 255.
int CombineAllTocAndIndex(const std::list<std::string>& moduleRoots, const std::string& setName);
