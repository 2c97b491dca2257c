#pragma once

#include <cstdint>
#include <string_view>

/// The 128 bits of a key: its first eight bytes and its last eight, as little-endian numbers.
struct SipKey
{
    std::uint64_t low;
    std::uint64_t high;
};

/// Returns the 64-bit hash of the bytes by SipHash-1-3 (Aumasson and Bernstein) under a key. Words are read
/// in the order of the machine: the value is the published one on little-endian machines.
std::uint64_t SipHash13(const SipKey& key, std::string_view bytes);

/// Returns SipHash13 under a key that is drawn at random once per process.
///
/// Input files can't be made so that their keys collide, which would turn look-ups into scans. The value
/// differs from run to run: no output may depend on it.
std::uint64_t KeyedHash(std::string_view bytes);
