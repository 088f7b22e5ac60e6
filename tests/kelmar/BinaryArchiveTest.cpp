#include "kelmar/KM_BinaryArchive.h"
#include "tests/kelmar/Bytes.h"

#include <gtest/gtest.h>

#include <bit>
#include <cmath>
#include <limits>

namespace {

using Archive = KM_BinaryArchive;

template <class Write> Bytes written(Write&& write) {
    Archive archive = Archive::ForWriting();
    EXPECT_TRUE(write(archive));
    return archive.TakeBytes();
}

// Reads with an operation and says whether it succeeded and took every byte.
template <class Value, class Read> bool takesAll(const Bytes& bytes, Value& value, Read&& read) {
    Archive archive = Archive::ForReading(bytes);
    return (archive.*read)(value) && archive.BytesLeft() == 0;
}

const Bytes count_of_2_to_31 = {0, 0, 0, 0x80, 0, 0, 0, 0};
const Bytes count_of_2_to_63 = {0, 0, 0, 0, 0, 0, 0, 0x80};

} // namespace

TEST(BinaryArchive, IntegersAreLittleEndian) {
    EXPECT_EQ(written([](Archive& a) { return a.WriteInt(0x01020304); }), (Bytes{4, 3, 2, 1}));
    EXPECT_EQ(written([](Archive& a) { return a.WriteInt(-2); }), (Bytes{0xFE, 0xFF, 0xFF, 0xFF}));
    EXPECT_EQ(written([](Archive& a) { return a.WriteInt64(0x0102030405060708); }),
              (Bytes{8, 7, 6, 5, 4, 3, 2, 1}));
    EXPECT_EQ(written([](Archive& a) { return a.WriteByte(7); }), (Bytes{7}));
}

TEST(BinaryArchive, IntegersComeBack) {
    std::int32_t number = 0;
    EXPECT_TRUE(takesAll(Bytes{4, 3, 2, 1}, number, &Archive::ReadInt));
    EXPECT_EQ(number, 0x01020304);
    EXPECT_TRUE(takesAll(Bytes{0, 0, 0, 0x80}, number, &Archive::ReadInt));
    EXPECT_EQ(number, std::numeric_limits<std::int32_t>::min());
    std::int64_t wide = 0;
    EXPECT_TRUE(takesAll(Bytes{8, 7, 6, 5, 4, 3, 2, 1}, wide, &Archive::ReadInt64));
    EXPECT_EQ(wide, 0x0102030405060708);
}

// IEEE 754: 1.0 is sign 0, biased exponent 1023, fraction 0; -2.5F is -1.25 * 2^1.
TEST(BinaryArchive, FloatingPointNumbersAreTheirLittleEndianBits) {
    EXPECT_EQ(written([](Archive& a) { return a.WriteDouble(1.0); }),
              (Bytes{0, 0, 0, 0, 0, 0, 0xF0, 0x3F}));
    EXPECT_EQ(written([](Archive& a) { return a.WriteFloat(-2.5F); }), (Bytes{0, 0, 0x20, 0xC0}));
    double number = 0.0;
    EXPECT_TRUE(takesAll(Bytes{0, 0, 0, 0, 0, 0, 0xF0, 0x3F}, number, &Archive::ReadDouble));
    EXPECT_EQ(number, 1.0);
    float small = 0.0F;
    EXPECT_TRUE(takesAll(Bytes{0, 0, 0x20, 0xC0}, small, &Archive::ReadFloat));
    EXPECT_EQ(small, -2.5F);
}

TEST(BinaryArchive, DoublesKeepEveryBit) {
    const std::uint64_t patterns[] = {
        0x8000000000000000, // minus zero
        0x0000000000000001, // the smallest denormal
        0x7FF8000000000123, // a quiet not-a-number that carries 0x123
        0xFFF0000000000000, // minus infinity
        0x0123456789ABCDEF,
    };
    for (const std::uint64_t bits : patterns) {
        const Bytes bytes =
            written([&](Archive& a) { return a.WriteDouble(std::bit_cast<double>(bits)); });
        double number = 0.0;
        EXPECT_TRUE(takesAll(bytes, number, &Archive::ReadDouble));
        EXPECT_EQ(std::bit_cast<std::uint64_t>(number), bits);
    }
}

TEST(BinaryArchive, BoolsAreOneByteOfZeroOrOne) {
    EXPECT_EQ(written([](Archive& a) { return a.WriteBool(true) && a.WriteBool(false); }),
              (Bytes{1, 0}));
    bool flag = false;
    EXPECT_TRUE(takesAll(Bytes{1}, flag, &Archive::ReadBool));
    EXPECT_TRUE(flag);
    EXPECT_FALSE(takesAll(Bytes{2}, flag, &Archive::ReadBool));
    EXPECT_TRUE(flag);
}

