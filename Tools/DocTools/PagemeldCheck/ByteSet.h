#pragma once

#include <algorithm>
#include <array>
#include <cstddef>
#include <string_view>

/// A set of bytes in which a look-up takes a few instructions: texts of whole modules are checked byte by
/// byte.
class ByteSet
{
public:
    constexpr explicit ByteSet(std::string_view bytes)
    {
        for (const char byte : bytes)
        {
            m_has[static_cast<unsigned char>(byte)] = true;
        }
    }

    /// Returns the set with all bytes from first to last as well.
    [[nodiscard]] constexpr ByteSet With(unsigned char first, unsigned char last) const
    {
        ByteSet result = *this;
        for (std::size_t byte = first; byte <= last; ++byte)
        {
            result.m_has[byte] = true;
        }
        return result;
    }

    [[nodiscard]] bool HasAnyOf(std::string_view text) const
    {
        return std::any_of(text.begin(), text.end(), [this](char c) { return Has(c); });
    }

    [[nodiscard]] bool HasAllOf(std::string_view text) const
    {
        return std::all_of(text.begin(), text.end(), [this](char c) { return Has(c); });
    }

private:
    [[nodiscard]] bool Has(char c) const { return m_has[static_cast<unsigned char>(c)]; }

    std::array<bool, 256> m_has = {};
};
