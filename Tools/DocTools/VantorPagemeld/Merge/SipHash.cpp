#include "Tools/DocTools/VantorPagemeld/Merge/SipHash.h"

#include <cstddef>
#include <cstring>
#include <random>

namespace
{

SipKey DrawKey()
{
    std::random_device device;
    const auto drawWord = [&device] { return static_cast<std::uint64_t>(device()) << 32 | device(); };
    return {drawWord(), drawWord()};
}

constexpr std::uint64_t RotateLeft(std::uint64_t value, int bits)
{
    return (value << bits) | (value >> (64 - bits));
}

class SipState
{
public:
    explicit SipState(const SipKey& key)
        : m_v0(key.low ^ 0x736f6d6570736575),
          m_v1(key.high ^ 0x646f72616e646f6d),
          m_v2(key.low ^ 0x6c7967656e657261),
          m_v3(key.high ^ 0x7465646279746573)
    {
    }

    void Absorb(std::uint64_t word)
    {
        m_v3 ^= word;
        Round();
        m_v0 ^= word;
    }

    std::uint64_t Finish()
    {
        m_v2 ^= 0xff;
        Round();
        Round();
        Round();
        return m_v0 ^ m_v1 ^ m_v2 ^ m_v3;
    }

private:
    void Round()
    {
        m_v0 += m_v1;
        m_v1 = RotateLeft(m_v1, 13) ^ m_v0;
        m_v0 = RotateLeft(m_v0, 32);
        m_v2 += m_v3;
        m_v3 = RotateLeft(m_v3, 16) ^ m_v2;
        m_v0 += m_v3;
        m_v3 = RotateLeft(m_v3, 21) ^ m_v0;
        m_v2 += m_v1;
        m_v1 = RotateLeft(m_v1, 17) ^ m_v2;
        m_v2 = RotateLeft(m_v2, 32);
    }

    std::uint64_t m_v0, m_v1, m_v2, m_v3;
};

} // namespace

std::uint64_t SipHash13(const SipKey& key, std::string_view bytes)
{
    SipState state(key);
    std::uint64_t word = 0;
    std::size_t position = 0;
    for (; bytes.size() - position >= sizeof word; position += sizeof word)
    {
        std::memcpy(&word, bytes.data() + position, sizeof word);
        state.Absorb(word);
    }
    // The last word: the bytes left over, and the length in the top byte.
    word = static_cast<std::uint64_t>(bytes.size()) << 56;
    for (int shift = 0; position < bytes.size(); ++position, shift += 8)
    {
        word |= static_cast<std::uint64_t>(static_cast<unsigned char>(bytes[position])) << shift;
    }
    state.Absorb(word);
    return state.Finish();
}

std::uint64_t KeyedHash(std::string_view bytes)
{
    static const SipKey key = DrawKey();
    return SipHash13(key, bytes);
}
