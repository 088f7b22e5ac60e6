#include "host/recovery/RecoveryJournal.h"

#include "engine/images/ImageFile.h"
#include "host/recovery/RecoveryGlance.h"
#include "tests/host/document/DocumentFixtures.h"
#include "tests/host/document/QualityChanges.h"
#include "tests/host/document/SampleContent.h"
#include "tests/host/recovery/RecoveryFixtures.h"

#include <gmock/gmock.h>

#include <csignal>
#include <sys/resource.h>
#include <sys/stat.h>

namespace quarn::test {
namespace {

namespace fs = std::filesystem;
using namespace std::chrono_literals;
using testing::AllOf;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::SizeIs;

/// About 24 bytes a triangle in a file.
std::shared_ptr<KM_Mesh> meshOf(std::uint32_t triangles) {
    auto mesh = std::make_shared<KM_Mesh>();
    for (std::uint32_t i = 0; i < triangles + 2; ++i)
        mesh->m_V.emplace_back(static_cast<float>(i % 1000), static_cast<float>(i / 1000),
                               static_cast<float>(i % 2));
    for (std::uint32_t i = 0; i < triangles; ++i)
        mesh->m_F.push_back({{i, i + 1, i + 2}});
    return mesh;
}

RecoveryState stateOf(DocumentContent content, fs::path document = {}) {
    RecoveryState state;
    state.document = std::move(document);
    state.kept_at = std::chrono::system_clock::time_point(1000s);
    state.content = std::move(content);
    return state;
}

void addMesh(DocumentContent& content, std::shared_ptr<const KM_Mesh> mesh) {
    ObjectContent object;
    object.id = KM_CreateUuid();
    object.placed.mesh = std::move(mesh);
    content.objects.push_back(object);
}

/// No file of this program may grow beyond a size while this lives.
class LargestFile {
public:
    explicit LargestFile(rlim_t bytes) : m_handler(std::signal(SIGXFSZ, SIG_IGN)) {
        getrlimit(RLIMIT_FSIZE, &m_before);
        const rlimit limit{bytes, m_before.rlim_max};
        setrlimit(RLIMIT_FSIZE, &limit);
    }
    ~LargestFile() {
        setrlimit(RLIMIT_FSIZE, &m_before);
        std::signal(SIGXFSZ, m_handler);
    }
    LargestFile(const LargestFile&) = delete;
    LargestFile& operator=(const LargestFile&) = delete;

private:
    void (*m_handler)(int);
    rlimit m_before{};
};

class RecoveryJournalTest : public testing::Test {
protected:
    RecoveryJournalTest() { fs::create_directory(documents); }

    static void write(RecoveryJournal& journal, const RecoveryState& state) {
        const auto written = journal.write(state);
        EXPECT_TRUE(written) << written.message();
    }
    static DocumentContent contentIn(const fs::path& file) {
        auto read = decodeRecovery(bytesOf(file));
        EXPECT_TRUE(read) << (read ? "" : read.message());
        return read ? std::move(read.value().content) : DocumentContent();
    }
    fs::path onlyFile(const fs::path& place) const {
        const auto files = recoveryFilesIn(place);
        EXPECT_THAT(files, SizeIs(1));
        return files.empty() ? fs::path() : files.front();
    }

