#pragma once

#include <tbb/parallel_for.h>

#include <algorithm>
#include <array>
#include <bit>
#include <cstddef>
#include <cstdint>
#include <span>
#include <utility>
#include <vector>

namespace quarn {

/// Finds for each of many items the first one that equals it, by several threads; what comes out
/// does not depend on how many. It looks first among items that follow each other, where the equal
/// ones of meshes mostly are, in tables that the processor's nearer caches hold; then among those
/// that are left, parted by their hashes.
/// @tparam Hash    called with an item's number: a hash of 32 bits
/// @tparam Equals  called with two items' numbers: whether they are equal
template <class Hash, class Equals> class EqualItems {
public:
    EqualItems(Hash hash, Equals equals) : m_hash(hash), m_equals(equals) {}

    /// @param firsts  receives for each item, of which there are as many, the number of the first
    ///   one that equals it: its own where there is none before
    void find(std::span<std::uint32_t> firsts) {
        m_firsts = firsts;
        m_left.resize((firsts.size() + BLOCK - 1) / BLOCK);
        tbb::parallel_for(std::size_t{0}, m_left.size(), [this](std::size_t b) { searchBlock(b); });
        if (m_left.size() < 2)
            return;
        partByHash();
        tbb::parallel_for(std::size_t{0}, PARTS, [this](std::size_t part) {
            search(std::span(m_parted).subspan(m_ends[part], m_ends[part + 1] - m_ends[part]),
                   [](const Entry&) {});
        });
        tbb::parallel_for(std::size_t{0}, m_left.size(), [this](std::size_t b) { resolve(b); });
    }

private:
    static constexpr std::size_t BLOCK = std::size_t{16} << 10;
    static constexpr std::size_t PARTS = 256;
    static constexpr std::uint32_t FREE = 0xFFFFFFFFU;

    struct Entry {
        std::uint32_t item = FREE;
        std::uint32_t hash = 0;
    };

    static std::size_t partOf(const Entry& entry) { return entry.hash >> 24U; }

    std::size_t endOf(std::size_t block) const {
        return std::min((block + 1) * BLOCK, m_firsts.size());
    }

    void searchBlock(std::size_t block) {
        std::vector<Entry> entries;
        entries.reserve(endOf(block) - block * BLOCK);
        for (std::size_t i = block * BLOCK; i < endOf(block); ++i) {
            const auto item = static_cast<std::uint32_t>(i);
            entries.push_back({item, m_hash(item)});
        }
        std::vector<Entry>& left = m_left[block];
        search(entries, [&left](const Entry& entry) { left.push_back(entry); });
    }

    /// @param isNew  called with each entry that equals none before it
    template <class IsNew> void search(std::span<const Entry> entries, IsNew isNew) {
        std::vector<Entry> slots(std::bit_ceil(2 * entries.size() + 1));
        const std::size_t mask = slots.size() - 1;
        for (const Entry& entry : entries) {
            std::size_t slot = entry.hash & mask;
            while (slots[slot].item != FREE &&
                   !(slots[slot].hash == entry.hash && m_equals(slots[slot].item, entry.item)))
                slot = (slot + 1) & mask;
            if (slots[slot].item == FREE) {
                slots[slot] = entry;
                isNew(entry);
            }
            m_firsts[entry.item] = slots[slot].item;
        }
    }

    /// Keeps the order of the items within each part.
    void partByHash() {
        using Counts = std::array<std::size_t, PARTS>;
        std::vector<Counts> places(m_left.size());
        tbb::parallel_for(std::size_t{0}, m_left.size(), [&](std::size_t block) {
            for (const Entry& entry : m_left[block])
                ++places[block][partOf(entry)];
        });
        std::size_t end = 0;
        for (std::size_t part = 0; part < PARTS; ++part) {
            m_ends[part] = end;
            for (Counts& of_block : places)
                end += std::exchange(of_block[part], end);
        }
        m_ends[PARTS] = end;
        m_parted.resize(end);
        tbb::parallel_for(std::size_t{0}, m_left.size(), [&](std::size_t block) {
            for (const Entry& entry : m_left[block])
                m_parted[places[block][partOf(entry)]++] = entry;
            m_left[block] = {};
        });
    }

    /// Leads from the first one of a block to the first one of all. The entries of the first ones
    /// of blocks are complete and stay as they are.
    void resolve(std::size_t block) {
        for (std::size_t i = block * BLOCK; i < endOf(block); ++i) {
            const std::uint32_t first = m_firsts[i];
            if (first != i && first / BLOCK == block)
                m_firsts[i] = m_firsts[first];
        }
    }

    Hash m_hash;
    Equals m_equals;
    std::span<std::uint32_t> m_firsts;
    std::vector<std::vector<Entry>> m_left; ///< of each block: those that equal none before
    std::vector<Entry> m_parted;            ///< all of them, by the parts of their hashes
    std::array<std::size_t, PARTS + 1> m_ends{};
};

} // namespace quarn
