#include "Runtime/Utilities/WallClock.h"

namespace
{

timeval Now()
{
    timeval now{};
    (void)::gettimeofday(&now, nullptr);
    return now;
}

} // namespace

std::int64_t GetCurrentTimeAsDateTime()
{
    const timeval now = Now();
    return now.tv_sec * std::int64_t{10'000'000} + now.tv_usec * std::int64_t{10} + kDateTimeOfUnixEpoch;
}

namespace UnitTest
{

void TimerImplPosix::Start()
{
    m_start = Now();
}

int TimerImplPosix::GetTimeInMs() const
{
    return MillisecondsBetween(m_start, Now());
}

int TimerImplPosix::MillisecondsBetween(const timeval& start, const timeval& now)
{
    return static_cast<int>((now.tv_usec - start.tv_usec) / 1000 + (now.tv_sec - start.tv_sec) * 1000);
}

} // namespace UnitTest
