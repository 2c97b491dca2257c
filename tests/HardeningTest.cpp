#include "tests/support/HasMatch.h"
#include "tests/support/RunProgram.h"

#include <gtest/gtest.h>

TEST(Hardening, IsInTheProgram)
{
#ifndef PAGEMELD_HARDENED
    GTEST_SKIP() << "the release build is hardened";
#endif
    const struct
    {
        const char* protection;
        const char* pattern; ///< of what readelf shows
    } cases[] = {
        {"position-independent", "Type: +DYN "},
        {"relocations read-only", "GNU_RELRO "},
        {"and bound at start", "FLAGS_1\\) +Flags: NOW"},
        {"stack not executable", "GNU_STACK [ 0-9xa-f]+RW "},
        {"stack protector", "__stack_chk_fail@"},
        {"fortified sources", "__[a-z]*printf_chk@"},
#ifdef __x86_64__
        {"control flow", "endbr64"},
#endif
    };
    const std::string program = PAGEMELD_PROGRAM;
    const std::string shown =
        RunProgram("readelf", {"-W", "--file-header", "--segments", "--dynamic", "--symbols", program})
            .standardOutput +
        RunProgram("objdump", {"--disassemble=main", program}).standardOutput;
    for (const auto& c : cases)
    {
        EXPECT_TRUE(HasMatch(shown, c.pattern)) << c.protection;
    }
}
