#pragma once

#include "tests/support/RunProgram.h"
#include "tests/support/TemporaryDirectory.h"

#include <string>
#include <vector>

/// Two small modules, a and b, with the Manual set only, whose outputs are those of an earlier run. They lie
/// in a temporary directory that is removed with this object.
class ExampleDocs
{
public:
    struct Output
    {
        std::string path; ///< below the directory
        bool isScript;
        std::string newBytes; ///< what an undisturbed run writes
    };

    ExampleDocs();

    /// Returns the path of something below the directory.
    [[nodiscard]] std::string operator/(const std::string& name) const { return m_directory / name; }

    /// Runs pagemeld over both modules; through a command that runs another one, if given.
    [[nodiscard]] ProgramResult Run(const std::vector<std::string>& through = {}) const;

    /// Puts the earlier outputs back, in place of whatever runs and tests left in the modules.
    void Restore() const;

    /// In the order in which they are written: of each module the search index as JSON and as script, then
    /// the table of contents.
    [[nodiscard]] const std::vector<Output>& Outputs() const { return m_outputs; }

    /// Returns a letter for every output: "NNNN NNNN" after an undisturbed run.
    ///
    /// N is the new file, O the earlier one, C a new one that was cut short, E an empty one, D a directory, -
    /// nothing, ? anything else. A temporary file that is left is in brackets after its output.
    [[nodiscard]] std::string Describe() const;

private:
    TemporaryDirectory m_directory;
    std::vector<Output> m_outputs;
};
