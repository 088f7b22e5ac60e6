#pragma once

#include "kelmar/KM_3dPointArray.h"
#include "kelmar/KM_Array.h"
#include "kelmar/KM_Color.h"
#include "kelmar/KM_Export.h"
#include "kelmar/KM_Mesh.h"
#include "kelmar/KM_Point.h"
#include "kelmar/KM_Uuid.h"
#include "kelmar/KM_wString.h"

#include <cstdint>
#include <limits>
#include <span>
#include <vector>

/// The version of document files that are written when none is asked for.
inline constexpr int KM_CURRENT_ARCHIVE_VERSION = 5;

/// The version that a plug-in gave its chunk.
struct KM_ChunkVersion {
    int Major = 0;
    int Minor = 0;

    friend bool operator==(const KM_ChunkVersion&, const KM_ChunkVersion&) = default;
};

/// Writes values to a growing run of bytes, or reads them back from one.
///
/// Numbers are little-endian whatever the machine. Counts have 64 bits, and a count that is read is
/// checked against the bytes that are left before memory is asked for. Every operation returns
/// false when it cannot be done: reading past the end of the innermost chunk, malformed bytes,
/// writing while reading or the reverse, no memory. The archive has then failed for good, and every
/// later operation returns false too, so that a sequence of them may be checked once, at its end.
/// An operation that fails to read leaves its argument as it was.
///
/// Not to be used by two threads at once.
class KELMAR_API KM_BinaryArchive {
public:
    /// An empty archive to write to.
    /// @param archive_version  see Archive3dmVersion
    /// @param size_limit       bytes that may be written; the operation that would exceed them
    /// fails
    static KM_BinaryArchive
    ForWriting(int archive_version = KM_CURRENT_ARCHIVE_VERSION,
               std::uint64_t size_limit = std::numeric_limits<std::uint64_t>::max());

    /// An archive that reads `bytes`, which must outlive it and stay unchanged. Hand a plug-in an
    /// archive over its own payload alone, so that what it reads stays within and its failures
    /// concern nobody else.
    static KM_BinaryArchive ForReading(std::span<const std::uint8_t> bytes,
                                       int archive_version = KM_CURRENT_ARCHIVE_VERSION);

    KM_BinaryArchive(KM_BinaryArchive&&) noexcept = default;
    KM_BinaryArchive& operator=(KM_BinaryArchive&&) noexcept = default;

    /// Version of the document file that the archive belongs to. It is below the current one when a
    /// document is saved for an older program.
    int Archive3dmVersion() const { return m_archive_version; }

    bool IsWriting() const { return m_is_writing; }
    bool HasFailed() const { return m_has_failed; }
    /// Marks the archive as failed: for content that can be read and still makes no sense.
    /// @return false
    bool Fail();

    /// All that was written; valid until the next write. Headers of open chunks are not final.
    std::span<const std::uint8_t> Bytes() const { return m_written; }
    /// Hands over all that was written and leaves the archive empty. Gives no bytes when the
    /// archive has failed or a chunk is still open.
    std::vector<std::uint8_t> TakeBytes();
    /// Makes room for `count` more bytes, as far as there is memory, so that long arrays are not
    /// copied again while the archive grows.
    void Reserve(std::uint64_t count);

    /// Bytes that can still be read: of the innermost open chunk or, when none is open, of the
    /// archive. 0 after a failure and while writing.
    std::uint64_t BytesLeft() const;

    /// @name Chunks
    /// A chunk is its id (4 bytes), the length of its payload (8), a CRC-32 of id, length and
    /// payload (4; see KM_Crc32), and the payload, in which chunks may be nested.
    /// @{

    bool BeginWriteChunk(std::uint32_t id);
    /// Completes the chunk that was begun last. Fails when there is none.
    bool EndWriteChunk();

    /// Enters the chunk that begins here, once its length fits and its CRC-32 agrees.
    /// @param id      the chunk's id
    /// @param length  bytes of its payload
    bool BeginReadChunk(std::uint32_t& id, std::uint64_t& length);
    /// Leaves the chunk that was entered last, skipping what was not read of it. Fails when there
    /// is none.
    bool EndReadChunk();

    /// Number of chunks that were begun and not ended.
    int OpenChunkCount() const { return static_cast<int>(m_chunks.size()); }

    /// Writes the version of a plug-in's chunk: two 4-byte integers. Negative numbers are refused.
    bool Write3dmChunkVersion(int major, int minor);
    /// Reads that version, and keeps it for ChunkVersion. Negative numbers are refused.
    bool Read3dmChunkVersion(int& major, int& minor);
    /// The version that was read last. The host reads it when it opens a plug-in's chunk, before
    /// the plug-in reads the rest; 0.0 when none was read.
    KM_ChunkVersion ChunkVersion() const { return m_chunk_version; }
    /// @}

