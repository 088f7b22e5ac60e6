#include "kelmar/KM_BinaryArchive.h"

#include "kelmar/KM_LittleEndian.h"

#include <algorithm>
#include <bit>
#include <cstring>
#include <exception>
#include <utility>

using kelmar::BitsOf;
using kelmar::fromLittleEndian;
using kelmar::toLittleEndian;

KM_BinaryArchive KM_BinaryArchive::ForWriting(int archive_version, std::uint64_t size_limit) {
    KM_BinaryArchive archive;
    archive.m_archive_version = archive_version;
    archive.m_is_writing = true;
    archive.m_size_limit = size_limit;
    return archive;
}

KM_BinaryArchive KM_BinaryArchive::ForReading(std::span<const std::uint8_t> bytes,
                                              int archive_version) {
    KM_BinaryArchive archive;
    archive.m_archive_version = archive_version;
    archive.m_source = bytes;
    return archive;
}

bool KM_BinaryArchive::Fail() {
    m_has_failed = true;
    return false;
}

std::vector<std::uint8_t> KM_BinaryArchive::TakeBytes() {
    if (m_has_failed || !m_chunks.empty())
        return {};
    return std::exchange(m_written, {});
}

bool KM_BinaryArchive::CanWrite(std::uint64_t count) const {
    return m_is_writing && !m_has_failed && m_written.size() <= m_size_limit &&
           count <= m_size_limit - m_written.size();
}

void KM_BinaryArchive::Reserve(std::uint64_t count) {
    if (!CanWrite(count) || count <= m_written.capacity() - m_written.size())
        return;
    try { // at least doubled, as many small requests would copy everything every time
        m_written.reserve(std::max(m_written.size() + count, 2 * m_written.capacity()));
    } catch (const std::exception&) {
        return; // what does not fit will fail when it is written
    }
}

std::uint64_t KM_BinaryArchive::BytesLeft() const {
    if (m_is_writing || m_has_failed)
        return 0;
    return (m_chunks.empty() ? m_source.size() : m_chunks.back().end) - m_position;
}

bool KM_BinaryArchive::WriteBytes(std::span<const std::uint8_t> bytes) {
    if (!CanWrite(bytes.size()))
        return Fail();
    try {
        m_written.insert(m_written.end(), bytes.begin(), bytes.end());
        return true;
    } catch (const std::exception&) {
        return Fail();
    }
}

bool KM_BinaryArchive::ViewBytes(std::uint64_t count, std::span<const std::uint8_t>& bytes) {
    if (m_is_writing || m_has_failed || count > BytesLeft())
        return Fail();
    bytes = m_source.subspan(m_position, count);
    m_position += count;
    return true;
}

bool KM_BinaryArchive::ReadBytes(std::span<std::uint8_t> bytes) {
    std::span<const std::uint8_t> view;
    if (!ViewBytes(bytes.size(), view))
        return false;
    std::ranges::copy(view, bytes.begin());
    return true;
}

template <class T> bool KM_BinaryArchive::WriteNumber(T value) {
    return WriteBytes(toLittleEndian(std::bit_cast<BitsOf<T>>(value)));
}

template <class T> bool KM_BinaryArchive::ReadNumber(T& value) {
    std::span<const std::uint8_t> bytes;
    if (!ViewBytes(sizeof(T), bytes))
        return false;
    value = std::bit_cast<T>(fromLittleEndian<BitsOf<T>>(bytes.data()));
    return true;
}

bool KM_BinaryArchive::WriteByte(std::uint8_t value) {
    return WriteNumber(value);
}

bool KM_BinaryArchive::ReadByte(std::uint8_t& value) {
    return ReadNumber(value);
}

bool KM_BinaryArchive::WriteBool(bool value) {
    return WriteByte(value ? 1 : 0);
}

bool KM_BinaryArchive::ReadBool(bool& value) {
    std::uint8_t byte = 0;
    if (!ReadByte(byte))
        return false;
    if (byte > 1)
        return Fail();
    value = byte == 1;
    return true;
}

bool KM_BinaryArchive::WriteInt(std::int32_t value) {
    return WriteNumber(value);
}

bool KM_BinaryArchive::ReadInt(std::int32_t& value) {
    return ReadNumber(value);
}

bool KM_BinaryArchive::WriteInt64(std::int64_t value) {
    return WriteNumber(value);
}

bool KM_BinaryArchive::ReadInt64(std::int64_t& value) {
    return ReadNumber(value);
}

bool KM_BinaryArchive::WriteFloat(float value) {
    return WriteNumber(value);
}

bool KM_BinaryArchive::ReadFloat(float& value) {
    return ReadNumber(value);
}

bool KM_BinaryArchive::WriteDouble(double value) {
    return WriteNumber(value);
}

bool KM_BinaryArchive::ReadDouble(double& value) {
    return ReadNumber(value);
}

bool KM_BinaryArchive::WriteUuid(const KM_UUID& id) {
    return WriteNumber(id.Data1) && WriteBytes(toLittleEndian(id.Data2)) &&
           WriteBytes(toLittleEndian(id.Data3)) && WriteBytes(id.Data4);
}

bool KM_BinaryArchive::ReadUuid(KM_UUID& id) {
    std::span<const std::uint8_t> bytes;
    if (!ViewBytes(16, bytes))
        return false;
    id.Data1 = fromLittleEndian<std::uint32_t>(bytes.data());
    id.Data2 = fromLittleEndian<std::uint16_t>(bytes.data() + 4);
    id.Data3 = fromLittleEndian<std::uint16_t>(bytes.data() + 6);
    std::memcpy(id.Data4, bytes.data() + 8, sizeof id.Data4);
    return true;
}

bool KM_BinaryArchive::WritePoint(const KM_3dPoint& point) {
    return WriteDouble(point.x) && WriteDouble(point.y) && WriteDouble(point.z);
}

bool KM_BinaryArchive::ReadPoint(KM_3dPoint& point) {
    KM_3dPoint read;
    if (!ReadDouble(read.x) || !ReadDouble(read.y) || !ReadDouble(read.z))
        return false;
    point = read;
    return true;
}

bool KM_BinaryArchive::WriteVector(const KM_3dVector& vector) {
    return WritePoint(KM_3dPoint(vector));
}

bool KM_BinaryArchive::ReadVector(KM_3dVector& vector) {
    KM_3dPoint read;
    if (!ReadPoint(read))
        return false;
    vector = KM_3dVector(read);
    return true;
}
