#include "host/app/DocumentSaving.h"

#include "host/document/Document.h"
#include "host/document/file/DocumentCoding.h"
#include "host/document/file/DocumentExtension.h"
#include "host/document/file/DocumentFile.h"
#include "host/document/file/FileRemainder.h"
#include "sdk/qncore/QnPlugIn.h"
#include "sdk/qncore/QnWinApp.h"
#include "tests/host/app/TestCommand.h"
#include "tests/host/document/DocumentFixtures.h"
#include "tests/host/document/SampleContent.h"
#include "tests/support/TempFolder.h"

#include <gmock/gmock.h>

#include <filesystem>
#include <stdexcept>

namespace quarn {

namespace {

namespace fs = std::filesystem;
using test::HostTest;
using test::sampleContent;
using test::sampleId;
using test::TempFolder;
using testing::HasSubstr;
using testing::IsEmpty;
using Bytes = std::vector<std::uint8_t>;

/// A plug-in that keeps a number in documents.
class KeepingPlugIn final : public CQuarnPlugIn {
public:
    enum class Writes { number, nothing, no_version, half_a_chunk, failure, exception };

    const wchar_t* PlugInName() const override { return L"Keeper"; }
    const wchar_t* PlugInVersion() const override { return L"1"; }
    KM_UUID PlugInID() const override { return sampleId(41); }
    unsigned int PlugInType() const override { return 16; }

    bool CallWriteDocument(const CQuarnFileWriteOptions& options) override {
        asked_selected_only = options.SelectedObjectFilter();
        asked_version = options.Quarn3dmVersion();
        asked_document = options.DocumentSerialNumber();
        return has_something;
    }
    bool WriteDocument(CQuarnDoc&, KM_BinaryArchive& archive,
                       const CQuarnFileWriteOptions&) override {
        written_for_version = archive.Archive3dmVersion();
        switch (writes) {
        case Writes::number:
            return archive.Write3dmChunkVersion(3, 1) && archive.WriteInt(number);
        case Writes::nothing:
            return true;
        case Writes::no_version:
            return archive.WriteByte(1);
        case Writes::half_a_chunk:
            return archive.Write3dmChunkVersion(3, 1) && archive.BeginWriteChunk(1);
        case Writes::failure:
            return false;
        case Writes::exception:
            throw std::runtime_error("out of ink");
        }
        return false;
    }
    bool ReadDocument(CQuarnDoc& document, KM_BinaryArchive& archive,
                      const CQuarnFileReadOptions& options) override {
        ++reads;
        read_version = archive.ChunkVersion();
        objects_while_reading = Document::of(document).objects().objects().size();
        was_opened = options.Mode(CQuarnFileReadOptions::open_mode);
        was_imported = options.Mode(CQuarnFileReadOptions::import_mode);
        if (throws_on_reading)
            throw std::runtime_error("no glasses");
        return archive.ReadInt(number) && archive.BytesLeft() == 0;
    }

    /// Global, as a plug-in has to be; each test begins with a fresh state.
    void reset() {
        has_something = true;
        writes = Writes::number;
        number = 0;
        reads = 0;
        throws_on_reading = false;
    }

    bool has_something = true;
    Writes writes = Writes::number;
    std::int32_t number = 0;
    bool throws_on_reading = false;
    bool asked_selected_only = false;
    int asked_version = 0;
    unsigned int asked_document = 0;
    int written_for_version = 0;
    int reads = 0;
    KM_ChunkVersion read_version;
    std::size_t objects_while_reading = 0;
    bool was_opened = false;
    bool was_imported = false;
};

CWinApp keeping_application;
KeepingPlugIn keeper;

class DocumentFile : public HostTest {
protected:
    DocumentFile() { keeper.reset(); }

    static Document& document() { return *Application::current()->documents().active(); }
    /// A document without anything but its views.
    static Document& newDocument() { return Application::current()->documents().openNew(); }

