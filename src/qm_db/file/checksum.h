// Fast 64-bit checksum against damage of stored data (not against intent).
#pragma once

#include <cstddef>
#include <cstdint>
#include <span>

/// Every step maps the state one to one, for a given word and for a given state: data that differ
/// in a single 8-byte word always differ in the sum, so a single flipped bit is always found.
/// State: order matters; equal calls in equal order give equal sums on every machine.
class CChecksum {
public:
    void AddWord(std::uint64_t word);
    /// The number of bytes counts too: "ab" + "c" differs from "a" + "bc".
    void AddBytes(std::span<const std::byte> bytes);
    std::uint64_t Value() const;

private:
    std::uint64_t m_state = 0x9E3779B97F4A7C15U;
};
