#include "kelmar/KM_AnimationProperties.h"
#include "kelmar/KM_BinaryArchive.h"
#include "tests/kelmar/Bytes.h"
#include "tests/kelmar/FilledRecord.h"

#include <gtest/gtest.h>

#include <bit>
#include <limits>

using Archive = KM_BinaryArchive;
using Record = KM_3dmAnimationProperties;

namespace {

constexpr std::size_t header_size = 16;

Bytes chunkOf(const Record& record) {
    Archive archive = Archive::ForWriting();
    EXPECT_TRUE(record.Write(archive));
    return archive.TakeBytes();
}

Bytes payloadOf(const Record& record) {
    const Bytes chunk = chunkOf(record);
    return {chunk.begin() + header_size, chunk.end()};
}

// A sound chunk around any payload, so that only the record's own checks can refuse it.
Bytes chunkAround(std::span<const std::uint8_t> payload) {
    Archive archive = Archive::ForWriting();
    EXPECT_TRUE(archive.BeginWriteChunk(0x4D494E41));
    EXPECT_TRUE(archive.WriteBytes(payload) && archive.EndWriteChunk());
    return archive.TakeBytes();
}

bool reads(const Bytes& chunk, Record& record) {
    Archive archive = Archive::ForReading(chunk);
    return record.Read(archive);
}

// Reads into a filled record and expects that a refusal leaves it as it was.
bool readsOrLeavesAlone(const Bytes& chunk) {
    Record record = filledRecord();
    Archive archive = Archive::ForReading(chunk);
    const bool success = record.Read(archive);
    EXPECT_EQ(archive.HasFailed(), !success);
    if (!success)
        expectFilled(record);
    return success;
}

// The payload that begins with a layout version and goes on as the callable writes it.
template <class Write> Bytes payload(std::int32_t major, std::int32_t minor, Write&& write) {
    Archive archive = Archive::ForWriting();
    EXPECT_TRUE(archive.WriteInt(major) && archive.WriteInt(minor) && write(archive));
    return archive.TakeBytes();
}

// All that stands before the camera points.
bool writeUpToDisplayMode(Archive& archive) {
    bool written = archive.WriteInt(Record::turntable);
    for (const wchar_t* text : {L"png", L"Wireframe", L"Top", L"Name"})
        written = written && archive.WriteString(text);
    return written && archive.WriteUuid(KM_nil_uuid);
}

Record recordAt(const KM_3dPoint& camera) {
    Record record;
    record.CameraPoints().Append(camera);
    return record;
}

Bytes withLayout(Bytes payload, std::uint8_t major, std::uint8_t minor) {
    payload[0] = major;
    payload[4] = minor;
    return payload;
}

} // namespace

TEST(RecordArchive, EveryFieldComesBack) {
    Record record;
    ASSERT_TRUE(reads(chunkOf(filledRecord()), record));
    expectFilled(record);
}

TEST(RecordArchive, ReadingReplacesWhatTheRecordHeld) {
    Record record = filledRecord();
    ASSERT_TRUE(reads(chunkOf(Record()), record));
    EXPECT_EQ(chunkOf(record), chunkOf(Record()));
}

TEST(RecordArchive, NumbersComeBackToTheLastBit) {
    const double not_a_number = std::bit_cast<double>(std::uint64_t{0x7FF8000000000123});
    const double smallest = std::numeric_limits<double>::denorm_min();
    Record record = recordAt({-0.0, smallest, 0.1});
    record.TargetPoints().Append(KM_3dPoint::UnsetPoint);
    record.TargetPoints().Append({std::numeric_limits<double>::max(), 1.0 / 3.0, -smallest});
    record.SetLatitude(not_a_number);
    record.SetLongitude(-0.0);
    record.SetNorthAngle(-std::numeric_limits<double>::infinity());
    record.SetFrameCount(std::numeric_limits<std::int32_t>::max());
    record.SetCurrentFrame(std::numeric_limits<std::int32_t>::min());
    Record read;
    ASSERT_TRUE(reads(chunkOf(record), read));
    const auto bits = [](double number) { return std::bit_cast<std::uint64_t>(number); };
    EXPECT_EQ(bits(read.CameraPoints()[0].x), 0x8000000000000000U);
    EXPECT_EQ(bits(read.CameraPoints()[0].y), 1U);
    EXPECT_EQ(read.CameraPoints()[0].z, 0.1);
    EXPECT_EQ(read.TargetPoints(), record.TargetPoints());
    EXPECT_EQ(bits(read.Latitude()), 0x7FF8000000000123U);
    EXPECT_EQ(bits(read.Longitude()), 0x8000000000000000U);
    EXPECT_EQ(bits(read.NorthAngle()), 0xFFF0000000000000U);
    EXPECT_EQ(read.FrameCount(), std::numeric_limits<std::int32_t>::max());
    EXPECT_EQ(read.CurrentFrame(), std::numeric_limits<std::int32_t>::min());
}

