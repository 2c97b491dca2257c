#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <vector>

/// Finds the position of a key in a list that is kept elsewhere and grows at its end, in expected constant
/// time. Like a linear search, it finds the first position of a key.
///
/// An open-addressing table with linear probing that holds 32 bits of each hash and the position: eight bytes
/// a slot, at least half of the slots free. Only the owner of the list knows the keys, and compares them. An
/// element without a hash is never found.
class PositionTable
{
public:
    using Hash = std::optional<std::uint64_t>;

    static constexpr std::uint32_t kNotFound = UINT32_MAX;

    /// Returns the position of the key with that hash for which `isEqual(position)`, or kNotFound.
    template <class IsEqual>
    [[nodiscard]] std::uint32_t Find(Hash hash, IsEqual isEqual) const
    {
        if (!hash)
        {
            return kNotFound;
        }
        const auto shortHash = static_cast<std::uint32_t>(*hash);
        for (std::size_t i = shortHash & Mask(); m_slots[i].position != kNotFound; i = (i + 1) & Mask())
        {
            if (m_slots[i].hash == shortHash && isEqual(m_slots[i].position))
            {
                return m_slots[i].position;
            }
        }
        return kNotFound;
    }

    /// Loads the slot of a hash while the caller does other work, such as this for the next ones. A large
    /// table is not in the caches.
    void Prefetch(std::uint64_t hash) const { __builtin_prefetch(&m_slots[hash & Mask()]); }

    /// Adds the next position, whose key Find does not find yet.
    void Add(Hash hash);

    /// Adds the positions that are missing below size, whoever appended them to the list. If the list has
    /// become shorter, starts anew. Takes `hashAt(position)` and `areEqual(position, position)`.
    template <class HashAt, class AreEqual>
    void CatchUp(std::uint32_t size, HashAt hashAt, AreEqual areEqual)
    {
        if (size < m_size)
        {
            *this = PositionTable();
        }
        while (m_size < size)
        {
            const Hash hash = hashAt(m_size);
            const std::uint32_t same = Find(hash, [&](std::uint32_t i) { return areEqual(i, m_size); });
            Add(same == kNotFound ? hash : std::nullopt);
        }
    }

private:
    struct Slot
    {
        std::uint32_t hash = 0;
        std::uint32_t position = kNotFound;
    };

    [[nodiscard]] std::size_t Mask() const { return m_slots.size() - 1; }
    void Grow();
    void Place(Slot slot);

    std::vector<Slot> m_slots = std::vector<Slot>(16); // a power of two; at most half of them are taken
    std::size_t m_taken = 0;
    std::uint32_t m_size = 0;
};
