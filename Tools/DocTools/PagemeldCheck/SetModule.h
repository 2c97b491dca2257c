#pragma once

#include "Tools/DocTools/PagemeldCheck/InputCheck.h"
#include "Tools/DocTools/VantorPagemeld/ModulePath.h"

#include <string>

/// One module of a set: where it is, and the outcome of reading its input files.
struct SetModule
{
    SetModule(const std::string& moduleRoot, const std::string& setName)
        : root(moduleRoot), path(moduleRoot, setName), docdata(path.File("docdata"))
    {
    }

    std::string root; ///< as typed
    ModulePath path;
    std::string docdata;
    bool hasDocdata = false; ///< whether that is a directory
    InputFacts index;
    InputFacts toc;
    bool isDropped = false; ///< whether the table of contents is sound, but left out for its root

    [[nodiscard]] bool HasFiles() const
    {
        return index.state != InputFacts::State::Missing || toc.state != InputFacts::State::Missing;
    }
};
