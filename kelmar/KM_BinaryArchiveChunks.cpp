#include "kelmar/KM_BinaryArchive.h"
#include "kelmar/KM_Crc32.h"
#include "kelmar/KM_LittleEndian.h"

#include <algorithm>
#include <exception>

namespace {

constexpr std::uint64_t id_size = 4;
constexpr std::uint64_t length_size = 8;
constexpr std::uint64_t crc_size = 4;
constexpr std::uint64_t header_size = id_size + length_size + crc_size;

// What the check sequence covers besides the payload: without the id, a damaged id would pass for
// a chunk that nobody knows.
std::uint32_t crcOf(std::span<const std::uint8_t> header, std::span<const std::uint8_t> payload) {
    return KM_Crc32(payload, KM_Crc32(header.first(id_size + length_size)));
}

} // namespace

bool KM_BinaryArchive::BeginWriteChunk(std::uint32_t id) {
    constexpr std::uint8_t to_be_patched[length_size + crc_size] = {};
    if (!WriteBytes(kelmar::toLittleEndian(id)) || !WriteBytes(to_be_patched))
        return false;
    try {
        m_chunks.push_back({m_written.size(), 0});
        return true;
    } catch (const std::exception&) {
        return Fail();
    }
}

bool KM_BinaryArchive::EndWriteChunk() {
    if (!m_is_writing || m_has_failed || m_chunks.empty())
        return Fail();
    const std::uint64_t begin = m_chunks.back().begin;
    m_chunks.pop_back();
    const std::span<std::uint8_t> header = std::span(m_written).subspan(begin - header_size);
    const std::span<std::uint8_t> payload = header.subspan(header_size);
    const std::uint64_t length = payload.size();
    std::ranges::copy(kelmar::toLittleEndian(length), header.begin() + id_size);
    std::ranges::copy(kelmar::toLittleEndian(crcOf(header, payload)),
                      header.begin() + id_size + length_size);
    return true;
}

bool KM_BinaryArchive::BeginReadChunk(std::uint32_t& id, std::uint64_t& length) {
    std::span<const std::uint8_t> header;
    if (!ViewBytes(header_size, header))
        return false;
    const auto payload_size = kelmar::fromLittleEndian<std::uint64_t>(header.data() + id_size);
    if (payload_size > BytesLeft())
        return Fail();
    const auto crc = kelmar::fromLittleEndian<std::uint32_t>(header.data() + id_size + length_size);
    if (crc != crcOf(header, m_source.subspan(m_position, payload_size)))
        return Fail();
    try {
        m_chunks.push_back({m_position, m_position + payload_size});
    } catch (const std::exception&) {
        return Fail();
    }
    id = kelmar::fromLittleEndian<std::uint32_t>(header.data());
    length = payload_size;
    return true;
}

bool KM_BinaryArchive::EndReadChunk() {
    if (m_is_writing || m_has_failed || m_chunks.empty())
        return Fail();
    m_position = m_chunks.back().end;
    m_chunks.pop_back();
    return true;
}

bool KM_BinaryArchive::Write3dmChunkVersion(int major, int minor) {
    if (major < 0 || minor < 0)
        return Fail();
    return WriteInt(major) && WriteInt(minor);
}

bool KM_BinaryArchive::Read3dmChunkVersion(int& major, int& minor) {
    KM_ChunkVersion version;
    if (!ReadInt(version.Major) || !ReadInt(version.Minor))
        return false;
    if (version.Major < 0 || version.Minor < 0)
        return Fail();
    m_chunk_version = version;
    major = version.Major;
    minor = version.Minor;
    return true;
}
