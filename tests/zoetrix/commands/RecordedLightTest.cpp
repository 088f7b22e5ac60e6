// What recordings are lit by, and stand before.
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
    /// Adds a floor and a lamp over it, which is the first light.
    void importLamp() {
        writeFile(
            folder / "lamp.gltf",
            R"({"asset":{"version":"2.0"},"scenes":[{"nodes":[0,1]}],"scene":0,)"
            R"("extensionsUsed":["KHR_lights_punctual"],)"
            R"("extensions":{"KHR_lights_punctual":{"lights":[{"type":"point"}]}},)"
            R"("nodes":[{"mesh":0},{"translation":[0,2,1],)"
            R"("extensions":{"KHR_lights_punctual":{"light":0}}}],)"
            R"("meshes":[{"primitives":[{"attributes":{"POSITION":0}}]}],)"
            R"("accessors":[{"bufferView":0,"componentType":5126,"count":3,"type":"VEC3",)"
            R"("min":[-2,0,-2],"max":[2,0,2]}],)"
            R"("bufferViews":[{"buffer":0,"byteLength":36}],"buffers":[{"byteLength":36,)"
            R"("uri":"data:application/octet-stream;base64,AAAAwAAAAAAAAABAAAAAQAAAAAAAAABAAAAAAAAAAAAAAADA"}]})");
        ASSERT_EQ(run(L"Import \"" + wide(folder / "lamp.gltf") + L"\""), CQuarnCommand::success);
        ASSERT_EQ(doc().LightTable().LightCount(), 1);
        ASSERT_TRUE(doc().LightTable()[0].Light().IsEnabled());
    }
};

} // namespace

TEST_F(RecordedLight, LampsOfAModelShineInCameraAnimationsAndRestInSunStudies) {
    importLamp();
    const auto walk = recorded();
    setUpSunFrames(3);
    const auto study = recorded();
    EXPECT_FALSE(study[0].empty());
    ASSERT_EQ(run(L"SaveFrame 1 \"" + wide(folder / "one.png") + L"\""), CQuarnCommand::success);
    EXPECT_TRUE(readFile(folder / "one.png") == study[1]);
    ASSERT_TRUE(doc().LightTable().DeleteLight(0, true));
    EXPECT_TRUE(recorded() == study);
    setUpCameraFrames(3);
    EXPECT_FALSE(recorded()[0] == walk[0]);
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
         {L"Light Sky", L"Exposure 1", L"Background Colour black", L"Ground=No"}) {
        ASSERT_EQ(run(KM_wString(L"RenderSettings ") + settings + L" _Enter"),
                  CQuarnCommand::success);
        front_end.clearPrinted();
        EXPECT_NE(recordFrame(L"NextRecording _Resume 1-1 _Enter"), CQuarnCommand::success)
            << KM_wString(settings).ToUtf8();
        EXPECT_THAT(printed(), HasSubstr(L"was recorded before"));
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
        EXPECT_THAT(printed(),
                    HasSubstr(std::wstring(L"Pictures of the kind ") + kind + L" have no opacity"));
        EXPECT_THAT(printed(), HasSubstr(L"Choose png"));
        for (const std::string& name : files())
            EXPECT_FALSE(name.starts_with("Walk000")) << name;
    }
    record().SetFileExtension(L"png");
    ASSERT_EQ(recordAnimation(), CQuarnCommand::success) << printed();
    constexpr std::size_t COLOR_TYPE = 25;
    constexpr char WITH_OPACITY = 6;
    EXPECT_EQ(readFile(frames / "Walk000.png").at(COLOR_TYPE), WITH_OPACITY);
}
