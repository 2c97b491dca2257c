#pragma once

#include "Tools/DocTools/VantorPagemeld/System/ScopedFile.h"

#include <algorithm>
#include <string>
#include <utility>

/// An unbuffered stream whose device is full after capacity bytes: writes beyond fail.
class FullDevice
{
public:
    explicit FullDevice(std::size_t capacity) : m_capacity(capacity)
    {
        cookie_io_functions_t functions = {};
        functions.write = &FullDevice::Write;
        m_stream.reset(::fopencookie(this, "w", functions));
        (void)std::setvbuf(m_stream.get(), nullptr, _IONBF, 0);
    }

    [[nodiscard]] std::FILE* Stream() const { return m_stream.get(); }

    /// Hands over the stream, which must not outlive this object.
    ScopedFile Take() { return std::move(m_stream); }

    /// What has reached the device so far.
    [[nodiscard]] const std::string& Arrived() const { return m_arrived; }

private:
    static ssize_t Write(void* device, const char* bytes, std::size_t count)
    {
        auto& self = *static_cast<FullDevice*>(device);
        const std::size_t taken = std::min(count, self.m_capacity - self.m_arrived.size());
        self.m_arrived.append(bytes, taken);
        return static_cast<ssize_t>(taken);
    }

    std::size_t m_capacity;
    std::string m_arrived;
    ScopedFile m_stream; // its end may write to m_arrived
};
