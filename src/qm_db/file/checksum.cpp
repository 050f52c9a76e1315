#include "qm_db/file/checksum.h"

#include <array>
#include <bit>
#include <cstring>

static_assert(std::endian::native == std::endian::little, "words are read as they lie in memory");

namespace {

constexpr std::uint64_t kFactor = 0xD6E8FEB86659FD93U; // odd, so that multiplying is one to one
constexpr std::size_t kWord = sizeof(std::uint64_t);
constexpr std::size_t kLanes = 4; // independent chains keep the multiplier busy

std::uint64_t Mix(std::uint64_t state, std::uint64_t word)
{
    state = (state ^ word) * kFactor;
    return state ^ (state >> 32);
}

std::uint64_t WordAt(const std::byte* from, std::size_t bytes = kWord)
{
    std::uint64_t word = 0; // the last word is filled up with zeros; the length tells them apart
    std::memcpy(&word, from, bytes);
    return word;
}

} // namespace

void CChecksum::AddWord(std::uint64_t word)
{
    m_state = Mix(m_state, word);
}

void CChecksum::AddBytes(std::span<const std::byte> bytes)
{
    AddWord(bytes.size());
    std::size_t at = 0;
    if (bytes.size() >= kLanes * kWord) {
        std::array<std::uint64_t, kLanes> lanes{1, 2, 3, 4};
        for (; at + kLanes * kWord <= bytes.size(); at += kLanes * kWord) {
            for (std::size_t i = 0; i < kLanes; ++i)
                lanes[i] = Mix(lanes[i], WordAt(bytes.data() + at + i * kWord));
        }
        for (const std::uint64_t lane : lanes)
            AddWord(lane);
    }
    for (; at + kWord <= bytes.size(); at += kWord)
        AddWord(WordAt(bytes.data() + at));
    if (at < bytes.size()) AddWord(WordAt(bytes.data() + at, bytes.size() - at));
}

std::uint64_t CChecksum::Value() const
{
    return Mix(Mix(m_state, 0), 0);
}
