#include "host/clock/ZoneFile.h"

#include "ground/FileBytes.h"

#include <algorithm>
#include <array>
#include <optional>
#include <span>

namespace quarn {
namespace {

using Bytes = std::span<const std::uint8_t>;

constexpr std::size_t HEADER = 44;
constexpr std::size_t FIRST_COUNT = 20;
constexpr std::size_t LARGEST_FILE = 1U << 20U;

std::uint64_t bigEndian(Bytes bytes) {
    std::uint64_t number = 0;
    for (const std::uint8_t byte : bytes)
        number = number << 8U | byte;
    return number;
}

/// The header of one of the blocks that a file consists of.
struct Block {
    std::uint64_t changes;
    std::uint64_t size; ///< of header and lists
};

/// @param time_bytes  of a time: 4 in the first block, 8 in the second
std::optional<Block> readBlock(Bytes bytes, std::uint64_t time_bytes) {
    constexpr std::array<std::uint8_t, 4> MAGIC = {'T', 'Z', 'i', 'f'};
    if (bytes.size() < HEADER || !std::ranges::equal(bytes.first(4), MAGIC))
        return std::nullopt;
    const auto count = [&](std::size_t index) {
        return bigEndian(bytes.subspan(FIRST_COUNT + 4 * index, 4));
    };
    const std::uint64_t changes = count(3);
    const std::uint64_t lists = count(0) + count(1) + count(2) * (time_bytes + 4) +
                                changes * (time_bytes + 1) + count(4) * 6 + count(5);
    if (lists > bytes.size() - HEADER)
        return std::nullopt;
    return Block{changes, HEADER + lists};
}

std::optional<ZoneFileEnd> endOf(Bytes bytes) {
    const auto old = readBlock(bytes, 4);
    if (!old || bytes[4] < '2')
        return std::nullopt;
    bytes = bytes.subspan(old->size);
    const auto block = readBlock(bytes, 8);
    if (!block)
        return std::nullopt;
    ZoneFileEnd end{std::chrono::sys_seconds::min(), {}};
    if (block->changes > 0) {
        const Bytes last = bytes.subspan(HEADER + 8 * (block->changes - 1), 8);
        end.last_change = std::chrono::sys_seconds(
            std::chrono::seconds(static_cast<std::int64_t>(bigEndian(last))));
    }
    const Bytes footer = bytes.subspan(block->size);
    if (footer.size() < 2 || footer.front() != '\n' || footer.back() != '\n')
        return std::nullopt;
    end.rule.assign(footer.begin() + 1, footer.end() - 1);
    return end;
}

} // namespace

Result<ZoneFileEnd> readZoneFileEnd(const std::filesystem::path& file) {
    const auto read = readFileBytes(file, LARGEST_FILE);
    if (!read)
        return Error{"The time zone file " + file.native() + " cannot be read: " + read.message() +
                     ". Install Debian's package tzdata again."};
    if (auto end = endOf(read.value().bytes()))
        return *end;
    return Error{"The time zone file " + file.native() +
                 " is damaged. Install Debian's package tzdata again."};
}

} // namespace quarn
