#include "host/session/DocumentState.h"
#include "kelmar/KM_BinaryArchive.h"
#include "kelmar/KM_LittleEndian.h"
#include "sdk/qncore/QnZoetrixDynamicAccess.h"
#include "tests/zoetrix/fixtures/PlugInFixture.h"

#include <algorithm>
#include <cstring>
#include <limits>

using quarn::isModified;
using testing::HasSubstr;
using testing::Not;

namespace {

using Bytes = std::vector<std::uint8_t>;
using Record = KM_3dmAnimationProperties;

constexpr std::uint64_t FILE_HEADER = 12;          // magic and version
constexpr std::uint64_t PART_HEADER = 16 + 8;      // the plug-in's id and its chunk version
constexpr std::uint32_t PLUG_IN_PART = 0x47554C50; // "PLUG"

/// Documents saved, opened and imported with an animation in them.
class StoredDocument : public PlugInFixture {
protected:
    void save() { ASSERT_EQ(CQuarnCommand::success, run(L"_-SaveAs \"" + file() + L"\"")); }
    CQuarnCommand::result open() { return run(L"_-Open \"" + file() + L"\""); }
    CQuarnCommand::result import() { return run(L"_-Import \"" + file() + L"\""); }
    KM_wString file() const { return wide(folder / "a.quarn"); }

    /// Changes the record in the saved file, which stays sound around it.
    void changeSavedRecord(const std::function<void(Bytes& record_payload)>& change);

    /// Expects that the record is one of a new document: nothing to play, and the plug-in's own
    /// name for a sequence.
    void expectFreshRecord() {
        EXPECT_EQ(Record::none, record().CaptureType());
        EXPECT_TRUE(record().CameraPoints().IsEmpty());
        EXPECT_TRUE(record().TargetPoints().IsEmpty());
    }
};

Bytes bytesOf(const std::string& text) {
    return {text.begin(), text.end()};
}

/// Copies a chunk, as it is or with another payload.
void copyChunk(KM_BinaryArchive& from, KM_BinaryArchive& to,
               const std::function<Bytes(std::uint32_t id, Bytes payload)>& change) {
    std::uint32_t id = 0;
    std::uint64_t length = 0;
    std::span<const std::uint8_t> view;
    ASSERT_TRUE(from.BeginReadChunk(id, length) && from.ViewBytes(length, view) &&
                from.EndReadChunk());
    ASSERT_TRUE(to.BeginWriteChunk(id) &&
                to.WriteBytes(change(id, Bytes(view.begin(), view.end()))) && to.EndWriteChunk());
}

void StoredDocument::changeSavedRecord(const std::function<void(Bytes&)>& change) {
    const Bytes old_file = bytesOf(readFile(folder / "a.quarn"));
    KM_BinaryArchive from = KM_BinaryArchive::ForReading(old_file);
    KM_BinaryArchive to = KM_BinaryArchive::ForWriting();
    std::span<const std::uint8_t> header;
    ASSERT_TRUE(from.ViewBytes(FILE_HEADER, header) && to.WriteBytes(header));
    const auto with_record = [&](std::uint32_t id, Bytes payload) {
        if (id != PLUG_IN_PART)
            return payload;
        const auto record_begin = payload.begin() + PART_HEADER;
        const Bytes record_chunk(record_begin, payload.end());
        KM_BinaryArchive record_from = KM_BinaryArchive::ForReading(record_chunk);
        KM_BinaryArchive record_to = KM_BinaryArchive::ForWriting();
        copyChunk(record_from, record_to, [&](std::uint32_t, Bytes record_payload) {
            change(record_payload);
            return record_payload;
        });
        payload.erase(record_begin, payload.end());
        const Bytes changed = record_to.TakeBytes();
        payload.insert(payload.end(), changed.begin(), changed.end());
        return payload;
    };
    while (from.BytesLeft() > 0)
        copyChunk(from, to, with_record);
    const Bytes file = to.TakeBytes();
    writeFile(folder / "a.quarn", {reinterpret_cast<const char*>(file.data()), file.size()});
}

/// Overwrites a 4-byte integer of the record's payload: the layout version takes the first eight
/// bytes, the capture type the next four.
std::function<void(Bytes&)> withInt(std::size_t at, std::int32_t value) {
    return [=](Bytes& payload) {
        std::ranges::copy(kelmar::toLittleEndian(static_cast<std::uint32_t>(value)),
                          payload.begin() + static_cast<std::ptrdiff_t>(at));
    };
}

constexpr std::size_t CAPTURE_TYPE = 8;

} // namespace

