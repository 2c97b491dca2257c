#include "Tools/DocTools/VantorPagemeld/Merge/PositionTable.h"

#include <utility>

void PositionTable::Add(Hash hash)
{
    if (hash)
    {
        if (2 * m_taken >= m_slots.size())
        {
            Grow();
        }
        Place({static_cast<std::uint32_t>(*hash), m_size});
        ++m_taken;
    }
    ++m_size;
}

void PositionTable::Grow()
{
    constexpr std::size_t kFirstSize = 16;
    const std::vector<Slot> old = std::exchange(m_slots, {});
    m_slots.resize(old.empty() ? kFirstSize : 2 * old.size(), Slot{0, kNotFound});
    for (const Slot& slot : old)
    {
        if (slot.position != kNotFound)
        {
            Place(slot);
        }
    }
}

void PositionTable::Place(Slot slot)
{
    std::size_t i = slot.hash & Mask();
    while (m_slots[i].position != kNotFound)
    {
        i = (i + 1) & Mask();
    }
    m_slots[i] = slot;
}
