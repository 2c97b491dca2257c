#include "Runtime/Testing/TestReporter.h"

namespace UnitTest
{

core::string TestProperty::AsString() const
{
    MemoryOutStream stream;
    std::visit([&stream](const auto& value) { stream << value; }, m_value);
    return stream.GetText();
}

} // namespace UnitTest