TEST_F(StoredDocument, PointsComeBackToTheLastBit) {
    setUpCameraFrames(1000);
    record().CameraPoints()[7] = KM_3dPoint(1.0 / 3.0, std::numeric_limits<double>::min(), -0.0);
    const KM_3dPointArray cameras = record().CameraPoints();
    const KM_3dPointArray targets = record().TargetPoints();
    save();
    ASSERT_EQ(CQuarnCommand::success, run(L"_-New"));
    expectFreshRecord();
    ASSERT_EQ(CQuarnCommand::success, open());
    ASSERT_EQ(1000, record().CameraPoints().Count());
    ASSERT_EQ(1000, record().TargetPoints().Count());
    EXPECT_EQ(0, std::memcmp(cameras.Array(), record().CameraPoints().Array(),
                             1000 * sizeof(KM_3dPoint)));
    EXPECT_EQ(0, std::memcmp(targets.Array(), record().TargetPoints().Array(),
                             1000 * sizeof(KM_3dPoint)));
}

TEST_F(StoredDocument, TheFrameShownLastComesBack) {
    setUpCameraFrames(9);
    ASSERT_EQ(CQuarnCommand::success, run(L"_-ViewFrameNumber 4"));
    save();
    ASSERT_EQ(CQuarnCommand::success, open());
    EXPECT_EQ(4, record().CurrentFrame());
    ASSERT_EQ(CQuarnCommand::success, run(L"_-ViewNextFrame"));
    EXPECT_EQ(5, record().CurrentFrame());
}

TEST_F(StoredDocument, ACurveThatTheCameraFollowsIsFoundAgain) {
    importObj("v 0 0 0\nv 5 0 0\nv 5 5 0\nl 1 2 3\n");
    setUpCameraFrames(4);
    const KM_UUID curve = objectId(L"model");
    record().SetCaptureType(Record::flythrough);
    record().SetCameraPathId(curve);
    save();
    ASSERT_EQ(CQuarnCommand::success, open());
    EXPECT_EQ(curve, record().CameraPathId());
    EXPECT_TRUE(CQuarnObjRef(record().CameraPathId()).Curve());
    ASSERT_EQ(CQuarnCommand::success, run(L"_-PlayAnimation"));
}

TEST_F(StoredDocument, AFileThatCannotBeReadLeavesTheOpenDocumentWithItsAnimation) {
    setUpCameraFrames(3);
    save();
    const std::string whole = readFile(folder / "a.quarn");
    writeFile(folder / "a.quarn", std::string_view(whole).substr(0, whole.size() - 1));
    setUpCameraFrames(8);
    const unsigned int document = doc().RuntimeSerialNumber();
    EXPECT_EQ(CQuarnCommand::failure, open());
    EXPECT_EQ(document, doc().RuntimeSerialNumber());
    EXPECT_EQ(8, record().FrameCount());
    EXPECT_EQ(CQuarnCommand::failure, import());
    EXPECT_EQ(8, record().FrameCount());
}

TEST_F(StoredDocument, OpeningAFileWithADamagedRecordLeavesNothingToPlay) {
    setUpCameraFrames(3);
    save();
    changeSavedRecord(withInt(CAPTURE_TYPE, 17));
    setUpCameraFrames(8);
    EXPECT_EQ(CQuarnCommand::success, open());
    EXPECT_THAT(printed(), HasSubstr(L"What Zoetrix keeps in the file cannot be read"));
    expectFreshRecord();
    EXPECT_EQ(CQuarnCommand::failure, run(L"_-PlayAnimation"));
}

