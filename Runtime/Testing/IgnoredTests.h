#pragma once

#include "Runtime/Testing/DisabledTestInfo.h"

#include <vector>

/// Whether a goes before b in the report: the higher case number first, then the greater reason by bytes,
/// then the shorter displayed test name. Names of one length count as equal; what they say is deliberately
/// not compared.
bool GroupByBugAndReason(const DisabledTestInfo& a, const DisabledTestInfo& b);

/// Sorts the tests by GroupByBugAndReason and returns the report on them, empty if there are none. Tests with
/// the same case number and the same reason share a line; those without a reason never do.
core::string DescribeIgnoredTests(std::vector<DisabledTestInfo>& ignoredTests);
