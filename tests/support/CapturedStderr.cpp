#include "tests/support/CapturedStderr.h"

#include <unistd.h>

CapturedStderr::CapturedStderr() : m_taken(std::tmpfile()), m_standardError(::dup(STDERR_FILENO))
{
    ::dup2(::fileno(m_taken.get()), STDERR_FILENO);
}

CapturedStderr::~CapturedStderr()
{
    Restore();
}

std::string CapturedStderr::Text()
{
    Restore();
    std::rewind(m_taken.get());
    std::string text;
    for (int c = std::fgetc(m_taken.get()); c != EOF; c = std::fgetc(m_taken.get()))
    {
        text += static_cast<char>(c);
    }
    return text;
}

void CapturedStderr::Restore()
{
    if (m_standardError >= 0)
    {
        std::fflush(stderr);
        ::dup2(m_standardError, STDERR_FILENO);
        ::close(m_standardError);
        m_standardError = -1;
    }
}