TEST(RecordArchive, ANewRecordIsTheseBytes) {
    const Bytes none(8, 0); // an empty text, an empty array, 0.0
    const Bytes nil(16, 0);
    const auto number = [](std::uint8_t low, std::uint8_t high = 0) {
        return Bytes{low, high, 0, 0};
    };
    const Bytes expected = joined({
        number(1),
        number(0),                               // layout 1.0
        number(5),                               // no animation
        {3, 0, 0, 0, 0, 0, 0, 0, 'j', 'p', 'g'}, // extension
        none,
        none,
        none, // method, viewport, name
        nil,  // display mode
        none,
        none, // camera and target points
        number(100),
        number(1), // frame count, current frame
        nil,
        nil,                                              // paths
        {0x6A, 0x4D, 0xF3, 0x8E, 0x53, 0xA4, 0x49, 0x40}, // latitude 51.2838
        none,
        none, // longitude, north
        number(1),
        number(6),
        number(0xDA, 0x07), // 1 June 2010
        number(1),
        number(6),
        number(0xDC, 0x07), // 1 June 2012
        number(6),
        number(0),
        number(0), // from 6:00:00
        number(18),
        number(0),
        number(59), // to 18:00:59
        number(30),
        number(30),     // days and minutes between frames
        Bytes(4, 0xFF), // light -1
        none,
        none,
        none,   // folder, images, dates
        {0, 0}, // render flags
    });
    EXPECT_EQ(payloadOf(Record()), expected);
    EXPECT_EQ(chunkOf(Record()), chunkAround(expected));
}

TEST(RecordArchive, WhatFollowsTheChunkCanBeRead) {
    Archive writing = Archive::ForWriting();
    ASSERT_TRUE(filledRecord().Write(writing) && writing.WriteInt(42));
    const Bytes bytes = writing.TakeBytes();
    Archive reading = Archive::ForReading(bytes);
    Record record;
    std::int32_t number = 0;
    EXPECT_TRUE(record.Read(reading) && reading.ReadInt(number));
    EXPECT_EQ(number, 42);
}

TEST(RecordArchive, AChunkCutAtAnyByteIsRefused) {
    const Bytes good = chunkOf(filledRecord());
    ASSERT_TRUE(readsOrLeavesAlone(good));
    for (std::size_t size = 0; size < good.size(); ++size)
        EXPECT_FALSE(readsOrLeavesAlone({good.begin(), good.begin() + long(size)})) << size;
}

TEST(RecordArchive, AChunkWithAnyByteFlippedIsRefused) {
    const Bytes good = chunkOf(filledRecord());
    for (std::size_t at = 0; at < good.size(); ++at) {
        Bytes bytes = good;
        bytes[at] = static_cast<std::uint8_t>(~bytes[at]);
        EXPECT_FALSE(readsOrLeavesAlone(bytes)) << at;
    }
}

// Such a payload is one of an older layout. There are as many as there are fields, and one without.
TEST(RecordArchive, ASoundPayloadMayEndBetweenTwoFieldsAndNowhereElse) {
    const Bytes good = payloadOf(filledRecord());
    int accepted = 0;
    for (std::size_t size = 0; size <= good.size(); ++size)
        accepted += readsOrLeavesAlone(chunkAround(std::span(good).first(size))) ? 1 : 0;
    EXPECT_EQ(accepted, 36);
}

