#include "kelmar/KM_BinaryArchive.h"
#include "kelmar/KM_Crc32.h"
#include "tests/kelmar/Bytes.h"

#include <gtest/gtest.h>

#include <limits>

namespace {

using Archive = KM_BinaryArchive;

// Chunk 1 holds a number, chunk 2 within it, and another number.
Bytes nestedChunks() {
    Archive archive = Archive::ForWriting();
    EXPECT_TRUE(archive.BeginWriteChunk(1));
    EXPECT_TRUE(archive.WriteInt(10));
    EXPECT_TRUE(archive.BeginWriteChunk(2));
    EXPECT_TRUE(archive.WriteInt(20));
    EXPECT_TRUE(archive.EndWriteChunk());
    EXPECT_TRUE(archive.WriteInt(11));
    EXPECT_TRUE(archive.EndWriteChunk());
    return archive.TakeBytes();
}

Bytes chunkWithLength(std::uint64_t length) {
    Bytes bytes = {7, 0, 0, 0};
    for (int i = 0; i < 8; ++i)
        bytes.push_back(static_cast<std::uint8_t>(length >> (8 * i)));
    const std::uint32_t crc = KM_Crc32(bytes);
    for (int i = 0; i < 4; ++i)
        bytes.push_back(static_cast<std::uint8_t>(crc >> (8 * i)));
    return bytes;
}

bool entersChunk(const Bytes& bytes) {
    Archive archive = Archive::ForReading(bytes);
    std::uint32_t id = 0;
    std::uint64_t length = 0;
    return archive.BeginReadChunk(id, length);
}

} // namespace

TEST(Chunks, AreIdLengthCheckSequenceAndPayload) {
    Archive archive = Archive::ForWriting();
    EXPECT_TRUE(archive.BeginWriteChunk(0x01020304));
    EXPECT_TRUE(archive.WriteByte(0xAB));
    EXPECT_TRUE(archive.EndWriteChunk());
    const std::uint32_t crc = KM_Crc32(Bytes{4, 3, 2, 1, 1, 0, 0, 0, 0, 0, 0, 0, 0xAB});
    const auto byte = [&](int i) { return static_cast<std::uint8_t>(crc >> (8 * i)); };
    EXPECT_EQ(archive.TakeBytes(), (Bytes{4, 3, 2, 1, 1, 0, 0, 0, 0, 0, 0, 0, byte(0), byte(1),
                                          byte(2), byte(3), 0xAB}));
}

TEST(Chunks, NestAndBoundWhatIsRead) {
    const Bytes bytes = nestedChunks();
    Archive archive = Archive::ForReading(bytes);
    std::uint32_t id = 0;
    std::uint64_t length = 0;
    std::int32_t number = 0;
    ASSERT_TRUE(archive.BeginReadChunk(id, length));
    EXPECT_EQ(id, 1U);
    EXPECT_EQ(length, 4U + 16U + 4U + 4U);
    EXPECT_TRUE(archive.ReadInt(number));
    EXPECT_EQ(number, 10);
    ASSERT_TRUE(archive.BeginReadChunk(id, length));
    EXPECT_EQ(id, 2U);
    EXPECT_EQ(length, 4U);
    EXPECT_EQ(archive.BytesLeft(), 4U);
    EXPECT_EQ(archive.OpenChunkCount(), 2);
    EXPECT_TRUE(archive.ReadInt(number));
    EXPECT_EQ(number, 20);
    EXPECT_TRUE(archive.EndReadChunk());
    EXPECT_TRUE(archive.ReadInt(number));
    EXPECT_EQ(number, 11);
    EXPECT_TRUE(archive.EndReadChunk());
    EXPECT_EQ(archive.BytesLeft(), 0U);
}

TEST(Chunks, LeavingOneSkipsWhatWasNotRead) {
    const Bytes bytes = nestedChunks();
    Archive archive = Archive::ForReading(bytes);
    std::uint32_t id = 0;
    std::uint64_t length = 0;
    EXPECT_TRUE(archive.BeginReadChunk(id, length));
    EXPECT_TRUE(archive.EndReadChunk());
    EXPECT_EQ(archive.BytesLeft(), 0U);
}

