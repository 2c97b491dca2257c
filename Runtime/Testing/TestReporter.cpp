#include "Runtime/Testing/TestReporter.h"

#include "Runtime/Utilities/TextConversion.h"

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

MemoryOutStream& MemoryOutStream::operator<<(long number)
{
    return *this << static_cast<long long>(number);
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

core::string TestProperty::AsString() const
{
    MemoryOutStream stream;
    std::visit([&stream](const auto& value) { stream << value; }, m_value);
    return stream.GetText();
}

} // namespace UnitTest
