#pragma once

#include "Runtime/Core/Containers/String.h"

#include <variant>

namespace UnitTest
{

/// A value that a test attaches to itself by name.
class TestProperty
{
public:
    /// The order gives each type its code: 0 for int to 4 for a text.
    using Value = std::variant<int, long long, float, double, core::string>;

    explicit TestProperty(Value value) : m_value(std::move(value)) {}

    [[nodiscard]] int GetType() const { return static_cast<int>(m_value.index()); }

    /// Returns the value as the console shows it: numbers as MemoryOutStream writes them, a text as it is.
    [[nodiscard]] core::string AsString() const;

private:
    Value m_value;
};

} // namespace UnitTest
