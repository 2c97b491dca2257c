#pragma once

/// Makes the command line known to HasARGV. The array and its texts must outlive all calls, as those
/// given to main do.
void SetCommandLine(int argc, const char* const* argv);

/// Returns whether some argument is the name behind "-" or "--", ignoring ASCII case. An argument counts
/// wherever it stands, even if it serves another purpose too.
bool HasARGV(const char* name);
