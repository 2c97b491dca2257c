#pragma once

#include "tests/support/TemporaryDirectory.h"

#include <string>
#include <vector>

/// How a process ended, and what it printed.
struct ProgramResult
{
    int status; ///< exit status, or minus the number of the signal that ended it
    std::string standardOutput;
    std::string standardError;
};

/// Runs a program to its end. It is found on the search path unless its name has a slash.
ProgramResult RunProgram(const std::string& program, const std::vector<std::string>& arguments);

/// Runs the built pagemeld to its end, with the directory for @ in its arguments.
///
/// Returns its standard output, its standard error and a line that reads "status 0", with @ for the directory
/// and PROGRAM for its own path.
std::string RunPagemeld(const TemporaryDirectory& directory, const std::vector<std::string>& arguments);

/// The same for the built pagemeld-check, whose path is not replaced.
std::string RunPagemeldCheck(const TemporaryDirectory& directory, const std::vector<std::string>& arguments);
