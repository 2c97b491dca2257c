#pragma once

#include "tests/support/TemporaryDirectory.h"

#include <string>
#include <vector>

// What is put at a path instead of a text.
inline const std::string kGone = "(gone)";
inline const std::string kDirectory = "(directory)";
inline const std::string kModule = "(a sound module)";
inline const std::string kLink = "(link to) "; ///< and a path
inline const std::string kCombined = "(outputs in both modules)";

/// What happens to a path of a tree before it is checked.
struct Change
{
    std::string path;
    std::string content;
};

/// A run over the sound modules a and b after some changes, and all that it prints: "..., status 0".
struct CheckCase
{
    std::string command; ///< for a shell in the directory of the modules, which is also @; CHECK is the
                         ///< program, AS_USER takes root's rights away, the comment says what must hold
    std::vector<Change> changes;
    const char* output;
};

/// Runs each case in a directory of its own. Each has what breaks some rules, mostly in module b, and what
/// comes close and is not reported, mostly in module a.
void ExpectReports(const std::vector<CheckCase>& cases);

/// Makes a sound module with one set.
void WriteSoundModule(const std::string& root);

/// Returns an index.json with these pages.
std::string Index(const std::string& pages,
                  const std::string& rest = R"("info":[],"common":{},"searchIndex":{})");

/// Returns a toc.json with these entries.
std::string Toc(const std::string& children, const std::string& root = R"("link":"toc","title":"toc")");
