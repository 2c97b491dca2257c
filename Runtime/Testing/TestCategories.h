#pragma once

namespace Testing
{

constexpr const char* kUnitTestCategory = "Unit";
constexpr const char* kPerformanceTestCategory = "Performance";

} // namespace Testing