// What is accepted is written back as it was read: nothing is taken for something else.
TEST(RecordArchive, ASoundChunkWithAnyBytesFlippedIsRefusedOrMeansWhatItSays) {
    const Bytes good = payloadOf(filledRecord());
    for (std::size_t at = 8; at < good.size(); ++at) {
        for (const int mask : {0x01, 0x80, 0xFF}) {
            Bytes flipped = good;
            flipped[at] = static_cast<std::uint8_t>(flipped[at] ^ mask);
            const Bytes chunk = chunkAround(flipped);
            Record record;
            if (readsOrLeavesAlone(chunk) && reads(chunk, record)) {
                const Bytes again = payloadOf(record);
                ASSERT_GE(again.size(), flipped.size()) << at;
                EXPECT_TRUE(std::equal(flipped.begin(), flipped.end(), again.begin())) << at;
            }
        }
    }
}

TEST(RecordArchive, FieldsThatAnOlderLayoutLacksHaveTheirDefaults) {
    const Bytes older = payload(1, 0, writeUpToDisplayMode);
    Record record = filledRecord();
    ASSERT_TRUE(reads(chunkAround(older), record));
    EXPECT_EQ(record.CaptureType(), Record::turntable);
    EXPECT_EQ(record.FileExtension(), L"png");
    EXPECT_EQ(record.HtmlFilename(), L"Name");
    EXPECT_TRUE(record.CameraPoints().IsEmpty());
    EXPECT_EQ(record.FrameCount(), 100);
    EXPECT_EQ(record.Latitude(), 51.2838);
    EXPECT_EQ(record.EndSeconds(), 59);
    EXPECT_EQ(record.LightIndex(), -1);
    EXPECT_TRUE(record.Dates().IsEmpty());
    EXPECT_FALSE(record.RenderPreview());
}

TEST(RecordArchive, WhatANewerMinorLayoutAddsIsSkipped) {
    const Bytes newer =
        joined({withLayout(payloadOf(filledRecord()), 1, 1), bytesOf("more fields")});
    const Bytes bytes = joined({chunkAround(newer), {42, 0, 0, 0}});
    Archive archive = Archive::ForReading(bytes);
    Record record;
    std::int32_t after = 0;
    ASSERT_TRUE(record.Read(archive) && archive.ReadInt(after));
    expectFilled(record);
    EXPECT_EQ(after, 42);
}

TEST(RecordArchive, BytesThatNoNewerLayoutExplainsAreRefused) {
    const Bytes surplus = joined({payloadOf(filledRecord()), {0}});
    EXPECT_FALSE(readsOrLeavesAlone(chunkAround(surplus)));
}

TEST(RecordArchive, OtherMajorLayoutsAreRefused) {
    const Bytes good = payloadOf(filledRecord());
    EXPECT_TRUE(readsOrLeavesAlone(chunkAround(withLayout(good, 1, 0))));
    EXPECT_FALSE(readsOrLeavesAlone(chunkAround(withLayout(good, 2, 0))));
    EXPECT_FALSE(readsOrLeavesAlone(chunkAround(withLayout(good, 0, 0))));
    const auto write = [](Archive& archive) { return writeUpToDisplayMode(archive); };
    EXPECT_FALSE(readsOrLeavesAlone(chunkAround(payload(1, -1, write))));
    EXPECT_FALSE(readsOrLeavesAlone(chunkAround(payload(-1, 0, write))));
}

TEST(RecordArchive, AChunkOfAnotherKindIsRefused) {
    Archive archive = Archive::ForWriting();
    ASSERT_TRUE(archive.BeginWriteChunk(1) && archive.WriteBytes(payloadOf(Record())));
    ASSERT_TRUE(archive.EndWriteChunk());
    EXPECT_FALSE(readsOrLeavesAlone(archive.TakeBytes()));
}

TEST(RecordArchive, UnknownCaptureTypesAreRefused) {
    for (const std::int32_t type : {17, 6, -1, std::numeric_limits<std::int32_t>::min()}) {
        const auto write = [type](Archive& archive) { return archive.WriteInt(type); };
        EXPECT_FALSE(readsOrLeavesAlone(chunkAround(payload(1, 0, write)))) << type;
    }
}

