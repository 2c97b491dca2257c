#pragma once

#include <string>

/// Checks that those of the four input files of a documentation root that exist, in its folder en, can be
/// read and are JSON. Their structure is not checked, and a missing file is no error.
///
/// Says on standard error which file it skips or verifies. Returns false at the first file that fails.
bool VerifyTocAndIndex(const std::string& rootDocPath);
