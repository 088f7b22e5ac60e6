#pragma once

#include <algorithm>
#include <array>
#include <bit>
#include <cstddef>
#include <cstdint>
#include <cstring>
#include <span>
#include <vector>

namespace quarn {

/// A hash table from values, which its user keeps in arrays, to their indices there. It stores the
/// indices and hashes alone, so that a million vertices take sixteen to thirty-two megabytes.
class IndexTable {
public:
    static constexpr std::uint32_t none = 0xFFFFFFFFU;

    /// @param expected  how many values will come, as far as that is known
    explicit IndexTable(std::size_t expected = 0)
        : m_slots(std::bit_ceil(std::max(least_slots, 2 * expected))) {}

    /// @param hash    of the value that is looked for
    /// @param equals  called with an index: whether the value there is the one looked for
    /// @param next    the index to keep for the value when it is new
    /// @return the index of the value; `next` when it is new
    template <class Equals>
    std::uint32_t findOrAdd(std::uint32_t hash, std::uint32_t next, Equals equals) {
        Slot& recent = m_recent[hash % m_recent.size()];
        if (recent.hash != hash || recent.index == none || !equals(recent.index)) {
            recent = {findOrAddInTable(hash, next, equals), hash};
        }
        return recent.index;
    }

private:
    static constexpr std::size_t least_slots = 1024;

    /// Both numbers side by side, so that a look-up touches one line of the processor's cache.
    struct Slot {
        std::uint32_t index = none;
        std::uint32_t hash = 0;
    };

    template <class Equals>
    std::uint32_t findOrAddInTable(std::uint32_t hash, std::uint32_t next, Equals& equals) {
        if (2 * m_count >= m_slots.size()) {
            grow();
        }
        std::size_t slot = hash & (m_slots.size() - 1);
        while (m_slots[slot].index != none) {
            if (m_slots[slot].hash == hash && equals(m_slots[slot].index)) {
                return m_slots[slot].index;
            }
            slot = (slot + 1) & (m_slots.size() - 1);
        }
        m_slots[slot] = {next, hash};
        ++m_count;
        return next;
    }

    void grow() {
        std::vector<Slot> slots(2 * m_slots.size());
        slots.swap(m_slots);
        for (const Slot& old : slots) {
            if (old.index == none) {
                continue;
            }
            std::size_t slot = old.hash & (m_slots.size() - 1);
            while (m_slots[slot].index != none) {
                slot = (slot + 1) & (m_slots.size() - 1);
            }
            m_slots[slot] = old;
        }
    }

    std::vector<Slot> m_slots;
    /// What was found last; neighbours in a mesh ask for the same vertices, and this part stays in
    /// the processor's nearest cache.
    std::array<Slot, 1024> m_recent;
    std::size_t m_count = 0;
};

/// A hash of the bits of some numbers; equal numbers must have equal bits (no negative zero).
inline std::uint32_t hashOfBits(std::span<const float> numbers) {
    std::uint64_t hash = 0x9E3779B97F4A7C15ULL;
    for (const float number : numbers) {
        std::uint32_t bits = 0;
        std::memcpy(&bits, &number, sizeof bits);
        hash = (hash ^ bits) * 0xFF51AFD7ED558CCDULL;
        hash ^= hash >> 32;
    }
    return static_cast<std::uint32_t>(hash);
}

} // namespace quarn