    static DocumentContent readWhole(const fs::path& file) {
        auto content = readDocumentFile(file);
        EXPECT_TRUE(content) << (content ? "" : content.message());
        return content ? std::move(content.value()) : DocumentContent();
    }
    static void save(const fs::path& file, const DocumentSaveOptions& options = {}) {
        const auto saved = saveDocument(document(), file, options);
        EXPECT_TRUE(saved) << saved.message();
    }
    static std::vector<std::string> open(const fs::path& file) {
        const DocumentContent content = readWhole(file);
        return openContent(newDocument(), content);
    }
    static std::vector<std::string> import(const fs::path& file) {
        return importContent(document(), readWhole(file));
    }
    void writeSample(const fs::path& file) {
        const auto bytes = encodeDocument(sampleContent());
        ASSERT_TRUE(bytes);
        test::writeFile(
            file, {reinterpret_cast<const char*>(bytes.value().data()), bytes.value().size()});
    }

    TempFolder folder;
};

/// Loads the plug-in into the session that runs.
void load(Session& session) {
    const PlugInLoad loaded = session.adoptProgramPlugIn();
    ASSERT_TRUE(loaded.ok()) << loaded.message;
}

} // namespace

TEST_F(DocumentFile, ADocumentIsSavedAndOpened) {
    writeSample(folder / "a.quarn");
    EXPECT_THAT(open(folder / "a.quarn"), IsEmpty());

    const DocumentContent sample = sampleContent();
    ASSERT_EQ(sample.objects.size(), document().objects().objects().size());
    EXPECT_EQ(L"Kiste", document().objects().find(sampleId(1))->name.View());
    EXPECT_FALSE(document().objects().find(sampleId(2))->visible);
    EXPECT_TRUE(document().objects().find(sampleId(13))->curve);
    EXPECT_EQ(KM_3dPoint(0.1, 0.2, 0.3), document().objects().find(sampleId(21))->point);
    EXPECT_EQ(UnitSystem::feet, document().units());
    EXPECT_EQ(0.0125, document().absoluteTolerance());
    EXPECT_FALSE(document().sun().isEnabled());
    EXPECT_EQ(KM_3dVector(0.6, 0.0, 0.8), document().sun().directionToSun());
    ASSERT_EQ(1U, document().namedViews().size());
    EXPECT_EQ(sample.cameras[0].viewport, document().namedViews()[0].viewport);
    EXPECT_EQ(document().edgesOf(wireframe_mode_id), MeshEdgeChoice::all);
    EXPECT_EQ(document().renderWindow().settings,
              (RenderSettings{640, 360, 128, 4, *sample.light}));
}

TEST_F(DocumentFile, OpeningBringsItsViewsInPlaceOfTheStandardOnes) {
    writeSample(folder / "a.quarn");
    open(folder / "a.quarn");
    const DocumentContent sample = sampleContent();
    ASSERT_EQ(2U, document().views().size());
    const ViewState& first = *document().views()[0];
    EXPECT_EQ(L"Perspective", first.name().View());
    EXPECT_EQ(640, first.frameWidth());
    EXPECT_EQ(360, first.frameHeight());
    EXPECT_EQ(sample.views[0].viewport, first.viewport());
    EXPECT_EQ(sample.views[0].display_mode, first.displayMode()->Id());
    EXPECT_EQ(L"Plan", document().activeView().name().View());
}

TEST_F(DocumentFile, LightsKeepTheirIndices) {
    writeSample(folder / "a.quarn");
    open(folder / "a.quarn");
    ASSERT_EQ(5, document().lights().count());
    for (const int deleted : {0, 2, 3, 4})
        EXPECT_TRUE(document().lights().at(deleted).IsDeleted());
    EXPECT_EQ(sampleContent().lights[0].light, document().lights().at(1).Light());
    EXPECT_EQ(5, document().lights().add(sampleContent().lights[0].light));
}

TEST_F(DocumentFile, WhatIsOpenedIsSavedAsTheSameFile) {
    writeSample(folder / "a.quarn");
    open(folder / "a.quarn");
    save(folder / "b.quarn");
    EXPECT_EQ(test::readFile(folder / "a.quarn"), test::readFile(folder / "b.quarn"));
}

TEST_F(DocumentFile, ADisplayModeThatIsNotKnownIsTold) {
    DocumentContent content = sampleContent();
    content.views[0].display_mode = sampleId(99);
    const std::vector<std::string> warnings = openContent(newDocument(), content);
    ASSERT_EQ(1U, warnings.size());
    EXPECT_THAT(warnings[0], HasSubstr("\"Perspective\""));
    EXPECT_TRUE(document().views()[0]->displayMode());
}

TEST_F(DocumentFile, AFileWithoutViewsLeavesTheStandardOnes) {
    DocumentContent content = sampleContent();
    content.views.clear();
    openContent(newDocument(), content);
    EXPECT_EQ(4U, document().views().size());
    EXPECT_EQ(L"Perspective", document().activeView().name().View());
}

TEST_F(DocumentFile, ImportingAddsObjectsCamerasAndLightsAndLeavesTheRest) {
    writeSample(folder / "a.quarn");
    test::addBox(document(), {0, 0, 0}, {1, 1, 1});
    const KM_3dVector sun = document().sun().directionToSun();
    import(folder / "a.quarn");
    EXPECT_EQ(1 + sampleContent().objects.size(), document().objects().objects().size());
    EXPECT_EQ(4U, document().views().size());
    EXPECT_EQ(1U, document().namedViews().size());
    EXPECT_TRUE(document().sun().isEnabled());
    EXPECT_EQ(sun, document().sun().directionToSun());
    ASSERT_EQ(1, document().lights().count()) << "slots of deleted lights are left out";
    EXPECT_EQ(L"Lampe", document().lights().at(0).Light().LightName().View());
}

TEST_F(DocumentFile, ImportingAFileTwiceGivesItsObjectsNewIdsAndNames) {
    writeSample(folder / "a.quarn");
    import(folder / "a.quarn");
    import(folder / "a.quarn");
    const std::size_t count = sampleContent().objects.size();
    ASSERT_EQ(2 * count, document().objects().objects().size());
    EXPECT_EQ(sampleId(1), document().objects().objects()[0]->id);
    EXPECT_NE(sampleId(1), document().objects().objects()[count]->id);
    EXPECT_EQ(L"Kiste 2", document().objects().objects()[count]->name.View());
}

TEST_F(DocumentFile, SelectedObjectsAreSavedWithoutWhatIsAroundThem) {
    writeSample(folder / "a.quarn");
    open(folder / "a.quarn");
    document().objects().find(sampleId(11))->selected = true;
    save(folder / "b.quarn", {.only_selected = true});
    const DocumentContent content = readWhole(folder / "b.quarn");
    ASSERT_EQ(1U, content.objects.size());
    EXPECT_EQ(sampleId(11), content.objects[0].id);
    EXPECT_EQ(UnitSystem::feet, content.settings.units);
    EXPECT_THAT(content.views, IsEmpty());
    EXPECT_THAT(content.lights, IsEmpty());
    EXPECT_THAT(content.cameras, IsEmpty());
    EXPECT_THAT(content.plug_ins, IsEmpty());
    EXPECT_THAT(content.unknown, IsEmpty());
}

TEST_F(DocumentFile, WhatNobodyUnderstandsIsLeftOutOfFilesForOlderPrograms) {
    writeSample(folder / "a.quarn");
    open(folder / "a.quarn");
    save(folder / "b.quarn", {.version = 4});
    const DocumentContent content = readWhole(folder / "b.quarn");
    EXPECT_EQ(4, content.version);
    EXPECT_THAT(content.plug_ins, IsEmpty());
    EXPECT_THAT(content.unknown, IsEmpty());
    EXPECT_EQ(sampleContent().objects.size(), content.objects.size());
}

TEST_F(DocumentFile, AFailedSaveNamesTheFileAndLeavesTheOldOne) {
    test::writeFile(folder / "old.quarn", "old");
    test::addBox(document(), {0, 0, 0}, {1, 1, 1});
    document().objects().addPoint(L"Nowhere", KM_3dPoint::UnsetPoint);
    const auto saved = saveDocument(document(), folder / "old.quarn");
    ASSERT_FALSE(saved);
    EXPECT_THAT(saved.message(), HasSubstr("old.quarn"));
    EXPECT_THAT(saved.message(), HasSubstr("\"Nowhere\""));
    EXPECT_EQ("old", test::readFile(folder / "old.quarn"));

    const auto nowhere = saveDocument(newDocument(), folder / "none" / "x.quarn");
    ASSERT_FALSE(nowhere);
    EXPECT_THAT(nowhere.message(), HasSubstr("folder does not exist"));
}

TEST_F(DocumentFile, FilesThatCannotBeReadAreNamed) {
    const auto expectRefused = [](const fs::path& file, const std::string& why) {
        const auto content = readDocumentFile(file);
        ASSERT_FALSE(content);
        EXPECT_THAT(content.message(), HasSubstr(file.filename().string()));
        EXPECT_THAT(content.message(), HasSubstr(why));
    };
    fs::create_directory(folder / "folder.quarn");
    test::writeFile(folder / "text.quarn", "not a document");
    test::writeFile(folder / "empty.quarn", "");
    expectRefused(folder / "none.quarn", "there is no such file");
    expectRefused(folder / "folder.quarn", "it is a folder");
    expectRefused(folder / "text.quarn", "it is no document");
    expectRefused(folder / "empty.quarn", "it is no document");
    expectRefused("/dev/null", "it is not an ordinary file");
}

TEST_F(DocumentFile, ItsEndingIsKnownInAnyCase) {
    EXPECT_TRUE(isDocumentFile("a.quarn"));
    EXPECT_TRUE(isDocumentFile("a.QUARN"));
    EXPECT_FALSE(isDocumentFile("quarn"));
    EXPECT_FALSE(isDocumentFile("a.quarn.obj"));
}

// ---- What plug-ins keep

TEST_F(DocumentFile, WhatAPlugInThatIsNotLoadedKeepsIsSavedAgain) {
    writeSample(folder / "a.quarn");
    EXPECT_THAT(open(folder / "a.quarn"), IsEmpty());
    save(folder / "b.quarn");
    EXPECT_EQ(sampleContent().plug_ins[0].bytes, readWhole(folder / "b.quarn").plug_ins[0].bytes);
    EXPECT_EQ(0, keeper.reads);
}

TEST_F(DocumentFile, APlugInThatIsLoadedLaterReadsWhatItKeepsInTheOpenDocument) {
    DocumentContent content = sampleContent();
    content.plug_ins[0].bytes = {3, 0, 0, 0, 1, 0, 0, 0, 77, 0, 0, 0};
    openContent(newDocument(), content);
    load(session);
    EXPECT_EQ(77, keeper.number);
    EXPECT_TRUE(keeper.was_opened);
    EXPECT_THAT(document().fileRemainder().plug_ins, IsEmpty());
}

TEST_F(DocumentFile, APlugInWritesAndReadsItsPart) {
    load(session);
    test::addBox(document(), {0, 0, 0}, {1, 1, 1});
    keeper.number = 4711;
    save(folder / "a.quarn");
    EXPECT_EQ(KM_CURRENT_ARCHIVE_VERSION, keeper.asked_version);
    EXPECT_EQ(KM_CURRENT_ARCHIVE_VERSION, keeper.written_for_version);
    EXPECT_EQ(document().serialNumber(), keeper.asked_document);
    EXPECT_FALSE(keeper.asked_selected_only);

    keeper.number = 0;
    open(folder / "a.quarn");
    EXPECT_EQ(4711, keeper.number);
    EXPECT_EQ((KM_ChunkVersion{3, 1}), keeper.read_version);
    EXPECT_EQ(1U, keeper.objects_while_reading);
    EXPECT_TRUE(keeper.was_opened);
    EXPECT_FALSE(keeper.was_imported);

    import(folder / "a.quarn");
    EXPECT_EQ(2, keeper.reads);
    EXPECT_FALSE(keeper.was_opened);
    EXPECT_TRUE(keeper.was_imported);
}

TEST_F(DocumentFile, APlugInIsToldOfSelectedObjectsAndOfOlderVersions) {
    load(session);
    save(folder / "a.quarn", {.only_selected = true});
    EXPECT_TRUE(keeper.asked_selected_only);
    save(folder / "a.quarn", {.version = 3});
    EXPECT_FALSE(keeper.asked_selected_only);
    EXPECT_EQ(3, keeper.asked_version);
    EXPECT_EQ(3, keeper.written_for_version);
}

TEST_F(DocumentFile, APlugInWithNothingToKeepHasNoPart) {
    load(session);
    keeper.has_something = false;
    save(folder / "a.quarn");
    EXPECT_THAT(readWhole(folder / "a.quarn").plug_ins, IsEmpty());
    keeper.has_something = true;
    keeper.writes = KeepingPlugIn::Writes::nothing;
    save(folder / "a.quarn");
    EXPECT_THAT(readWhole(folder / "a.quarn").plug_ins, IsEmpty());
}

TEST_F(DocumentFile, APlugInThatFailsToWriteKeepsTheDocumentFromBeingSaved) {
    load(session);
    test::writeFile(folder / "old.quarn", "old");
    using Writes = KeepingPlugIn::Writes;
    for (const Writes wrong :
         {Writes::no_version, Writes::half_a_chunk, Writes::failure, Writes::exception}) {
        keeper.writes = wrong;
        const auto saved = saveDocument(document(), folder / "old.quarn");
        ASSERT_FALSE(saved);
        EXPECT_THAT(saved.message(), HasSubstr("Keeper"));
        EXPECT_EQ("old", test::readFile(folder / "old.quarn"));
    }
}

TEST_F(DocumentFile, WhatAPlugInCannotReadIsToldKeptAndReplacedBySomethingNewer) {
    load(session);
    writeSample(folder / "a.quarn");
    keeper.has_something = false;
    const std::vector<std::string> warnings = open(folder / "a.quarn");
    ASSERT_EQ(1U, warnings.size());
    EXPECT_THAT(warnings[0], HasSubstr("Keeper"));
    save(folder / "b.quarn");
    EXPECT_EQ(sampleContent().plug_ins[0].bytes, readWhole(folder / "b.quarn").plug_ins[0].bytes);

    keeper.has_something = true;
    keeper.number = 5;
    save(folder / "b.quarn");
    const DocumentContent content = readWhole(folder / "b.quarn");
    ASSERT_EQ(1U, content.plug_ins.size());
    EXPECT_EQ((Bytes{3, 0, 0, 0, 1, 0, 0, 0, 5, 0, 0, 0}), content.plug_ins[0].bytes);
}

TEST_F(DocumentFile, APlugInThatThrowsOnReadingLosesNothingButItsPart) {
    load(session);
    writeSample(folder / "a.quarn");
    keeper.throws_on_reading = true;
    const std::vector<std::string> warnings = open(folder / "a.quarn");
    ASSERT_EQ(1U, warnings.size());
    EXPECT_THAT(warnings[0], HasSubstr("no glasses"));
    EXPECT_EQ(sampleContent().objects.size(), document().objects().objects().size());
}

} // namespace quarn
