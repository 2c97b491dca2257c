#include "Runtime/Testing/TimerImplPosix.h"

namespace UnitTest
{

void TimerImplPosix::Start()
{
    (void)::gettimeofday(&m_start, nullptr);
}

int TimerImplPosix::GetTimeInMs() const
{
    timeval now{};
    (void)::gettimeofday(&now, nullptr);
    return MillisecondsBetween(m_start, now);
}

int TimerImplPosix::MillisecondsBetween(const timeval& start, const timeval& now)
{
    return static_cast<int>((now.tv_usec - start.tv_usec) / 1000 + (now.tv_sec - start.tv_sec) * 1000);
}

} // namespace UnitTest
