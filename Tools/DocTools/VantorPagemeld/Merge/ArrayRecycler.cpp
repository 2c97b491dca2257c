#include "Tools/DocTools/VantorPagemeld/Merge/ArrayRecycler.h"

#include <new>

// The memory pools of the JSON library never free. A list that a hundred modules add to would grow by
// doubling, and the pool would keep every outgrown copy: several times what the list holds in the end. There
// are as many such lists as there are terms.
//
// So an array that is outgrown or emptied is kept, by the power of two that its capacity reaches, and the
// next list that needs that much room takes it over. No memory is needed to keep it: its first element is the
// array that was kept before it.

namespace
{

using rapidjson::SizeType;
using rapidjson::Value;

/// Returns the number of binary digits: 0 for 0, 1 for 1, 2 for 2 and 3.
unsigned BitLength(std::size_t number)
{
    return number == 0 ? 0 : 1 + BitLength(number / 2);
}

void AppendElements(Value& list, Value& input, ArrayRecycler::Allocator& allocator)
{
    for (Value& element : input.GetArray())
    {
        list.PushBack(element, allocator);
    }
}

} // namespace

void ArrayRecycler::MoveElements(Value& list, Value& input, Allocator& allocator)
{
    const std::size_t size = std::size_t{list.Size()} + input.Size();
    if (size > list.Capacity())
    {
        Value larger = Take(size, allocator);
        AppendElements(larger, list, allocator);
        list.Swap(larger);
        Keep(larger, allocator);
    }
    AppendElements(list, input, allocator);
    Keep(input, allocator);
}

Value ArrayRecycler::Take(std::size_t capacity, Allocator& allocator)
{
    // The largest power of two that a list can count.
    constexpr std::size_t kMaxCapacity = std::size_t{1} << 31;
    if (capacity > kMaxCapacity)
    {
        throw std::bad_alloc();
    }
    const unsigned length = BitLength(capacity - 1);
    Value& first = m_spares[length];
    Value list(rapidjson::kArrayType);
    if (first.IsNull())
    {
        list.Reserve(SizeType{1} << length, allocator);
        return list;
    }
    list = first;
    first = list[0];
    list.Clear();
    return list;
}

void ArrayRecycler::Keep(Value& list, Allocator& allocator)
{
    if (list.Capacity() == 0)
    {
        list.SetNull();
        return;
    }
    // A capacity of 2^n up to 2^(n+1) - 1 is enough for a list that needs 2^n.
    Value& first = m_spares[BitLength(list.Capacity()) - 1];
    list.Clear();
    list.PushBack(first, allocator);
    first = list;
}
