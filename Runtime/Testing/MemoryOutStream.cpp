#include "Runtime/Testing/MemoryOutStream.h"

#include "Runtime/Utilities/Format.h"

namespace UnitTest
{

MemoryOutStream& MemoryOutStream::operator<<(const core::string& text)
{
    m_text += text;
    return *this;
}

MemoryOutStream& MemoryOutStream::operator<<(int number)
{
    return *this << Format("%i", number);
}

MemoryOutStream& MemoryOutStream::operator<<(long long number)
{
    return *this << Format("%lld", number);
}

MemoryOutStream& MemoryOutStream::operator<<(float number)
{
    return *this << Format("%ff", static_cast<double>(number));
}

MemoryOutStream& MemoryOutStream::operator<<(double number)
{
    return *this << Format("%f", number);
}

} // namespace UnitTest
