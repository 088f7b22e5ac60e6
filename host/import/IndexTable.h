#pragma once

#include <cstddef>
#include <cstdint>
#include <cstring>
#include <span>
#include <vector>

namespace quarn {

/// A hash table from values, which its user keeps in arrays, to their indices there. It stores the
/// indices alone, so that a million vertices take four to eight megabytes.
class IndexTable {
public:
    static constexpr std::uint32_t none = 0xFFFFFFFFU;

    IndexTable() : m_slots(1024, none), m_hashes(1024, 0) {}

    /// @param hash    of the value that is looked for
    /// @param equals  called with an index: whether the value there is the one looked for
    /// @param next    the index to keep for the value when it is new
    /// @return the index of the value; `next` when it is new
    template <class Equals>
    std::uint32_t findOrAdd(std::uint32_t hash, std::uint32_t next, Equals equals) {
        if (2 * m_count >= m_slots.size()) {
            grow();
        }
        std::size_t slot = hash & (m_slots.size() - 1);
        while (m_slots[slot] != none) {
            if (m_hashes[slot] == hash && equals(m_slots[slot])) {
                return m_slots[slot];
            }
            slot = (slot + 1) & (m_slots.size() - 1);
        }
        place(slot, hash, next);
        return next;
    }

private:
    void place(std::size_t slot, std::uint32_t hash, std::uint32_t index) {
        m_slots[slot] = index;
        m_hashes[slot] = hash;
        ++m_count;
    }

    void grow() {
        std::vector<std::uint32_t> slots(2 * m_slots.size(), none);
        std::vector<std::uint32_t> hashes(slots.size(), 0);
        slots.swap(m_slots);
        hashes.swap(m_hashes);
        m_count = 0;
        for (std::size_t i = 0; i < slots.size(); ++i) {
            if (slots[i] == none) {
                continue;
            }
            std::size_t slot = hashes[i] & (m_slots.size() - 1);
            while (m_slots[slot] != none) {
                slot = (slot + 1) & (m_slots.size() - 1);
            }
            place(slot, hashes[i], slots[i]);
        }
    }

    std::vector<std::uint32_t> m_slots;
    std::vector<std::uint32_t> m_hashes;
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
