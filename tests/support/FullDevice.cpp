#include "tests/support/FullDevice.h"

#include <algorithm>
#include <cerrno>

FullDevice::FullDevice(std::size_t capacity) : m_capacity(capacity)
{
    cookie_io_functions_t functions = {};
    functions.write = &FullDevice::Write;
    m_stream.reset(::fopencookie(this, "w", functions));
}

ssize_t FullDevice::Write(void* device, const char* bytes, std::size_t count)
{
    auto& self = *static_cast<FullDevice*>(device);
    const std::size_t taken = std::min(count, self.m_capacity - self.m_arrived.size());
    self.m_arrived.append(bytes, taken);
    if (taken == 0 && count > 0)
    {
        errno = ENOSPC;
    }
    return static_cast<ssize_t>(taken);
}
