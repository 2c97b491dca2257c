#include "Tools/DocTools/VantorPagemeld/Merge/SipHash.h"

#include <gtest/gtest.h>

#include <numeric>
#include <string>

/// The expected values come from an independent implementation in another language, which gives the published
/// example of SipHash-2-4 with two and four rounds.
TEST(SipHash, ReturnsTheReferenceValues)
{
    const struct
    {
        std::size_t length; ///< of the message, whose bytes are 0, 1, 2, ...
        std::uint64_t hash;
    } cases[] = {
        {0, 0xabac0158050fc4dc}, {1, 0xc9f49bf37d57ca93},  {7, 0xd3927d989bb11140},  {8, 0x369095118d299a8e},
        {9, 0x25a48eb36c063de4}, {15, 0xd320d86d2a519956}, {16, 0xcc4fdd1a7d908b66}, {63, 0x9d199062b7bbb3a8},
    };
    const SipKey key = {0x0706050403020100, 0x0f0e0d0c0b0a0908};
    for (const auto& c : cases)
    {
        std::string message(c.length, '\0');
        std::iota(message.begin(), message.end(), '\0');
        EXPECT_EQ(c.hash, SipHash13(key, message)) << c.length << " bytes";
    }
    EXPECT_EQ(0xf30eb725bb91c9eaU,
              SipHash13({0, 0}, std::string("\0\1\2\3\4\5\6\7\10\11\12\13\14\15\16", 15)));
    EXPECT_EQ(KeyedHash("term"), KeyedHash("term"));
    EXPECT_NE(SipHash13({0, 0}, "term"), KeyedHash("term")) << "the key is random";
}
