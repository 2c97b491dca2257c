#include "Tools/DocTools/VantorPagemeld/Render/ModulePrefix.h"

#include <gtest/gtest.h>

TEST(RelativePrefix, ClimbsToTheCommonDirectory)
{
    const struct
    {
        const char* from;
        const char* to;
        const char* expected;
    } cases[] = {
        {"a/b/Manual", "a/c/Manual/", "../../c/Manual/"},
        {"a/b/Manual", "a/b/Manual/", ""},
        {"/r/m1/Manual", "/r/m12/Manual/", "../../m12/Manual/"},
        {"/r/m12/Manual", "/r/m1/Manual/", "../Manual/"},      // stops at the other's slash, on purpose
        {"docs1/Manual", "docs2/Manual/", "../docs2/Manual/"}, // no common directory: one short, on purpose
        {"/docs/a//Manual", "/docs/b//Manual/", "../../../b//Manual/"}, // every slash counts
        {"/r/a//Manual", "/r/a///Manual/", "Manual/"}, // all slashes after the split are passed
        {"/r/a/Manual", "", "../../../"},
        {"", "x/Manual/", "x/Manual/"},
        {"/r/a\"b\\/Manual", "/r/c\"d\\/Manual/", "../../c\"d\\/Manual/"},
    };
    for (const auto& c : cases)
    {
        EXPECT_EQ(c.expected, RelativePrefix(c.from, c.to)) << "from " << c.from << " to " << c.to;
    }
}
