#pragma once

#include <string>

/// Runs the self-tests that the filter selects. Returns the number of failed tests.
int RunNativeTests(const std::string& filter);
