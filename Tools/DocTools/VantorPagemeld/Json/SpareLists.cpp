#include "Tools/DocTools/VantorPagemeld/Json/SpareLists.h"

#include <new>

namespace
{

using rapidjson::SizeType;
using rapidjson::Value;

/// Returns how often number can be halved before nothing is left of it.
unsigned BitLength(std::size_t number)
{
    unsigned length = 0;
    for (; number != 0; number >>= 1)
    {
        ++length;
    }
    return length;
}

void AppendElements(Value& list, Value& input, SpareLists::Allocator& allocator)
{
    for (Value& element : input.GetArray())
    {
        list.PushBack(element, allocator);
    }
}

} // namespace

void SpareLists::MoveElements(Value& list, Value& input, Allocator& allocator)
{
    const std::size_t size = std::size_t{list.Size()} + input.Size();
    if (size > list.Capacity())
    {
        Value roomier = Take(size, allocator);
        AppendElements(roomier, list, allocator);
        list.Swap(roomier);
        Keep(roomier, allocator);
    }
    AppendElements(list, input, allocator);
    Keep(input, allocator);
}

Value SpareLists::Take(std::size_t capacity, Allocator& allocator)
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

void SpareLists::Keep(Value& list, Allocator& allocator)
{
    if (list.Capacity() == 0)
    {
        list.SetNull();
        return;
    }
    // A capacity of 2^n up to 2^(n+1) - 1 is enough for whoever needs 2^n.
    Value& first = m_spares[BitLength(list.Capacity()) - 1];
    list.Clear();
    list.PushBack(first, allocator);
    first = list;
}
