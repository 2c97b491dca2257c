#pragma once

#include <cstdint>
#include <string_view>

/// Returns a 64-bit hash of the bytes: SipHash-1-3 (Aumasson and Bernstein) under a key that is drawn at
/// random once per process.
///
/// Input files can't be made so that their keys collide, which would turn look-ups into scans. The value
/// differs from run to run: no output may depend on it.
std::uint64_t KeyedHash(std::string_view bytes);
