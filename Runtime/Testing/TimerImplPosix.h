#pragma once

#include <sys/time.h>

namespace UnitTest
{

/// A stop-watch on the wall clock; setting the clock back makes it show a negative time.
class TimerImplPosix
{
public:
    void Start();

    /// Returns the milliseconds since Start.
    [[nodiscard]] int GetTimeInMs() const;

    /// Seconds and microseconds are subtracted on their own, and the latter cut to whole milliseconds towards
    /// zero: over a change of the second the result is up to one above the whole milliseconds that passed.
    static int MillisecondsBetween(const timeval& start, const timeval& now);

private:
    timeval m_start{};
};

} // namespace UnitTest
