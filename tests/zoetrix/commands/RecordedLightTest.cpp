// What recordings are lit by, and stand before.
#include "host/document/Document.h"
#include "host/share/frames/FramePicture.h"
#include "tests/zoetrix/fixtures/RecordingFixture.h"

#include <array>

using testing::HasSubstr;

namespace {

class RecordedLight : public RecordingFixture {
protected:
    CQuarnCommand::result recordAnimation() {
        answer({L"_Enter"});
        return run(L"RecordAnimation");
    }
    CQuarnCommand::result recordFrame(const wchar_t* choice) {
        std::filesystem::create_directory(frames);
        return run(choice) == CQuarnCommand::success ? recordAnimation() : CQuarnCommand::failure;
    }
    /// The bytes of the frames, recorded anew.
    std::array<std::string, 3> recorded() {
        record().SetFileExtension(L"png");
        EXPECT_EQ(recordAnimation(), CQuarnCommand::success) << printed();
        std::array<std::string, 3> pictures;
        for (std::size_t k = 0; k < pictures.size(); ++k)
            pictures[k] = readFile(frames / ("Walk00" + std::to_string(k) + ".png"));
        std::filesystem::remove_all(frames);
        return pictures;
    }
    void addLampOfModel() {
        KM_Light lamp;
        lamp.SetStyle(KM_LightStyle::world_point);
        lamp.SetLocation({0.0, -2.0, 2.0});
        quarn::Document::of(doc()).lights().add(lamp);
    }
};

} // namespace

TEST_F(RecordedLight, LampsOfAModelShineInCameraAnimationsAndRestInSunStudies) {
    const auto without_lamp = recorded();
    addLampOfModel();
    const auto with_lamp = recorded();
    EXPECT_FALSE(with_lamp[0].empty());
    EXPECT_NE(with_lamp[0], without_lamp[0]);
    setUpSunFrames(3);
    const auto study = recorded();
    EXPECT_FALSE(study[0].empty());
    ASSERT_EQ(run(L"SaveFrame 1 \"" + wide(folder / "one.png") + L"\""), CQuarnCommand::success);
    EXPECT_EQ(readFile(folder / "one.png"), study[1]);
    quarn::Document::of(doc()).lights().remove(0);
    EXPECT_TRUE(recorded() == study);
}

TEST_F(RecordedLight, ASunStudyIsRecordedUnderTheSkyAsItsSingleFramesAre) {
    setUpSunFrames(3);
    const auto automatic = recorded();
    ASSERT_EQ(run(L"RenderSettings Light Sky _Enter"), CQuarnCommand::success);
    EXPECT_TRUE(recorded() == automatic);
    ASSERT_EQ(run(L"RenderSettings Light Studio _Enter"), CQuarnCommand::success);
    EXPECT_FALSE(recorded() == automatic);
}

TEST_F(RecordedLight, ARecordingIsNotGoneOnWithInAnotherLight) {
    ASSERT_EQ(recordFrame(L"NextRecording _Anew 0-0 _Enter"), CQuarnCommand::success);
    for (const wchar_t* settings :
         {L"Light Studio", L"Exposure 1", L"Background Colour black", L"Ground=No"}) {
        ASSERT_EQ(run(KM_wString(L"RenderSettings ") + settings + L" _Enter"),
                  CQuarnCommand::success);
        EXPECT_NE(recordFrame(L"NextRecording _Resume 1-1 _Enter"), CQuarnCommand::success)
            << KM_wString(settings).ToUtf8();
        EXPECT_THAT(printed(), HasSubstr("settings"));
        ASSERT_EQ(run(L"RenderSettings Light Automatic Exposure Automatic Background Colour white "
                      L"Background Automatic Ground=Yes _Enter"),
                  CQuarnCommand::success);
    }
    EXPECT_EQ(recordFrame(L"NextRecording _Resume 1-1 _Enter"), CQuarnCommand::success)
        << printed();
}

TEST_F(RecordedLight, TransparentFramesArePngWithOpacityAndJpgOrBmpNone) {
    ASSERT_EQ(run(L"RenderSettings Background Transparent Ground=No _Enter"),
              CQuarnCommand::success);
    for (const wchar_t* kind : {L"jpg", L"bmp"}) {
        record().SetFileExtension(kind);
        front_end.clearPrinted();
        EXPECT_NE(recordAnimation(), CQuarnCommand::success);
        EXPECT_THAT(printed(), HasSubstr("Pictures of the kind " + KM_wString(kind).ToUtf8() +
                                         " have no opacity"));
        EXPECT_THAT(printed(), HasSubstr("Choose png"));
        for (const std::string& name : files())
            EXPECT_FALSE(name.starts_with("Walk000")) << name;
    }
    record().SetFileExtension(L"png");
    ASSERT_EQ(recordAnimation(), CQuarnCommand::success) << printed();
    const auto frame = quarn::readFramePicture(frames / "Walk000.png");
    ASSERT_TRUE(frame) << frame.message();
    EXPECT_EQ(frame.value().pixel(0, 0)[3], 0);
    EXPECT_EQ(frame.value().pixel(32, 24)[3], 255);
}
