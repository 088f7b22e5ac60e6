#include "ground/Checksum.h"

#include <array>
#include <cerrno>
#include <charconv>
#include <cstdio>
#include <cstring>
#include <new>
#include <vector>
#include <xxhash.h>

namespace quarn {

namespace {

constexpr std::size_t PIECE_BYTES = 1 << 18;

struct Closing {
    void operator()(std::FILE* file) const { std::fclose(file); }
};

} // namespace

Checksum::Checksum() : m_state(XXH64_createState()) {
    if (!m_state)
        throw std::bad_alloc();
    XXH64_reset(m_state, 0);
}

Checksum::~Checksum() {
    XXH64_freeState(m_state);
}

void Checksum::addBytes(std::span<const std::byte> bytes) {
    if (!bytes.empty())
        XXH64_update(m_state, bytes.data(), bytes.size());
}

void Checksum::addText(const std::string& text) {
    add(std::uint64_t{text.size()});
    addBytes(std::as_bytes(std::span(text)));
}

std::uint64_t Checksum::value() const {
    return XXH64_digest(m_state);
}

Result<FileChecksum> checksumOfFile(const std::filesystem::path& file) {
    const std::unique_ptr<std::FILE, Closing> opened(std::fopen(file.c_str(), "rb"));
    if (!opened)
        return Error{std::strerror(errno)};
    FileChecksum checksum;
    Checksum sum;
    std::vector<std::byte> piece(PIECE_BYTES);
    while (const std::size_t read = std::fread(piece.data(), 1, piece.size(), opened.get())) {
        sum.addBytes(std::span(piece).first(read));
        checksum.bytes += read;
    }
    if (std::ferror(opened.get()))
        return Error{std::strerror(errno)};
    checksum.xxh64 = sum.value();
    return checksum;
}

std::string checksumText(std::uint64_t xxh64) {
    std::array<char, 16> digits{};
    const auto end = std::to_chars(digits.data(), digits.data() + digits.size(), xxh64, 16).ptr;
    const std::string text(digits.data(), end);
    return std::string(digits.size() - text.size(), '0') + text;
}

} // namespace quarn
