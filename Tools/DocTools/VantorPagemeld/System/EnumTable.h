#pragma once

#include <cstddef>

// What has an identity is an enumerator with one row in one table. The enum ends in Count; a row begins with
// its enumerator, id.

/// Whether the table has one row for each enumerator, in their order.
template <typename Row, std::size_t size>
constexpr bool HasRowOfEach(const Row (&rows)[size])
{
    using Enum = decltype(Row::id);
    for (std::size_t i = 0; i < size; ++i)
    {
        if (rows[i].id != static_cast<Enum>(i))
        {
            return false;
        }
    }
    return size == static_cast<std::size_t>(Enum::Count);
}

/// Returns the row of an enumerator.
template <typename Row, std::size_t size>
constexpr const Row& RowOf(const Row (&rows)[size], decltype(Row::id) id)
{
    return rows[static_cast<std::size_t>(id)];
}
