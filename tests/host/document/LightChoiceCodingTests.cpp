#include "host/document/file/ChunkIds.h"
#include "host/document/file/DocumentCoding.h"
#include "host/document/file/LightChoiceLayout.h"
#include "tests/host/document/SampleContent.h"

#include <gtest/gtest.h>

#include <functional>
#include <limits>

namespace quarn::test {
namespace {

using Bytes = std::vector<std::uint8_t>;

std::optional<LightChoice> roundTrip(const std::optional<LightChoice>& choice, int version) {
    DocumentContent content = sampleContent();
    content.version = version;
    content.light = choice;
    const auto bytes = encodeDocument(content);
    EXPECT_TRUE(bytes) << bytes.message();
    const auto read = decodeDocument(bytes.value());
    EXPECT_TRUE(read) << read.message();
    return read.value().light;
}

Bytes payloadOf(const LightChoice& choice, const std::function<void(KM_BinaryArchive&)>& more) {
    KM_BinaryArchive archive = KM_BinaryArchive::ForWriting();
    EXPECT_TRUE(writeLightChoice(archive, choice));
    more(archive);
    return archive.TakeBytes();
}

bool isRead(Bytes payload, LightChoice& choice) {
    KM_BinaryArchive archive = KM_BinaryArchive::ForReading(payload);
    return readLightChoice(archive, choice) && archive.BytesLeft() == 0;
}

bool isRead(Bytes payload) {
    LightChoice ignored;
    return isRead(std::move(payload), ignored);
}

LightChoice everyChoice() {
    LightChoice choice;
    choice.surroundings = Surroundings::picture;
    choice.picture = "/pictures/über den Dächern.hdr";
    choice.exposure = -1.25;
    choice.background = BackgroundKind::color;
    choice.background_color = {1, 2, 3, 255};
    choice.has_ground = false;
    return choice;
}

TEST(LightChoiceCoding, ChoicesComeBackInFilesOfEveryVersion) {
    for (int version = OLDEST_DOCUMENT_VERSION; version <= KM_CURRENT_ARCHIVE_VERSION; ++version) {
        EXPECT_EQ(roundTrip(everyChoice(), version), everyChoice());
        LightChoice clear;
        clear.background = BackgroundKind::transparent;
        clear.exposure = 0.0;
        EXPECT_EQ(roundTrip(clear, version), clear);
        EXPECT_FALSE(roundTrip(std::nullopt, version));
    }
}

TEST(LightChoiceCoding, ADocumentWithTheLightOfANewOneHasNoChunkOfIt) {
    DocumentContent content = sampleContent();
    content.light.reset();
    const auto without = encodeDocument(content);
    content.light = everyChoice();
    const auto with = encodeDocument(content);
    ASSERT_TRUE(without);
    ASSERT_TRUE(with);
    EXPECT_GT(with.value().size(), without.value().size());
}

TEST(LightChoiceCoding, ChoicesOutOfRangeAreRefused) {
    for (const double stops : {10.5, -11.0, 1e300, std::numeric_limits<double>::quiet_NaN()}) {
        LightChoice choice;
        choice.exposure = stops;
        KM_BinaryArchive archive = KM_BinaryArchive::ForWriting();
        EXPECT_FALSE(writeLightChoice(archive, choice)) << stops;
    }
    const Bytes whole = payloadOf(everyChoice(), [](KM_BinaryArchive&) {});
    ASSERT_TRUE(isRead(whole));
    for (std::size_t length = 0; length < whole.size(); ++length)
        EXPECT_FALSE(isRead({whole.begin(), whole.begin() + static_cast<long>(length)})) << length;
    Bytes unknown_surroundings = whole;
    unknown_surroundings[8] = 4; // behind the version of the layout
    EXPECT_FALSE(isRead(unknown_surroundings));
}

TEST(LightChoiceCoding, WhatANewerMinorLayoutAddsIsPassedOverAndAnotherMajorOneRefused) {
    Bytes newer = payloadOf(everyChoice(), [](KM_BinaryArchive& archive) { archive.WriteInt(7); });
    EXPECT_FALSE(isRead(newer)) << "the layout of today ends before";
    newer[4] = 1;
    LightChoice read;
    ASSERT_TRUE(isRead(newer, read));
    EXPECT_EQ(read, everyChoice());
    newer[0] = 2;
    EXPECT_FALSE(isRead(newer));
}

TEST(LightChoiceCoding, TwoChunksOfOneDocumentAreRefused) {
    DocumentContent content = sampleContent();
    content.light = everyChoice();
    content.unknown = {{chunk::SURROUNDINGS, payloadOf(everyChoice(), [](KM_BinaryArchive&) {})}};
    const auto bytes = encodeDocument(content);
    ASSERT_TRUE(bytes);
    EXPECT_FALSE(decodeDocument(bytes.value()));
}

} // namespace
} // namespace quarn::test
