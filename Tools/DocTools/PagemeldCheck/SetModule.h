#pragma once

#include "Tools/DocTools/PagemeldCheck/Explain/ShownText.h"
#include "Tools/DocTools/PagemeldCheck/InputCheck.h"
#include "Tools/DocTools/VantorPagemeld/System/FileStatus.h"

/// One module of a set: where it is, and the outcome of reading its input files.
struct SetModule
{
    /// The options must outlive the module.
    SetModule(std::size_t position, DocSet set, const std::string& moduleRoot,
              const CheckOptions& checkOptions)
        : options(checkOptions),
          root(moduleRoot),
          name(Quoted(NameOfRoot(moduleRoot), checkOptions.quoteSize)),
          path(moduleRoot, set),
          docdata{position, set, path.Docdata()},
          hasDocdata(FileStatus::Of(docdata.path).IsDirectory())
    {
    }

    /// Returns one of the module's files of the set.
    [[nodiscard]] ModuleFile File(std::string filePath) const
    {
        return {docdata.module, docdata.set, std::move(filePath)};
    }

    [[nodiscard]] ModuleFile File(const OutputRow& output) const { return File(path.PathOf(output)); }

    /// Returns what the check of an input needs. The module must outlive it.
    [[nodiscard]] FileScope ScopeOf(Input input) const
    {
        return {File(path.PathOf(input)), input, root, name, path, options};
    }

    InputFacts& FactsOf(Input input) { return input == Input::Index ? index : toc; }

    /// Whether the module brings anything to the set, sound or not.
    [[nodiscard]] bool HasFiles() const
    {
        return index.state != InputFacts::State::Missing || toc.state != InputFacts::State::Missing;
    }

    const CheckOptions& options;
    std::string root; ///< as typed
    std::string name; ///< as messages show it
    ModulePath path;
    ModuleFile docdata;
    bool hasDocdata; ///< whether that is a directory
    InputFacts index;
    InputFacts toc;
    bool isDropped = false; ///< whether the table of contents is sound, but left out for its root
};
