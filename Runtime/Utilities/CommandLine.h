#pragma once

/// Makes the command line known to HasARGV. The array and its texts must outlive all calls, as those
/// given to main do.
void SetCommandLine(int argc, const char* const* argv);

/// Returns whether some argument is "-" or "--" followed by the name, ignoring ASCII case. Its position
/// doesn't matter, even if the argument serves another purpose too.
bool HasARGV(const char* name);
