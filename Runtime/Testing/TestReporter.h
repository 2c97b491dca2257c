#pragma once

#include "Runtime/Testing/TestDetails.h"
#include "Runtime/Utilities/TextConversion.h"

#include <variant>

namespace UnitTest
{

/// Assembles a text from texts and numbers.
class MemoryOutStream
{
public:
    /// The text starts with room for capacity bytes, and may outgrow it.
    explicit MemoryOutStream(int capacity = 256) { m_text.reserve(static_cast<std::size_t>(capacity)); }

    MemoryOutStream& operator<<(const core::string& text)
    {
        m_text += text;
        return *this;
    }

    MemoryOutStream& operator<<(int number) { return *this << Format("%i", number); }
    MemoryOutStream& operator<<(long number) { return *this << static_cast<long long>(number); }
    MemoryOutStream& operator<<(long long number) { return *this << Format("%lld", number); }

    /// Writes an "f" after the digits, on purpose: 1.5 shows as 1.500000f.
    MemoryOutStream& operator<<(float number) { return *this << Format("%ff", static_cast<double>(number)); }

    MemoryOutStream& operator<<(double number) { return *this << Format("%f", number); }

    /// Returns what was written; valid until the next write.
    [[nodiscard]] const char* GetText() const { return m_text.c_str(); }

private:
    core::string m_text;
};

/// A value that a test attaches to itself by name.
class TestProperty
{
public:
    /// The order gives each type its code, from 0 for int to 4 for a text.
    using Value = std::variant<int, long long, float, double, core::string>;

    explicit TestProperty(Value value) : m_value(std::move(value)) {}

    [[nodiscard]] int GetType() const { return static_cast<int>(m_value.index()); }

    /// Returns the value as the console shows it: numbers as MemoryOutStream writes them, a text as it is.
    [[nodiscard]] core::string AsString() const
    {
        MemoryOutStream stream;
        std::visit([&stream](const auto& value) { stream << value; }, m_value);
        return stream.GetText();
    }

private:
    Value m_value;
};

/// Receives the events of a run. Per test: one start, any number of failures and properties, one finish; at
/// the end of the run one summary.
class TestReporter
{
public:
    TestReporter() = default;
    virtual ~TestReporter() = default;

    TestReporter(const TestReporter&) = delete;
    TestReporter& operator=(const TestReporter&) = delete;

    virtual void ReportTestStart(const TestDetails& details) = 0;

    /// The details are those of the running test, except for the line, which is that of the failing check.
    virtual void ReportFailure(const TestDetails& details, const char* message) = 0;

    virtual void ReportTestFinish(const TestDetails& details, float seconds) = 0;
    virtual void ReportTestProperty(const TestDetails& details, const char* name,
                                    const TestProperty& property) = 0;

    /// The seconds are those of the whole run.
    virtual void ReportSummary(int totalTests, int failedTests, int failures, float seconds) = 0;
};

} // namespace UnitTest