// U+00E9 is C3 A9, U+1F600 is F0 9F 98 80 in UTF-8.
TEST(BinaryArchive, StringsAreUtf8WithTheirNumberOfBytes) {
    const KM_wString text = KM_wString::FromUtf8("\xC3\xA9\xF0\x9F\x98\x80!");
    const Bytes bytes = {7, 0, 0, 0, 0, 0, 0, 0, 0xC3, 0xA9, 0xF0, 0x9F, 0x98, 0x80, '!'};
    EXPECT_EQ(written([&](Archive& a) { return a.WriteString(text); }), bytes);
    KM_wString read;
    EXPECT_TRUE(takesAll(bytes, read, &Archive::ReadString));
    EXPECT_EQ(read, text);
}

TEST(BinaryArchive, StringsMayBeEmptyAndMayHoldZeros) {
    for (const std::string_view utf8 : {std::string_view(), std::string_view("a\0b", 3)}) {
        const KM_wString text = KM_wString::FromUtf8(utf8);
        const Bytes bytes = written([&](Archive& a) { return a.WriteString(text); });
        KM_wString read = L"before";
        EXPECT_TRUE(takesAll(bytes, read, &Archive::ReadString));
        EXPECT_EQ(read.ToUtf8(), utf8);
    }
}

TEST(BinaryArchive, IllFormedUtf8IsRefused) {
    const Bytes ill_formed[] = {
        {0xFF},             // never a byte of UTF-8
        {0xC0, 0x80},       // an overlong zero
        {0xED, 0xA0, 0x80}, // a surrogate
        {0xC3},             // cut
    };
    for (const Bytes& text : ill_formed) {
        const Bytes count = {static_cast<std::uint8_t>(text.size()), 0, 0, 0, 0, 0, 0, 0};
        KM_wString read = L"before";
        EXPECT_FALSE(takesAll(joined({count, text}), read, &Archive::ReadString));
        EXPECT_EQ(read, L"before");
    }
}

TEST(BinaryArchive, AReplacementCharacterThatWasWrittenIsNoError) {
    const Bytes bytes = {3, 0, 0, 0, 0, 0, 0, 0, 0xEF, 0xBF, 0xBD};
    KM_wString read;
    EXPECT_TRUE(takesAll(bytes, read, &Archive::ReadString));
    EXPECT_EQ(read[0], wchar_t{0xFFFD});
}

TEST(BinaryArchive, UuidsAreTheirFieldsInOrder) {
    const KM_UUID id = {0x01020304, 0x0506, 0x0708, {9, 10, 11, 12, 13, 14, 15, 16}};
    const Bytes bytes = {4, 3, 2, 1, 6, 5, 8, 7, 9, 10, 11, 12, 13, 14, 15, 16};
    EXPECT_EQ(written([&](Archive& a) { return a.WriteUuid(id); }), bytes);
    KM_UUID read;
    EXPECT_TRUE(takesAll(bytes, read, &Archive::ReadUuid));
    EXPECT_EQ(read, id);
}

TEST(BinaryArchive, PointsAndVectorsAreTheirCoordinates) {
    const Bytes bytes = {0, 0, 0, 0, 0, 0, 0xF0, 0x3F, 0, 0, 0,    0,
                         0, 0, 0, 0, 0, 0, 0,    0,    0, 0, 0xF0, 0xBF};
    const Bytes point = written([](Archive& a) { return a.WritePoint({1, 0, -1}); });
    EXPECT_EQ(point, bytes);
    EXPECT_EQ(written([](Archive& a) { return a.WriteVector({1, 0, -1}); }), bytes);
    KM_3dPoint read_point;
    KM_3dVector read_vector;
    EXPECT_TRUE(takesAll(bytes, read_point, &Archive::ReadPoint));
    EXPECT_TRUE(takesAll(bytes, read_vector, &Archive::ReadVector));
    EXPECT_EQ(read_point, KM_3dPoint(1, 0, -1));
    EXPECT_EQ(read_vector, KM_3dVector(1, 0, -1));
}

TEST(BinaryArchive, AnArrayOfPointsIsTheCountAndThePoints) {
    const KM_3dPointArray points = {{1, 2, 3}, {4, 5, 6}};
    const Bytes bytes = written([&](Archive& a) { return a.WriteArray(points); });
    const Bytes one_by_one = written([&](Archive& a) {
        return a.WriteInt64(2) && a.WritePoint(points[0]) && a.WritePoint(points[1]);
    });
    EXPECT_EQ(bytes, one_by_one);
    KM_3dPointArray read = {{9, 9, 9}};
    using Operation = bool (Archive::*)(KM_3dPointArray&);
    EXPECT_TRUE(takesAll(bytes, read, Operation(&Archive::ReadArray)));
    EXPECT_EQ(read, points);
}

