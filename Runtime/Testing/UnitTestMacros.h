#pragma once

#include "Runtime/Testing/TestList.h"

/// Defines a test of the category "Unit"; its body follows in braces. It runs only if a REGISTER_UNIT_TEST
/// registers it. The test is reported with the file and line given here, so they stay the same when the code
/// moves.
#define UNIT_TEST(suite, name, file, line)                                                                   \
    namespace Suite##suite##kUnitTestCategory                                                                \
    {                                                                                                        \
        class Test##name : public UnitTest::Test                                                             \
        {                                                                                                    \
        public:                                                                                              \
            using Test::Test;                                                                                \
            void RunImpl() const override;                                                                   \
        };                                                                                                   \
        UnitTest::Test* CreateTest##name(void* /*argument*/)                                                 \
        {                                                                                                    \
            return new Test##name(                                                                           \
                UnitTest::TestDetails(#name, #suite, Testing::kUnitTestCategory, file, line));               \
        }                                                                                                    \
    }                                                                                                        \
    void Suite##suite##kUnitTestCategory::Test##name::RunImpl() const

/// Registers a test that UNIT_TEST defines in some file. All registrations of a program belong in one file:
/// their order is that of the run, and across files the linker would choose it.
#define REGISTER_UNIT_TEST(suite, name)                                                                      \
    namespace Suite##suite##kUnitTestCategory                                                                \
    {                                                                                                        \
        UnitTest::Test* CreateTest##name(void* argument);                                                    \
        static UnitTest::TestFactory factoryOf##name(CreateTest##name);                                      \
        static const UnitTest::ListAdder adderOf##name(UnitTest::Test::GetTestList(), &factoryOf##name);     \
    }
