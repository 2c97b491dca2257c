#pragma once

#include <map>
#include <string>
#include <string_view>

// The variables p0, p1, ... of the scripts. Each holds the path to one merged module, so that the scripts of
// two modules differ in these lines alone.

/// Returns the name of a module's variable.
std::string PrefixVariable(int moduleIndex);

/// Returns the path from the directory fromModule to toModule as the web pages use it: "../" for every '/' in
/// fromModule after the common start, then the rest of toModule.
///
/// Works on bytes; neither splits into components nor normalises nor escapes. toModule ends in '/',
/// fromModule does not. Two results differ from the true relative path, and pages rely on both: a
/// module whose name begins with a sibling's gets a shorter climb to that sibling, and relative paths without
/// a common directory climb one level less.
std::string RelativePrefix(std::string_view fromModule, std::string_view toModule);

/// Returns a line for each entry of the table, which holds module paths with their trailing '/', that sets
/// the module's variable to its relative prefix seen from fromModule. Nothing in a path is escaped, on
/// purpose.
std::string RenderPrefixLines(std::string_view fromModule, const std::map<int, std::string>& modulePathTable);