TEST(BinaryArchive, ArraysOfTextsNumbersAndMeshElementsComeBack) {
    const KM_ClassArray<KM_wString> texts = {L"one", L"", L"three"};
    const std::vector<std::int32_t> integers = {-1, 0x01020304};
    const std::vector<double> doubles = {0.5, -0.0};
    const std::vector<KM_3fPoint> vertices = {{1, 2, 3}, {4, 5, 6}};
    const std::vector<KM_3fVector> normals = {{0, 0, 1}};
    const std::vector<KM_2fPoint> places = {{0.25F, 0.75F}};
    const std::vector<KM_Color> colors = {{1, 2, 3, 4}};
    const std::vector<KM_MeshTriangle> triangles = {{{0, 1, 2}}, {{2, 1, 0xFFFFFFFF}}};
    const Bytes bytes = written([&](Archive& a) {
        return a.WriteArray(texts) && a.WriteArray(integers) && a.WriteArray(doubles) &&
               a.WriteArray(vertices) && a.WriteArray(normals) && a.WriteArray(places) &&
               a.WriteArray(colors) && a.WriteArray(triangles);
    });
    Archive archive = Archive::ForReading(bytes);
    KM_ClassArray<KM_wString> read_texts;
    std::vector<std::int32_t> read_integers;
    std::vector<double> read_doubles;
    std::vector<KM_3fPoint> read_vertices;
    std::vector<KM_3fVector> read_normals;
    std::vector<KM_2fPoint> read_places;
    std::vector<KM_Color> read_colors;
    std::vector<KM_MeshTriangle> read_triangles;
    EXPECT_TRUE(archive.ReadArray(read_texts) && archive.ReadArray(read_integers));
    EXPECT_TRUE(archive.ReadArray(read_doubles) && archive.ReadArray(read_vertices));
    EXPECT_TRUE(archive.ReadArray(read_normals) && archive.ReadArray(read_places));
    EXPECT_TRUE(archive.ReadArray(read_colors) && archive.ReadArray(read_triangles));
    EXPECT_EQ(archive.BytesLeft(), 0U);
    EXPECT_EQ(read_texts, texts);
    EXPECT_EQ(read_integers, integers);
    EXPECT_EQ(read_doubles[0], 0.5);
    EXPECT_TRUE(std::signbit(read_doubles[1]));
    EXPECT_EQ(read_vertices, vertices);
    EXPECT_EQ(read_normals, normals);
    EXPECT_EQ(read_places, places);
    EXPECT_EQ(read_colors, colors);
    EXPECT_EQ(read_triangles, triangles);
}

TEST(BinaryArchive, IndicesOfTrianglesAreLittleEndian) {
    const std::vector<KM_MeshTriangle> triangles = {{{1, 2, 0x04030201}}};
    EXPECT_EQ(written([&](Archive& a) { return a.WriteArray(triangles); }),
              (Bytes{1, 0, 0, 0, 0, 0, 0, 0, 1, 0, 0, 0, 2, 0, 0, 0, 1, 2, 3, 4}));
}

TEST(BinaryArchive, EmptyArraysComeBackEmpty) {
    const Bytes bytes = written([](Archive& a) { return a.WriteArray(KM_3dPointArray()); });
    EXPECT_EQ(bytes, Bytes(8, 0));
    KM_3dPointArray read = {{1, 2, 3}};
    Archive archive = Archive::ForReading(bytes);
    EXPECT_TRUE(archive.ReadArray(read));
    EXPECT_TRUE(read.IsEmpty());
}

TEST(BinaryArchive, CountsThatTheBytesCannotHoldAreRefusedBeforeMemoryIsTaken) {
    const Bytes one_too_many = joined({{2, 0, 0, 0, 0, 0, 0, 0}, Bytes(47, 0)});
    for (const Bytes& bytes : {count_of_2_to_31, count_of_2_to_63, Bytes(8, 0xFF), one_too_many}) {
        KM_3dPointArray points = {{1, 2, 3}};
        Archive archive = Archive::ForReading(bytes);
        EXPECT_FALSE(archive.ReadArray(points));
        EXPECT_TRUE(archive.HasFailed());
        EXPECT_EQ(points, KM_3dPointArray({{1, 2, 3}}));
    }
    for (const Bytes& bytes : {count_of_2_to_31, count_of_2_to_63}) {
        KM_ClassArray<KM_wString> texts;
        std::vector<double> doubles;
        KM_wString text;
        EXPECT_FALSE(Archive::ForReading(bytes).ReadArray(texts));
        EXPECT_FALSE(Archive::ForReading(bytes).ReadArray(doubles));
        EXPECT_FALSE(Archive::ForReading(bytes).ReadString(text));
    }
}

