#pragma once

#include <algorithm>
#include <cstddef>
#include <memory>
#include <mutex>
#include <span>
#include <type_traits>
#include <vector>

namespace quarn {

/// Memory for what is needed only while a picture is drawn. It is all taken back at once and serves
/// the next picture, so that frames like each other ask the heap for nothing.
class PictureScratch {
public:
    /// Begins a picture: everything that was taken is taken back. Holds a quarter more than the
    /// last picture needed, and lets most go once pictures have needed far less for a while.
    void reset();

    /// Room for `count` values, which are not set; valid until the next reset. Any thread may call
    /// it while a picture is drawn.
    template <class T> std::span<T> take(std::size_t count) {
        static_assert(std::is_trivially_destructible_v<T> && alignof(T) <= alignment);
        return {reinterpret_cast<T*>(takeBytes(count * sizeof(T))), count};
    }
    /// The same, every byte of it 0.
    template <class T> std::span<T> takeZeroed(std::size_t count) {
        const std::span<T> taken = take<T>(count);
        std::fill(taken.begin(), taken.end(), T{});
        return taken;
    }

    /// Bytes that are held, whether they are in use or not.
    std::size_t capacity() const { return m_capacity; }

private:
    static constexpr std::size_t alignment = 16;

    struct Block {
        std::unique_ptr<std::byte[]> memory;
        std::size_t bytes = 0;
    };
    std::byte* takeBytes(std::size_t bytes);
    void addBlock(std::size_t bytes);
    void letGoOfWhatNoneNeeds();

    std::mutex m_mutex;
    std::vector<Block> m_blocks;
    std::size_t m_capacity = 0;
    std::size_t m_block = 0; ///< the one that is taken from
    std::size_t m_used = 0;  ///< bytes of it
    std::size_t m_taken = 0; ///< bytes of this picture
    std::size_t m_most_taken = 0;
    int m_pictures = 0; ///< since it was last looked what is needed
};

} // namespace quarn
