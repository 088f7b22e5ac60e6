#include "host/recovery/RecoveryCoding.h"

#include "host/recovery/RecoveryChunks.h"
#include "tests/host/document/DocumentFixtures.h"
#include "tests/host/document/SampleContent.h"
#include "tests/host/recovery/RecoveryFixtures.h"

#include <gmock/gmock.h>

namespace quarn::test {
namespace {

using namespace std::chrono_literals;
using testing::HasSubstr;
using Time = std::chrono::system_clock::time_point;

/// A recovery file put together chunk by chunk.
class FileOfStates {
public:
    void add(const Result<Bytes>& chunk) {
        ASSERT_TRUE(chunk) << chunk.message();
        bytes.insert(bytes.end(), chunk.value().begin(), chunk.value().end());
    }
    void addState(const DocumentContent& content, Time kept_at = Time(5s)) {
        const SharedThings shared = m_places.add(content);
        for (const Texture* texture : shared.textures)
            add(textureChunk(*texture));
        for (const Material* material : shared.materials)
            add(materialChunks(*material, m_places));
        for (const KM_Mesh* mesh : shared.meshes)
            add(meshChunk(*mesh));
        RecoveryState state;
        state.kept_at = kept_at;
        state.content = content;
        add(stateChunk(state, m_places));
    }

    Bytes bytes = recoveryBeginning();

private:
    SharedPlaces m_places;
};

DocumentContent contentWithAnotherMesh(DocumentContent content) {
    ObjectContent box;
    box.id = sampleId(61);
    box.placed.mesh = boxMesh({0, 0, 0}, {7, 7, 7});
    content.objects.insert(content.objects.begin(), box);
    return content;
}

TEST(RecoveryFile, GivesBackAllThatADocumentHolds) {
    FileOfStates file;
    const DocumentContent content = sampleContent();
    file.addState(content, Time(1234567ms));
    const auto read = decodeRecovery(file.bytes);
    ASSERT_TRUE(read) << read.message();
    EXPECT_EQ(documentBytes(read.value().content), documentBytes(content));
    EXPECT_EQ(read.value().kept_at, Time(1234567ms));
    EXPECT_FALSE(read.value().lost_its_end);
}

TEST(RecoveryFile, ALaterStateSharesWhatStandsBefore) {
    FileOfStates file;
    const DocumentContent before = sampleContent();
    file.addState(before);
    const std::size_t size_before = file.bytes.size();
    const DocumentContent after = contentWithAnotherMesh(before);
    file.addState(after);
    const Bytes whole = documentBytes(before);
    EXPECT_LT(file.bytes.size() - size_before, whole.size())
        << "the texture and the mesh that were there stand in it once";
    const auto read = decodeRecovery(file.bytes);
    ASSERT_TRUE(read) << read.message();
    EXPECT_EQ(documentBytes(read.value().content), documentBytes(after));
}

TEST(RecoveryFile, APictureBetweenStatesIsPassedOver) {
    FileOfStates file;
    file.addState(sampleContent());
    file.add(pictureChunk(std::as_bytes(std::span("a picture"))));
    file.addState(sampleContent());
    const auto read = decodeRecovery(file.bytes);
    ASSERT_TRUE(read) << read.message();
    EXPECT_FALSE(read.value().lost_its_end);
}

TEST(RecoveryFile, CutOffAnywhereItGivesItsLastWholeStateOrSaysThatThereIsNone) {
    FileOfStates file;
    const DocumentContent first = sampleContent();
    file.addState(first);
    const std::size_t first_end = file.bytes.size();
    const DocumentContent second = contentWithAnotherMesh(first);
    file.addState(second);
    const Bytes first_bytes = documentBytes(first);
    for (std::size_t size = 0; size < file.bytes.size(); ++size) {
        const auto read = decodeRecovery(std::span(file.bytes).first(size));
        ASSERT_EQ(read.ok(), size >= first_end) << size;
        if (!read) {
            ASSERT_FALSE(read.message().empty());
            continue;
        }
        ASSERT_EQ(documentBytes(read.value().content), first_bytes) << size;
        ASSERT_EQ(read.value().lost_its_end, size != first_end) << size;
    }
}

TEST(RecoveryFile, WithAnyByteFlippedItGivesAStateThatWasKeptOrSaysThatThereIsNone) {
    FileOfStates file;
    const DocumentContent first = sampleContent();
    file.addState(first);
    const std::size_t first_end = file.bytes.size();
    file.addState(contentWithAnotherMesh(first));
    const Bytes first_bytes = documentBytes(first);
    for (std::size_t at = 0; at < file.bytes.size(); ++at) {
        Bytes flipped = file.bytes;
        flipped[at] = static_cast<std::uint8_t>(flipped[at] ^ (1U << (at % 8)));
        const auto read = decodeRecovery(flipped);
        ASSERT_EQ(read.ok(), at >= first_end) << at;
        if (!read)
            continue;
        ASSERT_EQ(documentBytes(read.value().content), first_bytes) << at;
        ASSERT_TRUE(read.value().lost_its_end) << at;
    }
}

TEST(RecoveryFile, SaysWhatItIsNot) {
    const auto expectRefused = [](const Bytes& bytes, const char* why) {
        const auto read = decodeRecovery(bytes);
        ASSERT_FALSE(read);
        EXPECT_THAT(read.message(), HasSubstr(why));
    };
    expectRefused({}, "it is no recovery file");
    expectRefused(documentBytes(sampleContent()), "it is no recovery file");
    expectRefused(recoveryBeginning(), "before any of its states is whole");
    FileOfStates newer;
    newer.bytes[RECOVERY_MAGIC.size()] = RECOVERY_VERSION + 1;
    newer.addState(sampleContent());
    expectRefused(newer.bytes, "a newer program wrote it");
}

} // namespace
} // namespace quarn::test