    /// @name Single values
    /// Floating-point numbers keep every bit. A bool is a byte, 0 or 1; another value is refused.
    /// A string is the number of its UTF-8 bytes (8 bytes) and these; ill-formed UTF-8 is refused.
    /// A UUID is its fields in order, 16 bytes. Points and vectors are their coordinates.
    /// @{
    bool WriteByte(std::uint8_t value);
    bool WriteBool(bool value);
    bool WriteInt(std::int32_t value);
    bool WriteInt64(std::int64_t value);
    bool WriteFloat(float value);
    bool WriteDouble(double value);
    bool WriteString(const KM_wString& text);
    bool WriteUuid(const KM_UUID& id);
    bool WritePoint(const KM_3dPoint& point);
    bool WriteVector(const KM_3dVector& vector);

    bool ReadByte(std::uint8_t& value);
    bool ReadBool(bool& value);
    bool ReadInt(std::int32_t& value);
    bool ReadInt64(std::int64_t& value);
    bool ReadFloat(float& value);
    bool ReadDouble(double& value);
    bool ReadString(KM_wString& text);
    bool ReadUuid(KM_UUID& id);
    bool ReadPoint(KM_3dPoint& point);
    bool ReadVector(KM_3dVector& vector);
    /// @}

    /// @name Arrays
    /// The count (8 bytes), then the elements one after the other. Reading replaces what the array
    /// holds. A count above 2^31 - 1 is refused.
    /// @{
    bool WriteArray(const KM_3dPointArray& points);
    bool WriteArray(const KM_ClassArray<KM_wString>& texts);
    bool WriteArray(std::span<const std::int32_t> numbers);
    bool WriteArray(std::span<const double> numbers);
    bool WriteArray(std::span<const KM_3fPoint> points);
    bool WriteArray(std::span<const KM_3fVector> vectors);
    bool WriteArray(std::span<const KM_2fPoint> points);
    bool WriteArray(std::span<const KM_Color> colors);
    bool WriteArray(std::span<const KM_MeshTriangle> triangles);

    bool ReadArray(KM_3dPointArray& points);
    bool ReadArray(KM_ClassArray<KM_wString>& texts);
    bool ReadArray(std::vector<std::int32_t>& numbers);
    bool ReadArray(std::vector<double>& numbers);
    bool ReadArray(std::vector<KM_3fPoint>& points);
    bool ReadArray(std::vector<KM_3fVector>& vectors);
    bool ReadArray(std::vector<KM_2fPoint>& points);
    bool ReadArray(std::vector<KM_Color>& colors);
    bool ReadArray(std::vector<KM_MeshTriangle>& triangles);

    /// For arrays of other things: the 8-byte count alone. Write it, then the elements.
    bool WriteCount(std::uint64_t count);
    /// Reads a count, refusing one above 2^31 - 1 and one that the bytes left cannot hold.
    /// @param smallest_element  the least number of bytes that an element takes; 0 counts as 1
    bool ReadCount(std::uint64_t smallest_element, int& count);
    /// @}

    /// @name Raw bytes
    /// @{
    bool WriteBytes(std::span<const std::uint8_t> bytes);
    /// Fills all of `bytes`.
    bool ReadBytes(std::span<std::uint8_t> bytes);
    /// Passes over `count` bytes and shows them in place; they live as long as the archive's own.
    bool ViewBytes(std::uint64_t count, std::span<const std::uint8_t>& bytes);
    /// @}

private:
    // Where a chunk's payload begins and, while reading, where it ends.
    struct OpenChunk {
        std::uint64_t begin = 0;
        std::uint64_t end = 0;
    };

    KM_BinaryArchive() = default;
    bool CanWrite(std::uint64_t count) const;
    template <class T> bool WriteNumber(T value);
    template <class T> bool ReadNumber(T& value);
    template <class T> bool WriteElements(std::span<const T> elements);
    template <class T> bool ReadElements(std::vector<T>& elements);
    template <class T> bool WriteRun(std::span<const T> elements);
    template <class T> bool ReadRun(std::span<T> elements);

    int m_archive_version = KM_CURRENT_ARCHIVE_VERSION;
    bool m_is_writing = false;
    bool m_has_failed = false;
    KM_ChunkVersion m_chunk_version;
    std::vector<OpenChunk> m_chunks;
    std::uint64_t m_size_limit = 0;
    std::vector<std::uint8_t> m_written;
    std::span<const std::uint8_t> m_source;
    std::uint64_t m_position = 0;
};