TEST(Chunks, NothingIsReadPastTheInnermostOne) {
    const Bytes bytes = nestedChunks();
    Archive archive = Archive::ForReading(bytes);
    std::uint32_t id = 0;
    std::uint64_t length = 0;
    std::int32_t number = 0;
    EXPECT_TRUE(archive.BeginReadChunk(id, length) && archive.ReadInt(number));
    EXPECT_TRUE(archive.BeginReadChunk(id, length) && archive.ReadInt(number));
    EXPECT_FALSE(archive.ReadInt(number));
    EXPECT_TRUE(archive.HasFailed());
}

TEST(Chunks, AnyFlippedBitIsFound) {
    const Bytes good = nestedChunks();
    ASSERT_TRUE(entersChunk(good));
    for (std::size_t at = 0; at < good.size(); ++at) {
        for (int bit = 0; bit < 8; ++bit) {
            Bytes bytes = good;
            bytes[at] = static_cast<std::uint8_t>(bytes[at] ^ (1 << bit));
            EXPECT_FALSE(entersChunk(bytes)) << "byte " << at << ", bit " << bit;
        }
    }
}

TEST(Chunks, CutAnywhereAreRefused) {
    const Bytes good = nestedChunks();
    for (std::size_t size = 0; size < good.size(); ++size)
        EXPECT_FALSE(entersChunk({good.begin(), good.begin() + static_cast<long>(size)})) << size;
}

TEST(Chunks, HostileLengthsAreRefused) {
    EXPECT_TRUE(entersChunk(chunkWithLength(0)));
    const std::uint64_t max = std::numeric_limits<std::uint64_t>::max();
    for (const std::uint64_t length : {std::uint64_t{1}, std::uint64_t{1} << 31,
                                       std::uint64_t{1} << 63, max, max - 15, max - 16})
        EXPECT_FALSE(entersChunk(chunkWithLength(length))) << length;
}

TEST(Chunks, EndingOneThatWasNotBegunFails) {
    Archive writing = Archive::ForWriting();
    EXPECT_FALSE(writing.EndWriteChunk());
    EXPECT_TRUE(writing.HasFailed());
    Archive reading = Archive::ForReading({});
    EXPECT_FALSE(reading.EndReadChunk());
    EXPECT_TRUE(reading.HasFailed());
}

TEST(Chunks, AnOpenChunkGivesNoBytes) {
    Archive archive = Archive::ForWriting();
    EXPECT_TRUE(archive.BeginWriteChunk(1));
    EXPECT_TRUE(archive.TakeBytes().empty());
    EXPECT_TRUE(archive.EndWriteChunk());
    EXPECT_EQ(archive.TakeBytes().size(), 16U);
}

TEST(ChunkVersion, IsTwoIntegersThatTheArchiveRemembersWhenRead) {
    Archive writing = Archive::ForWriting();
    EXPECT_TRUE(writing.Write3dmChunkVersion(5, 0x0102));
    const Bytes bytes = writing.TakeBytes();
    EXPECT_EQ(bytes, (Bytes{5, 0, 0, 0, 2, 1, 0, 0}));
    Archive reading = Archive::ForReading(bytes);
    EXPECT_EQ(reading.ChunkVersion(), KM_ChunkVersion());
    int major = 0;
    int minor = 0;
    EXPECT_TRUE(reading.Read3dmChunkVersion(major, minor));
    EXPECT_EQ(major, 5);
    EXPECT_EQ(minor, 0x0102);
    EXPECT_EQ(reading.ChunkVersion(), (KM_ChunkVersion{5, 0x0102}));
}

TEST(ChunkVersion, NegativeNumbersAreRefused) {
    EXPECT_FALSE(Archive::ForWriting().Write3dmChunkVersion(-1, 0));
    EXPECT_FALSE(Archive::ForWriting().Write3dmChunkVersion(5, -1));
    const Bytes bytes(8, 0xFF);
    Archive reading = Archive::ForReading(bytes);
    int major = 1;
    int minor = 2;
    EXPECT_FALSE(reading.Read3dmChunkVersion(major, minor));
    EXPECT_EQ(major, 1);
    EXPECT_EQ(minor, 2);
    EXPECT_EQ(reading.ChunkVersion(), KM_ChunkVersion());
}

TEST(ChunkVersion, IsNotWrittenPastTheSizeLimit) {
    EXPECT_FALSE(Archive::ForWriting(5, 4).Write3dmChunkVersion(5, 0));
}
