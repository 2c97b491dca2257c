#pragma once

#include <cstdint>

/// GetCurrentTimeAsDateTime at 1970-01-01 00:00 UTC.
constexpr std::int64_t kDateTimeOfUnixEpoch = 621'355'968'000'000'000;

/// Returns the wall clock in ticks of 100 nanoseconds since 0001-01-01 00:00 UTC. It advances in steps of a
/// microsecond.
std::int64_t GetCurrentTimeAsDateTime();
