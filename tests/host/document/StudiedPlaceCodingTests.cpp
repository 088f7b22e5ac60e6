#include "host/document/file/DocumentCoding.h"
#include "host/document/file/StudiedPlaceLayout.h"
#include "tests/host/document/SampleContent.h"

#include <gtest/gtest.h>

#include <limits>

namespace quarn::test {
namespace {

const StudiedPlace BERLIN{L"Berlin, Germany", L"Europe/Berlin", 52.52, 13.41};

bool isRead(const std::vector<std::uint8_t>& payload, StudiedPlace& place) {
    KM_BinaryArchive archive = KM_BinaryArchive::ForReading(payload);
    return readStudiedPlace(archive, place) && archive.BytesLeft() == 0;
}

std::vector<std::uint8_t> payloadOf(const StudiedPlace& place) {
    KM_BinaryArchive archive = KM_BinaryArchive::ForWriting();
    EXPECT_TRUE(writeStudiedPlace(archive, place));
    return archive.TakeBytes();
}

TEST(StudiedPlaceCoding, PlacesComeBackInFilesOfEveryVersion) {
    for (int version = OLDEST_DOCUMENT_VERSION; version <= KM_CURRENT_ARCHIVE_VERSION; ++version) {
        DocumentContent content = sampleContent();
        content.version = version;
        content.studied_place = BERLIN;
        const auto bytes = encodeDocument(content);
        ASSERT_TRUE(bytes) << bytes.message();
        const auto read = decodeDocument(bytes.value());
        ASSERT_TRUE(read) << read.message();
        EXPECT_EQ(read.value().studied_place, BERLIN);
        content.studied_place.reset();
        const auto without = decodeDocument(encodeDocument(content).value());
        EXPECT_FALSE(without.value().studied_place);
    }
}

TEST(StudiedPlaceCoding, ThatIsCutOffOrOffTheEarthIsRefused) {
    const auto whole = payloadOf(BERLIN);
    StudiedPlace read;
    EXPECT_TRUE(isRead(whole, read));
    for (std::size_t size = 0; size < whole.size(); ++size)
        EXPECT_FALSE(
            isRead({whole.begin(), whole.begin() + static_cast<std::ptrdiff_t>(size)}, read))
            << size;
    for (const double longitude : {-180.5, 360.5, std::numeric_limits<double>::quiet_NaN()}) {
        KM_BinaryArchive archive = KM_BinaryArchive::ForWriting();
        StudiedPlace place = BERLIN;
        place.longitude_deg = longitude;
        EXPECT_FALSE(writeStudiedPlace(archive, place)) << longitude;
    }
}

TEST(StudiedPlaceCoding, NewerMinorLayoutIsReadAndAnotherMajorOneRefused) {
    auto newer = payloadOf(BERLIN);
    newer[4] = 1; // the minor number behind the major one, both 4 bytes
    newer.push_back(42);
    StudiedPlace read;
    EXPECT_TRUE(isRead(newer, read));
    EXPECT_EQ(read, BERLIN);
    auto other = payloadOf(BERLIN);
    other[0] = 2;
    EXPECT_FALSE(isRead(other, read));
}

} // namespace
} // namespace quarn::test
