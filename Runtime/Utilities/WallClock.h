#pragma once

#include <cstdint>

#include <sys/time.h>

/// GetCurrentTimeAsDateTime at 1970-01-01 00:00 UTC.
constexpr std::int64_t kDateTimeOfUnixEpoch = 621'355'968'000'000'000;

/// Returns the wall clock in ticks of 100 nanoseconds since 0001-01-01 00:00 UTC. It advances in steps of a
/// microsecond.
std::int64_t GetCurrentTimeAsDateTime();

namespace UnitTest
{

/// A stop-watch on the wall clock; setting the clock back makes it show a negative time.
class TimerImplPosix
{
public:
    void Start();

    /// Returns the milliseconds since Start.
    [[nodiscard]] int GetTimeInMs() const;

    /// Subtracts seconds and microseconds separately, and truncates the latter to milliseconds. If the second
    /// changed in between, the result can be one more than the whole milliseconds that passed.
    static int MillisecondsBetween(const timeval& start, const timeval& now);

private:
    timeval m_start{};
};

} // namespace UnitTest