TEST(BinaryArchive, ACountThatOverflowsWhenMultipliedIsRefused) {
    // 24 * (2^64 / 24 rounded up) is 8 in 64 bits.
    Bytes bytes = written([](Archive& a) { return a.WriteInt64(0x0AAAAAAAAAAAAAAB); });
    bytes.resize(bytes.size() + 8);
    KM_3dPointArray points;
    EXPECT_FALSE(Archive::ForReading(bytes).ReadArray(points));
}

TEST(BinaryArchive, ATextArrayThatFailsHalfWayLeavesTheOldTexts) {
    const KM_ClassArray<KM_wString> texts = {L"one", L"two"};
    Bytes bytes = written([&](Archive& a) { return a.WriteArray(texts); });
    bytes.back() = 0xFF;
    KM_ClassArray<KM_wString> read = {L"before"};
    EXPECT_FALSE(Archive::ForReading(bytes).ReadArray(read));
    EXPECT_EQ(read, KM_ClassArray<KM_wString>({L"before"}));
}

TEST(BinaryArchive, AFailedArchiveStaysFailed) {
    const Bytes bytes(12, 0);
    Archive archive = Archive::ForReading(bytes);
    std::int32_t number = 5;
    EXPECT_FALSE(archive.Fail());
    EXPECT_FALSE(archive.ReadInt(number));
    EXPECT_FALSE(archive.ReadBytes({}));
    EXPECT_EQ(archive.BytesLeft(), 0U);
    EXPECT_EQ(number, 5);
}

TEST(BinaryArchive, ReadingPastTheEndFailsAndLeavesTheValue) {
    const Bytes bytes(7, 1);
    double number = 2.5;
    Archive archive = Archive::ForReading(bytes);
    EXPECT_FALSE(archive.ReadDouble(number));
    EXPECT_EQ(number, 2.5);
    EXPECT_TRUE(archive.HasFailed());
}

TEST(BinaryArchive, APointThatIsCutLeavesTheOldOne) {
    const Bytes bytes(23, 0);
    KM_3dPoint point(1, 2, 3);
    EXPECT_FALSE(Archive::ForReading(bytes).ReadPoint(point));
    EXPECT_EQ(point, KM_3dPoint(1, 2, 3));
}

TEST(BinaryArchive, WritingWhileReadingFailsAndSoDoesTheReverse) {
    const Bytes bytes(4, 0);
    Archive reading = Archive::ForReading(bytes);
    EXPECT_FALSE(reading.WriteInt(1));
    EXPECT_TRUE(reading.HasFailed());
    Archive writing = Archive::ForWriting();
    std::uint8_t byte = 0;
    EXPECT_FALSE(writing.ReadByte(byte));
    EXPECT_TRUE(writing.HasFailed());
}

TEST(BinaryArchive, WritingFailsAtTheSizeLimit) {
    Archive archive = Archive::ForWriting(5, 8);
    EXPECT_TRUE(archive.WriteDouble(1.0));
    EXPECT_FALSE(archive.WriteByte(1));
    EXPECT_TRUE(archive.HasFailed());
    EXPECT_EQ(archive.Bytes().size(), 8U);
    EXPECT_TRUE(archive.TakeBytes().empty());
}

TEST(BinaryArchive, KnowsTheVersionOfItsDocument) {
    EXPECT_EQ(Archive::ForWriting().Archive3dmVersion(), 5);
    EXPECT_EQ(Archive::ForWriting(3).Archive3dmVersion(), 3);
    EXPECT_EQ(Archive::ForReading({}, 4).Archive3dmVersion(), 4);
}

TEST(BinaryArchive, RawBytesCanBeCopiedOrSeenInPlace) {
    const Bytes bytes = {1, 2, 3, 4, 5};
    Archive archive = Archive::ForReading(bytes);
    std::uint8_t copy[2] = {};
    std::span<const std::uint8_t> seen;
    EXPECT_TRUE(archive.ReadBytes(copy));
    EXPECT_TRUE(archive.ViewBytes(2, seen));
    EXPECT_EQ(copy[1], 2);
    EXPECT_EQ(seen.data(), bytes.data() + 2);
    EXPECT_EQ(archive.BytesLeft(), 1U);
    EXPECT_FALSE(archive.ViewBytes(2, seen));
}