TEST_F(StoredDocument, ImportingAFileWithADamagedRecordLeavesNothingToPlay) {
    setUpCameraFrames(3);
    save();
    changeSavedRecord(withInt(CAPTURE_TYPE, 17));
    setUpCameraFrames(8);
    EXPECT_EQ(CQuarnCommand::success, import());
    EXPECT_THAT(printed(), HasSubstr(L"What Zoetrix keeps in the file cannot be read"));
    expectFreshRecord();
    EXPECT_EQ(0, record().FrameCount());
    EXPECT_EQ(CQuarnCommand::failure, run(L"_-PlayAnimation"));
}

TEST_F(StoredDocument, ADamagedRecordIsKeptUntilAnotherIsSetUp) {
    setUpCameraFrames(3);
    save();
    changeSavedRecord(withInt(CAPTURE_TYPE, 17));
    const std::string damaged = readFile(folder / "a.quarn");
    ASSERT_EQ(CQuarnCommand::success, open());
    ASSERT_EQ(CQuarnCommand::success, run(L"_-Save"));
    EXPECT_EQ(damaged, readFile(folder / "a.quarn"));

    setUpCameraFrames(2);
    ASSERT_EQ(CQuarnCommand::success, run(L"_-Save"));
    ASSERT_EQ(CQuarnCommand::success, open());
    EXPECT_EQ(2, record().FrameCount());
}

TEST_F(StoredDocument, AFrameCountUnlikeItsPointsIsReadAndRefusedByEveryCommand) {
    setUpCameraFrames(3);
    for (const int count : {4, 2, 0, -1, std::numeric_limits<int>::max()}) {
        setUpCameraFrames(3);
        record().SetFrameCount(count);
        save();
        ASSERT_EQ(CQuarnCommand::success, open());
        EXPECT_EQ(count, record().FrameCount());
        for (const wchar_t* command : {L"_-PlayAnimation", L"_-ViewFirstFrame", L"_-ViewLastFrame",
                                       L"_-ViewNextFrame", L"_-ViewPreviousFrame"})
            EXPECT_EQ(CQuarnCommand::failure, run(command));
    }
}

TEST_F(StoredDocument, StoredFrameNumbersFarOutsideAreSurvived) {
    for (const int number : {std::numeric_limits<int>::max(), std::numeric_limits<int>::min()}) {
        setUpCameraFrames(3);
        record().SetCurrentFrame(number);
        save();
        ASSERT_EQ(CQuarnCommand::success, open());
        EXPECT_EQ(number, record().CurrentFrame());
        for (const wchar_t* command :
             {L"_-ViewNextFrame", L"_-ViewPreviousFrame", L"_-ViewFirstFrame", L"_-PlayAnimation"})
            run(command);
        EXPECT_EQ(3, record().FrameCount());
    }
}

// ---- Names that a page would hold as they are

TEST_F(StoredDocument, NamesThatNoFileHoldsAreCleanedWhenTheyAreOpenedAndThatIsToldOnce) {
    setUpCameraFrames(2);
    record().SetHtmlFilename(L"</TITLE>\\|/:*?\"<>\n\x7F\x85\u2028\u2029 & 'Haus 日'");
    record().SetFileExtension(L"j/g");
    record().Images().Append(L"a000.jpg");
    record().Images().Append(L"\";b()//.jpg");
    save();
    for (const wchar_t* command : {L"_-Open \"", L"_-Import \""}) {
        record() = Record();
        front_end.clearPrinted();
        ASSERT_EQ(CQuarnCommand::success, run(command + file() + L"\""));
        EXPECT_EQ(L"__TITLE_"
                  L"_________"
                  L"_____"
                  L" & 'Haus 日'",
                  record().HtmlFilename());
        EXPECT_EQ(L"j_g", record().FileExtension());
        ASSERT_EQ(2, record().Images().Count());
        EXPECT_EQ(L"a000.jpg", record().Images()[0]);
        EXPECT_EQ(L"_;b()__.jpg", record().Images()[1]);
        EXPECT_EQ(2, record().FrameCount());
        const std::wstring said = printed();
        const std::wstring told = L"The animation of the file had names or dates with characters";
        EXPECT_THAT(said, HasSubstr(told));
        EXPECT_EQ(said.find(told), said.rfind(told)) << "told once";
    }
}

