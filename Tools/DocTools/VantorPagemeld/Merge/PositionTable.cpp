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
    const std::vector<Slot> old = std::exchange(m_slots, std::vector<Slot>(2 * m_slots.size()));
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
