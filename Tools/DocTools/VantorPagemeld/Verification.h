#pragma once

#include <string>

/// Checks that those of the four input files of a documentation root that exist, in its directory en,
/// can be read and are JSON. Their structure is not checked, and a missing file is no error.
///
/// Names on standard error each file that it skips or verifies. Returns false at the first file that fails.
bool VerifyTocAndIndex(const std::string& rootDocPath);
