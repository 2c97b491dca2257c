#pragma once

#include "Tools/DocTools/VantorPagemeld/Output/ScopedFile.h"

#include <string>

/// Takes what is written to standard error from its construction until it is asked for the text, or dies.
class CapturedStderr
{
public:
    CapturedStderr();
    ~CapturedStderr();

    CapturedStderr(const CapturedStderr&) = delete;
    CapturedStderr& operator=(const CapturedStderr&) = delete;

    /// Ends the capture, and returns all that was written. To be called once.
    std::string Text();

private:
    void Restore();

    ScopedFile m_taken;
    int m_standardError;
};
