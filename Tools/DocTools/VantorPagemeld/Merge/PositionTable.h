#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

/// Finds the position of a key in a list that is kept elsewhere, in expected constant time.
///
/// An open-addressing table with linear probing that holds 32 bits of each hash and the position: eight bytes
/// a slot, at least half of the slots free. Only the owner of the list knows the keys: its
/// `isEqual(position)` returns whether the key looked for is the one at that position.
class PositionTable
{
public:
    static constexpr std::uint32_t kNotFound = UINT32_MAX;

    /// Returns the position of the key with that hash, or kNotFound.
    template <class IsEqual>
    [[nodiscard]] std::uint32_t Find(std::uint64_t hash, IsEqual isEqual) const
    {
        if (m_slots.empty())
        {
            return kNotFound;
        }
        const auto shortHash = static_cast<std::uint32_t>(hash);
        for (std::size_t i = shortHash & Mask(); m_slots[i].position != kNotFound; i = (i + 1) & Mask())
        {
            if (m_slots[i].hash == shortHash && isEqual(m_slots[i].position))
            {
                return m_slots[i].position;
            }
        }
        return kNotFound;
    }

    /// Adds a key that Find does not find yet. position is below kNotFound.
    void Add(std::uint64_t hash, std::uint32_t position);

private:
    struct Slot
    {
        std::uint32_t hash;
        std::uint32_t position;
    };

    [[nodiscard]] std::size_t Mask() const { return m_slots.size() - 1; }
    void Grow();
    void Place(Slot slot);

    std::vector<Slot> m_slots; // a power of two or none; at most half of them are taken
    std::size_t m_taken = 0;
};
