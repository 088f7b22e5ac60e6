#include "engine/display/PictureScratch.h"

#include <algorithm>

namespace quarn {

namespace {

constexpr std::size_t smallest_block = 256 * 1024;

/// After so many pictures memory goes that none of them needed.
constexpr int pictures_to_watch = 64;

} // namespace

void PictureScratch::reset() {
    m_most_taken = std::max(m_most_taken, m_taken);
    if (++m_pictures >= pictures_to_watch)
        letGoOfWhatNoneNeeds();
    const std::size_t wanted = m_taken + m_taken / 4;
    if (wanted > m_capacity)
        addBlock(wanted - m_capacity);
    m_block = 0;
    m_used = 0;
    m_taken = 0;
}

void PictureScratch::letGoOfWhatNoneNeeds() {
    if (m_capacity > 4 * m_most_taken + smallest_block) {
        m_blocks.clear();
        m_capacity = 0;
        addBlock(m_most_taken + m_most_taken / 4);
    }
    m_most_taken = 0;
    m_pictures = 0;
}

std::byte* PictureScratch::takeBytes(std::size_t bytes) {
    const std::size_t whole = (bytes + alignment - 1) / alignment * alignment;
    const std::lock_guard lock(m_mutex);
    while (m_block < m_blocks.size() && m_used + whole > m_blocks[m_block].bytes) {
        m_taken += m_blocks[m_block].bytes - m_used; // it stays free, but cannot be taken
        ++m_block;
        m_used = 0;
    }
    if (m_block == m_blocks.size())
        addBlock(std::max(whole, m_capacity / 4));
    std::byte* const taken = m_blocks[m_block].memory.get() + m_used;
    m_used += whole;
    m_taken += whole;
    return taken;
}

void PictureScratch::addBlock(std::size_t bytes) {
    const std::size_t size = std::max(bytes, smallest_block);
    m_blocks.push_back({std::make_unique_for_overwrite<std::byte[]>(size), size});
    m_capacity += size;
}

} // namespace quarn