    TempFolder folder;
    const fs::path documents = folder / "documents";
    const fs::path state_folder = folder / "state";
    const fs::path kept_in = recoveryFolder(state_folder);
    const ProcessIdentity self = currentProcess();
};

TEST_F(RecoveryJournalTest, AMeshIsWrittenOnceHoweverOftenStatesFollow) {
    RecoveryJournal journal(state_folder, self);
    DocumentContent content = sampleContent();
    addMesh(content, meshOf(40'000));
    write(journal, stateOf(content));
    const fs::path file = onlyFile(kept_in);
    const auto size_with_mesh = fs::file_size(file);
    EXPECT_GT(size_with_mesh, 900'000U);
    for (int i = 0; i < 20; ++i) {
        ObjectContent point;
        point.id = KM_CreateUuid();
        point.point = KM_3dPoint(i, 0, 0);
        content.objects.push_back(point);
        write(journal, stateOf(content));
    }
    EXPECT_LT(fs::file_size(file) - size_with_mesh, 100'000U);
    addMesh(content, meshOf(40'000));
    const auto size_before = fs::file_size(file);
    write(journal, stateOf(content));
    EXPECT_GT(fs::file_size(file) - size_before, 900'000U);
    EXPECT_LT(fs::file_size(file) - size_before, 1'100'000U);
    EXPECT_EQ(documentBytes(contentIn(file)), documentBytes(content));
}

TEST_F(RecoveryJournalTest, MaterialsComeBackWhole) {
    RecoveryJournal journal(state_folder, self);
    DocumentContent content;
    addMesh(content, boxMesh({0, 0, 0}, {1, 1, 1}));
    content.objects[0].placed.material = std::make_shared<Material>(changedMaterial());
    write(journal, stateOf(content));
    const DocumentContent back = contentIn(onlyFile(kept_in));
    ASSERT_THAT(back.objects, SizeIs(1));
    for (const QualityChange& change : qualityChanges())
        EXPECT_TRUE(change.is_made(*back.objects[0].placed.material)) << change.name;
}

TEST_F(RecoveryJournalTest, TexturesOfAnyQualityArePassedOnAndAreNotTakenForGarbage) {
    RecoveryJournal journal(state_folder, self);
    auto texture = std::make_shared<Texture>();
    texture->width = texture->height = 2200; // 19 MB
    texture->rgba.resize(4UL * 2200 * 2200);
    auto material = std::make_shared<Material>();
    material->normals.texture = texture;
    DocumentContent content;
    addMesh(content, boxMesh({0, 0, 0}, {1, 1, 1}));
    content.objects[0].placed.material = material;
    write(journal, stateOf(content));
    const auto file = onlyFile(kept_in);
    struct stat begun {};
    ASSERT_EQ(stat(file.c_str(), &begun), 0);
    for (int i = 0; i < 3; ++i)
        write(journal, stateOf(content));
    struct stat appended {};
    ASSERT_EQ(stat(file.c_str(), &appended), 0);
    EXPECT_EQ(begun.st_ino, appended.st_ino) << "it was not written anew";
    EXPECT_LT(appended.st_size - begun.st_size, 10'000) << "the texture stands there once";
    const DocumentContent back = contentIn(file);
    EXPECT_EQ(back.objects[0].placed.material->normals.texture->rgba, texture->rgba);
}

TEST_F(RecoveryJournalTest, AMeshInTheMemoryOfOneThatIsGoneIsAnotherMesh) {
    RecoveryJournal journal(state_folder, self);
    const auto place = std::make_shared<KM_Mesh>();
    const auto in_place = [&] { return std::shared_ptr<KM_Mesh>(place.get(), [](KM_Mesh*) {}); };
    *place = *boxMesh({0, 0, 0}, {1, 1, 1});
    {
        DocumentContent content;
        addMesh(content, in_place());
        write(journal, stateOf(content));
    }
    *place = *boxMesh({0, 0, 0}, {9, 9, 9});
    DocumentContent content;
    addMesh(content, in_place());
    write(journal, stateOf(content));
    EXPECT_EQ(documentBytes(contentIn(onlyFile(kept_in))), documentBytes(content));
}

TEST_F(RecoveryJournalTest, WhatNobodyNeedsAnyMoreDoesNotPileUp) {
    RecoveryJournal journal(state_folder, self);
    DocumentContent content;
    std::uintmax_t largest = 0;
    for (int i = 0; i < 12; ++i) {
        content.objects.clear();
        addMesh(content, meshOf(150'000)); // 3.6 MB
        write(journal, stateOf(content));
        largest = std::max(largest, fs::file_size(onlyFile(kept_in)));
    }
    EXPECT_LT(largest, 27U << 20) << "of 43 MB that were written";
    EXPECT_EQ(documentBytes(contentIn(onlyFile(kept_in))), documentBytes(content));
}

TEST_F(RecoveryJournalTest, TwoProgramsKeepTheSameDocumentEachInAFileOfItsOwn) {
    const fs::path document = documents / "house.quarn";
    ProcessIdentity other = self;
    other.pid += 1;
    RecoveryJournal journal(state_folder, self);
    RecoveryJournal journal_of_other(state_folder, other);
    DocumentContent content;
    addMesh(content, meshOf(10));
    write(journal, stateOf(content, document));
    const fs::path file = onlyFile(documents);
    DocumentContent more = content;
    addMesh(more, meshOf(20));
    write(journal_of_other, stateOf(more, document));
    EXPECT_THAT(recoveryFilesIn(documents), SizeIs(2));
    EXPECT_EQ(documentBytes(contentIn(file)), documentBytes(content));
    journal_of_other.remove();
    EXPECT_EQ(onlyFile(documents), file);
    EXPECT_THAT(marksIn(kept_in), SizeIs(1));
}

TEST_F(RecoveryJournalTest, AFileThatWasLeftUnderTheSameNameStays) {
    const RecoveryState state = stateOf(sampleContent(), documents / "house.quarn");
    RecoveryJournal ended(state_folder, self);
    write(ended, state);
    RecoveryJournal journal(state_folder, self);
    write(journal, state);
    EXPECT_THAT(recoveryFilesIn(documents), SizeIs(2));
    journal.remove();
    EXPECT_EQ(documentBytes(contentIn(onlyFile(documents))), documentBytes(state.content));
}

TEST_F(RecoveryJournalTest, ADocumentWhoseFolderCannotBeWrittenIsKeptInTheStateFolder) {
    RecoveryJournal journal(state_folder, self);
    write(journal, stateOf(sampleContent(), "/proc/house.quarn"));
    EXPECT_THAT(
        onlyFile(kept_in).filename().native(),
        AllOf(HasSubstr("house.quarn"), HasSubstr(self.host), HasSubstr(std::to_string(self.pid))));
    ASSERT_THAT(marksIn(kept_in), SizeIs(1));
    EXPECT_EQ(readMark(marksIn(kept_in)[0])->document, "/proc/house.quarn");
}

TEST_F(RecoveryJournalTest, ALongNameIsShortenedBetweenCharacters) {
    RecoveryJournal journal(state_folder, self);
    std::string name;
    for (int i = 0; i < 80; ++i)
        name += "語"; // 3 bytes
    write(journal, stateOf(sampleContent(), documents / (name + ".quarn")));
    const std::string kept = onlyFile(documents).filename().native();
    EXPECT_EQ(kept.rfind("." + name.substr(0, 120) + "-", 0), 0U) << kept;
}

TEST_F(RecoveryJournalTest, ADocumentThatGotAnotherFileIsKeptBesideThat) {
    RecoveryJournal journal(state_folder, self);
    write(journal, stateOf(sampleContent()));
    write(journal, stateOf(sampleContent(), documents / "house.quarn"));
    EXPECT_THAT(recoveryFilesIn(kept_in), IsEmpty());
    EXPECT_THAT(onlyFile(documents).filename().native(), HasSubstr("house.quarn"));
    EXPECT_THAT(marksIn(kept_in), SizeIs(1));
}

TEST_F(RecoveryJournalTest, AFileThatSomebodyMovedAwayIsBegunAgain) {
    RecoveryJournal journal(state_folder, self);
    const RecoveryState state = stateOf(sampleContent(), documents / "house.quarn");
    write(journal, state);
    fs::rename(documents, folder / "moved");
    fs::create_directory(documents);
    write(journal, state);
    EXPECT_EQ(documentBytes(contentIn(onlyFile(documents))), documentBytes(state.content));
    EXPECT_THAT(marksIn(kept_in), SizeIs(1));
}

TEST_F(RecoveryJournalTest, WithoutSpaceItSaysSoAndTheStateBeforeStays) {
    RecoveryJournal journal(state_folder, self);
    const RecoveryState small = stateOf(sampleContent(), documents / "house.quarn");
    RecoveryState large = small;
    addMesh(large.content, meshOf(40'000));
    write(journal, small);
    {
        const LargestFile limit(200'000);
        for (int tries = 0; tries < 3; ++tries) {
            const auto written = journal.write(large);
            ASSERT_FALSE(written);
            EXPECT_THAT(written.message(), HasSubstr("Unsaved work cannot be kept"));
            EXPECT_EQ(documentBytes(contentIn(onlyFile(documents))), documentBytes(small.content));
        }
    }
    write(journal, large);
    EXPECT_EQ(documentBytes(contentIn(onlyFile(documents))), documentBytes(large.content));
    EXPECT_EQ(filesBelow(folder.path()), 2) << "the file and its mark";
}

TEST_F(RecoveryJournalTest, WithoutSpaceFromTheBeginningItLeavesNothing) {
    RecoveryJournal journal(state_folder, self);
    RecoveryState state = stateOf(sampleContent(), documents / "house.quarn");
    addMesh(state.content, meshOf(40'000));
    {
        const LargestFile limit(200'000);
        EXPECT_FALSE(journal.write(state));
    }
    EXPECT_EQ(filesBelow(folder.path()), 0);
    write(journal, state);
    EXPECT_EQ(documentBytes(contentIn(onlyFile(documents))), documentBytes(state.content));
}

TEST_F(RecoveryJournalTest, AContentThatCannotBeWrittenLeavesTheStateBefore) {
    RecoveryJournal journal(state_folder, self);
    const RecoveryState good = stateOf(sampleContent());
    RecoveryState bad = good;
    bad.content.objects[5].point = KM_3dPoint::UnsetPoint;
    write(journal, good);
    EXPECT_FALSE(journal.write(bad));
    EXPECT_EQ(documentBytes(contentIn(onlyFile(kept_in))), documentBytes(good.content));
    write(journal, good);
    EXPECT_EQ(documentBytes(contentIn(onlyFile(kept_in))), documentBytes(good.content));
}

TEST_F(RecoveryJournalTest, FilesAreTheUsersAlone) {
    using enum fs::perms;
    const mode_t before = umask(0);
    RecoveryJournal journal(state_folder, self);
    write(journal, stateOf(sampleContent(), documents / "house.quarn"));
    umask(before);
    EXPECT_EQ(fs::status(onlyFile(documents)).permissions(), owner_read | owner_write);
    EXPECT_EQ(fs::status(kept_in).permissions(), owner_all);
}

TEST_F(RecoveryJournalTest, TheLastPictureIsSeenAlsoWhereTheFileWasWrittenAnew) {
    RecoveryJournal journal(state_folder, self);
    RecoveryState state = stateOf(sampleContent());
    state.picture.resize(8, 4);
    write(journal, state);
    const auto picture = glanceAt(onlyFile(kept_in)).picture;
    ASSERT_THAT(picture, testing::Not(IsEmpty()));
    fs::remove(onlyFile(kept_in));
    write(journal, stateOf(sampleContent()));
    EXPECT_EQ(glanceAt(onlyFile(kept_in)).picture, picture);
    state.picture.resize(16, 4);
    write(journal, state);
    EXPECT_NE(glanceAt(onlyFile(kept_in)).picture, picture);
}

TEST_F(RecoveryJournalTest, APictureThatIsSeeThroughIsKeptOnWhite) {
    RecoveryJournal journal(state_folder, self);
    RecoveryState state = stateOf(sampleContent());
    state.picture.resize(2, 1);
    state.picture.rgba = {10, 20, 30, 255, 10, 20, 30, 0};
    write(journal, state);
    Image on_white;
    on_white.resize(2, 1);
    on_white.rgba = {10, 20, 30, 255, 255, 255, 255, 255};
    const auto png = encodeImage(on_white, ImageFormat::png);
    ASSERT_TRUE(png);
    EXPECT_EQ(glanceAt(onlyFile(kept_in)).picture, png.value());
}

// ---- Marks

TEST_F(RecoveryJournalTest, AMarkHoldsAnyPath) {
    const RecoveryMark mark{self, "/a b/\n\"\xff.recovery", "/\xe8\xaa\x9e\n.quarn"};
    const auto file = writeMark(kept_in, mark);
    ASSERT_TRUE(file) << file.message();
    const auto read = readMark(file.value());
    ASSERT_TRUE(read);
    EXPECT_EQ(read->writer, self);
    EXPECT_EQ(read->recovery, mark.recovery);
    EXPECT_EQ(read->document, mark.document);
}

TEST_F(RecoveryJournalTest, ADamagedMarkIsNone) {
    const auto file = writeMark(kept_in, {self, "/a.recovery", "/a.quarn"});
    ASSERT_TRUE(file);
    const std::string whole = readFile(file.value());
    for (std::size_t size = 0; size < whole.size(); ++size) {
        writeFile(file.value(), whole.substr(0, size));
        EXPECT_FALSE(readMark(file.value())) << size;
    }
    writeFile(file.value(), whole + "more");
    EXPECT_FALSE(readMark(file.value()));
}

} // namespace
} // namespace quarn::test
