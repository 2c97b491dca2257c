#pragma once

#include <string>
#include <string_view>

/// Returns the path from the folder fromModule to toModule as the web pages use it: "../" for every '/' left
/// in fromModule behind the common start, then the rest of toModule.
///
/// Works on bytes; neither splits into components nor normalises nor escapes. toModule ends in '/',
/// fromModule does not. Two results differ from what the folders ask for, and pages rely on both: a module
/// whose name begins with a sibling's gets a shorter climb to that sibling, and relative paths without a
/// common folder climb one level less.
std::string RelativePrefix(std::string_view fromModule, std::string_view toModule);
