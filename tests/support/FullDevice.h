#pragma once

#include "Tools/DocTools/VantorPagemeld/Output/ScopedFile.h"

#include <cstddef>
#include <string>

/// A stream whose device takes so many bytes and is full then: writes beyond fail, as on a full disk.
class FullDevice
{
public:
    explicit FullDevice(std::size_t capacity);

    FullDevice(const FullDevice&) = delete;
    FullDevice& operator=(const FullDevice&) = delete;

    [[nodiscard]] std::FILE* Stream() const { return m_stream.get(); }

    /// What has reached the device so far.
    [[nodiscard]] const std::string& Arrived() const { return m_arrived; }

private:
    static ssize_t Write(void* device, const char* bytes, std::size_t count);

    std::size_t m_capacity;
    std::string m_arrived;
    ScopedFile m_stream; // its end writes to m_arrived
};
