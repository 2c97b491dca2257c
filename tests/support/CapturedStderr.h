#pragma once

#include <gtest/gtest.h>

#include <string>
#include <utility>

/// Takes what is written to standard error, until it is asked for the text or destroyed.
class CapturedStderr
{
public:
    CapturedStderr() { testing::internal::CaptureStderr(); }
    ~CapturedStderr() { (void)Text(); }

    CapturedStderr(const CapturedStderr&) = delete;
    CapturedStderr& operator=(const CapturedStderr&) = delete;

    /// Ends the capture, and returns all that was written; nothing the second time.
    std::string Text()
    {
        return std::exchange(m_isCapturing, false) ? testing::internal::GetCapturedStderr() : "";
    }

private:
    bool m_isCapturing = true;
};
