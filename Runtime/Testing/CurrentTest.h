#pragma once

#include "Runtime/Testing/TestDetails.h"

namespace UnitTest
{

class TestResults;

/// The way from a test body, which has no arguments, to its surroundings. Both pointers are good while a
/// body runs, and not to be followed at any other time.
namespace CurrentTest
{

TestResults*& Results();
const TestDetails*& Details();

} // namespace CurrentTest

} // namespace UnitTest
