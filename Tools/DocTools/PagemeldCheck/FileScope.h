#pragma once

#include "Tools/DocTools/VantorPagemeld/ModuleLayout.h"

#include <cstddef>
#include <string>

/// Which checks run, and how much of what they find is shown.
struct CheckOptions
{
    bool checksTargets = false; ///< whether page paths and links lead to files
    bool checksOutputs = false; ///< the outputs of a run, besides its inputs
    std::size_t limit = 10;     ///< findings shown per rule and file; 0 for all
    std::size_t quoteSize = 80; ///< bytes of a text that a message shows
};

/// A file or directory of one set of a module.
struct ModuleFile
{
    std::size_t module; ///< its position in the list of roots
    DocSet set;
    std::string path; ///< as pagemeld would name it
};

/// What the check of one input needs to know.
struct FileScope
{
    ModuleFile file;
    Input input;
    const std::string& root;       ///< of the module, as typed
    const std::string& moduleName; ///< as messages show it
    const ModulePath& directory;   ///< which page paths and links are relative to
    const CheckOptions& options;

    /// Returns what follows if the file is not taken.
    [[nodiscard]] std::string Loss() const
    {
        return moduleName + " will be missing from the " + (input == Input::Index ? "search" : "contents") +
               " of " + NameOf(file.set);
    }
};