TEST(RecordArchive, HostileCountsAreRefused) {
    for (const std::uint64_t count :
         {std::uint64_t{1}, std::uint64_t{1} << 31, std::uint64_t{1} << 63, ~std::uint64_t{0}}) {
        const auto points = [count](Archive& archive) {
            return writeUpToDisplayMode(archive) && archive.WriteInt64(std::int64_t(count));
        };
        EXPECT_FALSE(readsOrLeavesAlone(chunkAround(payload(1, 0, points)))) << count;
        const auto text = [count](Archive& archive) {
            return archive.WriteInt(Record::path) && archive.WriteInt64(std::int64_t(count));
        };
        EXPECT_FALSE(readsOrLeavesAlone(chunkAround(payload(1, 0, text)))) << count;
    }
}

TEST(RecordArchive, HostileCountsOfTextsAreRefused) {
    const Bytes good = payloadOf(Record());
    constexpr std::size_t dates_from_end = 10; // the count of dates and two flags
    for (const std::size_t byte : {0U, 3U, 7U}) {
        Bytes bytes = good;
        bytes[bytes.size() - dates_from_end + byte] = 0x80;
        EXPECT_FALSE(readsOrLeavesAlone(chunkAround(bytes))) << byte;
    }
}

TEST(RecordArchive, PointsThatAreNotFiniteAreRefused) {
    const double bad[] = {std::numeric_limits<double>::quiet_NaN(),
                          std::numeric_limits<double>::infinity(),
                          -std::numeric_limits<double>::infinity()};
    for (const double coordinate : bad) {
        for (const KM_3dPoint& point : {KM_3dPoint(coordinate, 0, 0), KM_3dPoint(0, coordinate, 0),
                                        KM_3dPoint(0, 0, coordinate)}) {
            const auto write = [&](Archive& archive) {
                return writeUpToDisplayMode(archive) && archive.WriteInt64(2) &&
                       archive.WritePoint({1, 2, 3}) && archive.WritePoint(point);
            };
            EXPECT_FALSE(readsOrLeavesAlone(chunkAround(payload(1, 0, write))));
        }
    }
}

TEST(RecordArchive, FlagsOtherThanZeroAndOneAreRefused) {
    Bytes bytes = payloadOf(filledRecord());
    bytes.back() = 2;
    EXPECT_FALSE(readsOrLeavesAlone(chunkAround(bytes)));
}

TEST(RecordArchive, IllFormedTextIsRefused) {
    const auto write = [](Archive& archive) {
        return archive.WriteInt(Record::path) && archive.WriteInt64(1) && archive.WriteByte(0xFF);
    };
    EXPECT_FALSE(readsOrLeavesAlone(chunkAround(payload(1, 0, write))));
}

TEST(RecordArchive, AFrameCountUnlikeTheArraysIsTakenAsItIs) {
    for (const std::int32_t count : {0, -1, 7, std::numeric_limits<std::int32_t>::min()}) {
        Record record = recordAt({1, 2, 3});
        record.SetFrameCount(count);
        Record read;
        EXPECT_TRUE(reads(chunkOf(record), read));
        EXPECT_EQ(read.FrameCount(), count);
        EXPECT_EQ(read.CameraPoints().Count(), 1);
    }
}

TEST(RecordArchive, WhatCouldNotBeReadBackIsNotWritten) {
    Record unknown;
    unknown.SetCaptureType(static_cast<Record::CaptureTypes>(7));
    Archive archive = Archive::ForWriting();
    EXPECT_FALSE(unknown.Write(archive));
    EXPECT_TRUE(archive.TakeBytes().empty());
    Archive another = Archive::ForWriting();
    EXPECT_FALSE(recordAt({0, std::numeric_limits<double>::quiet_NaN(), 0}).Write(another));
}

TEST(RecordArchive, WritingFailsWhereverTheArchiveDoes) {
    const Record record = filledRecord();
    const std::size_t needed = chunkOf(record).size();
    for (std::size_t limit = 0; limit <= needed; ++limit) {
        Archive archive = Archive::ForWriting(5, limit);
        EXPECT_EQ(record.Write(archive), limit == needed) << limit;
    }
}

TEST(RecordArchive, AFailedArchiveIsNeitherWrittenNorRead) {
    Archive writing = Archive::ForWriting();
    writing.Fail();
    EXPECT_FALSE(Record().Write(writing));
    const Bytes chunk = chunkOf(Record());
    Archive reading = Archive::ForReading(chunk);
    reading.Fail();
    Record record = filledRecord();
    EXPECT_FALSE(record.Read(reading));
    expectFilled(record);
}