TEST_F(StoredDocument, LabelsLoseWhatEndsAStringOrAScriptAndNothingElse) {
    setUpSunFrames(5);
    const wchar_t* const stored[] = {L"2026-06-21 14:00:00", L"21/6/2026 | 2 o'clock * & more?",
                                     L"\";x();\"", L"</SCRIPT>\u2028\u2029\r\n", L"ends \\"};
    const wchar_t* const opened[] = {stored[0], stored[1], L"_;x();_", L"_/SCRIPT_____", L"ends _"};
    record().Dates().SetCount(0);
    for (const wchar_t* label : stored)
        record().Dates().Append(label);
    save();
    record() = Record();
    ASSERT_EQ(CQuarnCommand::success, open());
    ASSERT_EQ(5, record().Dates().Count());
    for (int i = 0; i < 5; ++i)
        EXPECT_EQ(opened[i], record().Dates()[i]);
}

TEST_F(StoredDocument, OurOwnStudyComesBackAsItWasWithoutAWord) {
    ASSERT_EQ(CQuarnCommand::success,
              run(L"_-SetOneDaySunAnimation 51 0 0 21 6 2026 6 0 8 0 30 _jpg "
                  L"_RenderedViewport Perspective _Enter"));
    const Record study(record());
    ASSERT_FALSE(record().Dates().IsEmpty());
    save();
    const std::string saved = readFile(folder / "a.quarn");
    front_end.clearPrinted();
    ASSERT_EQ(CQuarnCommand::success, open());
    EXPECT_THAT(printed(), Not(HasSubstr(L"stands in their place")));
    ASSERT_EQ(CQuarnCommand::success, run(L"_-Save"));
    EXPECT_EQ(saved, readFile(folder / "a.quarn"));
}

TEST_F(StoredDocument, ACleanedDocumentWantsNoSaving) {
    setUpCameraFrames(2);
    record().SetHtmlFilename(L"<b>");
    save();
    ASSERT_EQ(CQuarnCommand::success, open());
    EXPECT_EQ(L"_b_", record().HtmlFilename());
    EXPECT_FALSE(isModified(doc()));
}

TEST_F(StoredDocument, AViewNameThatNoLongerExistsIsTold) {
    setUpCameraFrames(3);
    record().SetViewportName(L"Gone");
    save();
    ASSERT_EQ(CQuarnCommand::success, open());
    EXPECT_NE(CQuarnCommand::success, run(L"_-PlayAnimation"));
    EXPECT_THAT(printed(), HasSubstr(L"Unable to find viewport to play animation"));
}

TEST_F(StoredDocument, AnImportedSunStudyNeverDeletesALightOfTheDocument) {
    setUpSunFrames(3);
    KM_Light lamp;
    lamp.SetStyle(KM_LightStyle::world_directional);
    lamp.SetDirection({0.0, 0.0, -1.0});
    doc().LightTable().AddLight(lamp, nullptr);
    record().SetLightIndex(doc().LightTable().AddLight(lamp, nullptr));
    save();

    // Here the first two lights are the document's own, so the study's index 1 would name one.
    ASSERT_EQ(CQuarnCommand::success, run(L"_-New"));
    doc().LightTable().AddLight(lamp, nullptr);
    doc().LightTable().AddLight(lamp, nullptr);
    ASSERT_EQ(CQuarnCommand::success, import());
    EXPECT_EQ(3, record().LightIndex()) << "behind two own lights and one that came along";
    ASSERT_EQ(CQuarnCommand::success, run(L"_-PlayAnimation"));
    for (const int own : {0, 1, 2})
        EXPECT_FALSE(doc().LightTable()[own].IsDeleted());
}

TEST_F(StoredDocument, ALightIndexIsNotMovedByAnImportThatBroughtNoRecord) {
    setUpSunFrames(3);
    save();
    changeSavedRecord(withInt(CAPTURE_TYPE, 17));
    record().SetLightIndex(2);
    ASSERT_EQ(CQuarnCommand::success, import());
    EXPECT_EQ(2, record().LightIndex());
}

TEST_F(StoredDocument, AnImportedIndexWithoutALightNamesNoneHere) {
    setUpSunFrames(3);
    record().SetLightIndex(7);
    save();
    ASSERT_EQ(CQuarnCommand::success, run(L"_-New"));
    ASSERT_EQ(CQuarnCommand::success, import());
    EXPECT_EQ(-1, record().LightIndex());
}
