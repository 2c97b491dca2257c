#pragma once

#include <string>

/// Checks the four input files in the directory en of a documentation root: each that exists must be readable
/// and JSON. Their structure is not checked, and a missing file is not an error.
///
/// Names on standard error each file that it skips or verifies. Returns false at the first file that fails.
bool VerifyTocAndIndex(const std::string& rootDocPath);
