#pragma once

#include "Runtime/Core/Containers/String.h"

#include <cstdint>

/// The status lines that a program which runs the tests reads: "##qzm:" and a compact JSON object, without a
/// line break. They show the time of the call and the process id. No text may be null.
namespace Testing
{

constexpr unsigned int kProtocolVersion = 2;
constexpr const char* kPhaseBegin = "Begin";
constexpr const char* kPhaseEnd = "End";

enum class TestState : std::uint32_t
{
    NoResult = 0,
    Passed = 4,
    Failed = 5
};

/// Returns the line for a test that begins. (The spelling of both functions is kept.)
core::string TestStatusBeginMesssageToQZMString(const char* name);

/// Returns the line for a test that ended, with its failure text, which may be empty, and the place where it
/// is defined.
core::string TestStatusEndMesssageToQZMString(const char* name, TestState state,
                                              unsigned long long durationMicroseconds, const char* message,
                                              const char* fileName, int lineNumber);

} // namespace Testing
