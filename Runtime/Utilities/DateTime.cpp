#include "Runtime/Utilities/DateTime.h"

#include <sys/time.h>

std::int64_t GetCurrentTimeAsDateTime()
{
    timeval now{};
    (void)::gettimeofday(&now, nullptr);
    return now.tv_sec * std::int64_t{10'000'000} + now.tv_usec * std::int64_t{10} + kDateTimeOfUnixEpoch;
}
