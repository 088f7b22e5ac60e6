#include "tests/zoetrix/fixtures/RecordingFixture.h"

#include <limits>
#include <string>
#include <vector>

using testing::HasSubstr;

namespace {

/// Frames that are written one by one are those of a whole recording, and nothing but the file
/// comes of it.
class SaveFrame : public RecordingFixture {
protected:
    std::filesystem::path file(const char* name = "one.png") const { return folder.path() / name; }

    CQuarnCommand::result save(const KM_wString& words, const std::filesystem::path& to) {
        return run(L"SaveFrame " + words + L" \"" + wide(to) + L"\"");
    }
    void recordAll(const wchar_t* extension) {
        record().SetFileExtension(extension);
        answer({L"_Enter"});
        ASSERT_EQ(CQuarnCommand::success, run(L"RecordAnimation"));
    }
    /// Records all three frames and compares each with the one that is written alone.
    void expectSameFiles(const char* extension, const KM_wString& size = L"") {
        recordAll(KM_wString::FromUtf8(extension));
        for (int frame = 0; frame < 3; ++frame)
            expectSameFile(frame, extension, size);
    }
    void expectSameFile(int frame, const char* extension, const KM_wString& size) {
        const std::filesystem::path alone = file("alone").replace_extension(extension);
        ASSERT_EQ(CQuarnCommand::success,
                  save(size + KM_wString::FormatToString(L"%d", frame), alone));
        const std::string name = "Walk00" + std::to_string(frame) + "." + extension;
        const std::string recorded = readFile(frames / name);
        ASSERT_FALSE(recorded.empty()) << name;
        EXPECT_TRUE(readFile(alone) == recorded) << name;
    }
    void expectRefused(const KM_wString& words, const wchar_t* reason) {
        front_end.clearPrinted();
        EXPECT_NE(CQuarnCommand::success, save(words, file()));
        EXPECT_THAT(printed(), HasSubstr(reason));
        EXPECT_FALSE(std::filesystem::exists(file()));
    }
    void switchSun(bool on) {
        doc().Sun().BeginChange(CQuarnSun::change_by_user);
        doc().Sun().SetEnabled(on);
        doc().Sun().EndChange();
    }
    int addLight(const KM_3dVector& direction) {
        KM_Light light;
        light.SetStyle(KM_LightStyle::world_directional);
        light.SetDirection(direction);
        return doc().LightTable().AddLight(light, nullptr);
    }
    /// A sun study whose three frames look different.
    void setUpThreeSuns() {
        placeCamera(L"Perspective", {3.0, -5.0, 3.0}, {0.0, 0.0, 0.5});
        setUpSunFrames(3);
        for (int k = 0; k < 3; ++k)
            record().CameraPoints()[k] = KM_3dPoint(0.6 - 0.6 * k, 0.3, 0.8);
    }
    /// Curves in the picture that the camera follows.
    void followBothRails() {
        importObj("v -4 -6 2\nv 4 -6 3\nv 4 4 1\nv 2 -5 2\nv 2 -3 4\n"
                  "o rail\nl 1 2 3\no gaze\nl 4 5\n");
        record().SetCaptureType(KM_3dmAnimationProperties::path);
        record().SetCameraPathId(objectId(L"rail"));
        record().SetTargetPathId(objectId(L"gaze"));
    }
};

} // namespace

TEST_F(SaveFrame, IsTheRecordedFileOfThatFrame) {
    expectSameFiles("png");
    EXPECT_NE(readFile(frames / "Walk000.png"), readFile(frames / "Walk002.png"));
    expectSameFiles("jpg");
}

TEST_F(SaveFrame, AnAnimationWithoutModeIsWireframe) {
    record().SetDisplayMode(KM_nil_uuid);
    expectSameFiles("png");
}

TEST_F(SaveFrame, IsDrawnInTheAnimationsModeAndNotInTheViews) {
    ASSERT_TRUE(view(L"Perspective")
                    .MainViewport()
                    .SetDisplayMode(CQuarnDisplayAttrsMgr::WireframeModeId()));
    expectSameFiles("png");
}

TEST_F(SaveFrame, AModeThatTheHostDoesNotKnowIsTheViewsOwn) {
    record().SetDisplayMode(KM_CreateUuid());
    expectSameFiles("png");
}

TEST_F(SaveFrame, IsTheRecordedFileInAParallelView) {
    record().SetViewportName(L"Front");
    expectSameFiles("png");
}

TEST_F(SaveFrame, IsTheRecordedFileOfACameraThatLooksStraightDown) {
    for (const wchar_t* name : {L"Top", L"Perspective"}) {
        record().SetViewportName(name);
        for (int k = 0; k < 3; ++k) {
            record().CameraPoints()[k] = KM_3dPoint(0.5 * k, 0.2, 9.0);
            record().TargetPoints()[k] = KM_3dPoint(0.5 * k, 0.2, 0.0);
        }
        expectSameFiles("png");
    }
}

TEST_F(SaveFrame, ARolledViewKeepsItsRollWhileARecordingLevelsIt) {
    expectSameFiles("png");
    const std::string level = readFile(frames / "Walk001.png");
    CQuarnViewport& viewport = view(L"Perspective").MainViewport();
    KM_Viewport rolled = viewport.VP();
    ASSERT_TRUE(rolled.SetCameraUp(rolled.CameraY() + rolled.CameraX()));
    ASSERT_TRUE(viewport.SetVP(rolled, true, true));
    recordAll(L"png");
    EXPECT_TRUE(readFile(frames / "Walk001.png") == level);
    ASSERT_EQ(CQuarnCommand::success, save(L"1", file()));
    EXPECT_FALSE(readFile(file()) == level);
}

TEST_F(SaveFrame, CurvesThatTheCameraFollowsAreNotInThePicture) {
    followBothRails();
    expectSameFiles("png");
    const std::string followed = readFile(file("alone.png"));
    EXPECT_FALSE(isHidden(L"rail"));
    EXPECT_FALSE(isHidden(L"gaze"));
    // With the curves hidden by hand it is the same picture: they are left out indeed.
    for (const wchar_t* name : {L"rail", L"gaze"})
        doc().HideObject(CQuarnObjRef(objectId(name)), false);
    ASSERT_EQ(CQuarnCommand::success, save(L"2", file()));
    EXPECT_TRUE(readFile(file()) == followed);
}

TEST_F(SaveFrame, OtherCurvesAreInThePicture) {
    followBothRails();
    record().SetCaptureType(KM_3dmAnimationProperties::flythrough);
    expectSameFiles("png");
    ASSERT_EQ(CQuarnCommand::success, save(L"0", file()));
    const std::string with_gaze = readFile(file());
    doc().HideObject(CQuarnObjRef(objectId(L"gaze")), false);
    ASSERT_EQ(CQuarnCommand::success, save(L"0", file()));
    EXPECT_FALSE(readFile(file()) == with_gaze);
}

TEST_F(SaveFrame, SunStudyIsLitByItsOwnSunAlone) {
    for (const bool sun_is_on : {true, false}) {
        setUpThreeSuns();
        switchSun(sun_is_on);
        expectSameFiles("png");
        EXPECT_NE(readFile(frames / "Walk000.png"), readFile(frames / "Walk002.png"));
        EXPECT_EQ(sun_is_on, doc().Sun().IsEnabled());
    }
}

TEST_F(SaveFrame, SunStudyKeepsTheLightsOfTheDocument) {
    addLight({1.0, 1.0, -0.2});
    setUpThreeSuns();
    record().SetCaptureType(KM_3dmAnimationProperties::seasonal_sun);
    expectSameFiles("png");
    EXPECT_FALSE(doc().LightTable()[0].IsDeleted());
}

TEST_F(SaveFrame, TheLightThatTheAnimationLeftIsReplaced) {
    setUpThreeSuns();
    const int left = addLight({1.0, 1.0, -0.2});
    record().SetLightIndex(left);
    ASSERT_EQ(CQuarnCommand::success, save(L"1", file("alone.png")));
    EXPECT_FALSE(doc().LightTable()[left].IsDeleted());
    EXPECT_EQ(left, record().LightIndex());
    recordAll(L"png");
    EXPECT_TRUE(readFile(file("alone.png")) == readFile(frames / "Walk001.png"));
}

TEST_F(SaveFrame, ASunThatCannotShineLeavesTheModelUnlit) {
    setUpThreeSuns();
    record().CameraPoints()[1] = KM_3dPoint::Origin;
    expectSameFiles("png");
}

TEST_F(SaveFrame, AnotherSizeIsWhatAViewOfThatSizeRecords) {
    ASSERT_EQ(CQuarnCommand::success, save(L"Size 40 50 1", file()));
    ASSERT_EQ(CQuarnCommand::success, run(L"ViewportSize 40 50"));
    recordAll(L"png");
    EXPECT_TRUE(readFile(file()) == readFile(frames / "Walk001.png"));
}

TEST_F(SaveFrame, NothingOfTheDocumentChanges) {
    followBothRails();
    record().SetCurrentFrame(1);
    record().SetFileExtension(L".jpg");
    record().SetDisplayMode(KM_nil_uuid);
    const KM_Viewport camera = view(L"Perspective").MainViewport().VP();
    const KM_UUID mode = view(L"Perspective").DisplayAttributes()->Id();
    ASSERT_EQ(CQuarnCommand::success, save(L"Size 20 10 2", file()));
    EXPECT_TRUE(camera == view(L"Perspective").MainViewport().VP());
    EXPECT_EQ(mode, view(L"Perspective").DisplayAttributes()->Id());
    EXPECT_EQ(64, view(L"Perspective").MainViewport().DisplayPipeline()->FrameWidth());
    EXPECT_EQ(1, record().CurrentFrame());
    EXPECT_EQ(L".jpg", record().FileExtension().View());
    EXPECT_TRUE(KM_UuidIsNil(record().DisplayMode()));
    EXPECT_TRUE(near(record().CameraPoints()[1], cameraOfFrame(1), 0.0));
    EXPECT_EQ(0, record().Images().Count());

    setUpThreeSuns();
    ASSERT_EQ(CQuarnCommand::success, save(L"2", file()));
    EXPECT_EQ(0, doc().LightTable().LightCount());
    EXPECT_EQ(-1, record().LightIndex());
    EXPECT_TRUE(doc().Sun().IsEnabled());
    EXPECT_EQ(mode, view(L"Perspective").DisplayAttributes()->Id());
}

TEST_F(SaveFrame, EnterTakesTheFrameShownLast) {
    record().SetCurrentFrame(2);
    ASSERT_EQ(CQuarnCommand::success, save(L"_Enter", file("last.png")));
    ASSERT_EQ(CQuarnCommand::success, save(L"2", file()));
    EXPECT_TRUE(readFile(file()) == readFile(file("last.png")));
}

TEST_F(SaveFrame, AStoredFrameOutOfRangeIsNotOfferedOnEnter) {
    for (const int stored :
         {3, -1, std::numeric_limits<int>::max(), std::numeric_limits<int>::min()}) {
        record().SetCurrentFrame(stored);
        answer({L"_Cancel"});
        EXPECT_EQ(CQuarnCommand::cancel, run(L"SaveFrame"));
        EXPECT_EQ(L"0", front_end.questions().back().default_answer->View());
    }
}

TEST_F(SaveFrame, FramesOutsideTheAnimationAreRefused) {
    for (const wchar_t* frame : {L"3", L"-1", L"2147483647", L"-2147483648"})
        expectRefused(frame, L"Enter a number from 0 to 2");
    for (const wchar_t* text : {L"1.5", L"2147483648", L"one"})
        expectRefused(text, L"Enter a whole number from 0 to 2");
}

TEST_F(SaveFrame, SizesOutOfRangeAreRefused) {
    for (const wchar_t* size : {L"Size 0 10", L"Size 10 0", L"Size 16385 10", L"Size 10 -4"})
        expectRefused(KM_wString(size) + L" 1", L"Enter a number from 1 to 16384");
}

TEST_F(SaveFrame, WithoutAnimationThereIsNoFrame) {
    constexpr const wchar_t* reason = L"The document has no animation.";
    record().SetFrameCount(0);
    expectRefused(L"0", reason);
    setUpCameraFrames(3);
    record().CameraPoints().SetCount(2);
    expectRefused(L"0", reason);
    setUpCameraFrames(3);
    record().TargetPoints().Append(KM_3dPoint::Origin);
    expectRefused(L"0", reason);
    setUpCameraFrames(3);
    record().SetFrameCount(std::numeric_limits<int>::max());
    expectRefused(L"0", reason);
    record().SetFrameCount(std::numeric_limits<int>::min());
    expectRefused(L"0", reason);
    EXPECT_TRUE(front_end.questions().empty());
}

TEST_F(SaveFrame, AViewThatIsGoneIsNamed) {
    record().SetViewportName(L" Back ");
    expectRefused(L"0", L"The animation was made for the view \"Back\", which the document does "
                        L"not have.");
    record().SetViewportName(L" \t");
    expectRefused(L"0", L"The animation names no view.");
}

TEST_F(SaveFrame, RenderedAnimationsAreRendered) {
    ASSERT_EQ(CQuarnCommand::success,
              run(L"RenderSettings Size 32 24 Samples 4 PreviewSamples 1 _Enter"));
    record().SetRenderFull(true);
    ASSERT_EQ(CQuarnCommand::success, save(L"0", file()));
    const std::string full = readFile(file());
    record().SetRenderFull(false);
    record().SetRenderPreview(true);
    ASSERT_EQ(CQuarnCommand::success, save(L"0", file()));
    EXPECT_NE(full, readFile(file())) << "of fewer samples";
}

TEST_F(SaveFrame, ACameraInItsTargetIsTold) {
    record().TargetPoints()[1] = record().CameraPoints()[1];
    expectRefused(L"1", L"The camera of frame 1 cannot be placed");
    EXPECT_EQ(CQuarnCommand::success, save(L"0", file()));
}

TEST_F(SaveFrame, FilesThatCannotBeWrittenAreRefusedBeforeDrawing) {
    EXPECT_EQ(CQuarnCommand::failure, save(L"0", file("one.gif")));
    EXPECT_THAT(printed(), HasSubstr(L"no image format has this extension"));
    EXPECT_EQ(CQuarnCommand::failure, save(L"0", file("one")));
    front_end.clearPrinted();
    EXPECT_EQ(CQuarnCommand::failure, save(L"0", folder.path() / "nowhere" / "one.png"));
    EXPECT_THAT(printed(), HasSubstr(L"there is no folder " +
                                     std::wstring(wide(folder.path() / "nowhere").View())));
    EXPECT_FALSE(std::filesystem::exists(folder.path() / "nowhere"));
}

TEST_F(SaveFrame, AFileThatIsAFolderIsToldAndStays) {
    std::filesystem::create_directory(file());
    front_end.clearPrinted();
    EXPECT_EQ(CQuarnCommand::failure, save(L"0", file()));
    EXPECT_THAT(printed(), HasSubstr(std::wstring(wide(file()).View())));
    EXPECT_TRUE(std::filesystem::is_directory(file()));
}

TEST_F(SaveFrame, ACaptureTypeOutOfRangeIsACameraAnimation) {
    record().SetCaptureType(static_cast<KM_3dmAnimationProperties::CaptureTypes>(17));
    expectSameFiles("png");
}

TEST_F(SaveFrame, AReopenedDocumentGivesTheSameFilesAndPoints) {
    followBothRails();
    expectSameFiles("png");
    const std::vector<std::string> recorded{readFile(frames / "Walk000.png"),
                                            readFile(frames / "Walk001.png"),
                                            readFile(frames / "Walk002.png")};
    const KM_3dPointArray cameras = record().CameraPoints();
    const KM_3dPointArray targets = record().TargetPoints();
    const std::filesystem::path document = folder.path() / "walk.quarn";
    ASSERT_EQ(CQuarnCommand::success, run(L"SaveAs \"" + wide(document) + L"\""));
    ASSERT_EQ(CQuarnCommand::success, run(L"New"));
    EXPECT_EQ(0, record().CameraPoints().Count());
    ASSERT_EQ(CQuarnCommand::success, run(L"Open \"" + wide(document) + L"\""));

    ASSERT_EQ(3, record().CameraPoints().Count());
    ASSERT_EQ(3, record().TargetPoints().Count());
    for (int k = 0; k < 3; ++k) {
        EXPECT_TRUE(near(record().CameraPoints()[k], cameras[k], 0.0)) << k;
        EXPECT_TRUE(near(record().TargetPoints()[k], targets[k], 0.0)) << k;
        ASSERT_EQ(CQuarnCommand::success, save(KM_wString::FormatToString(L"%d", k), file()));
        EXPECT_TRUE(readFile(file()) == recorded[static_cast<std::size_t>(k)]) << k;
    }
    recordAll(L"png");
    EXPECT_TRUE(readFile(frames / "Walk001.png") == recorded[1]);
}

TEST_F(SaveFrame, AReopenedSunStudyGivesTheSameFiles) {
    addLight({1.0, 1.0, -0.2});
    setUpThreeSuns();
    expectSameFiles("png");
    const std::string recorded = readFile(frames / "Walk001.png");
    const std::filesystem::path document = folder.path() / "suns.quarn";
    ASSERT_EQ(CQuarnCommand::success, run(L"SaveAs \"" + wide(document) + L"\""));
    ASSERT_EQ(CQuarnCommand::success, run(L"New"));
    EXPECT_EQ(-1, record().LightIndex());
    ASSERT_EQ(CQuarnCommand::success, run(L"Open \"" + wide(document) + L"\""));
    ASSERT_EQ(CQuarnCommand::success, save(L"1", file()));
    EXPECT_TRUE(readFile(file()) == recorded);
    ASSERT_EQ(CQuarnCommand::success, run(L"PlayAnimation"));
    EXPECT_FALSE(doc().LightTable()[0].IsDeleted());
    EXPECT_EQ(-1, record().LightIndex());
}

TEST_F(SaveFrame, AStoredLightIndexIsNotCarriedIntoANewDocument) {
    setUpThreeSuns();
    record().SetLightIndex(0);
    ASSERT_EQ(CQuarnCommand::success, run(L"New"));
    const int lamp = addLight({1.0, 1.0, -0.2});
    ASSERT_EQ(0, lamp);
    const int no_light = record().LightIndex();
    setUpThreeSuns();
    EXPECT_EQ(-1, no_light);
    ASSERT_EQ(CQuarnCommand::success, run(L"PlayAnimation"));
    EXPECT_FALSE(doc().LightTable()[lamp].IsDeleted());
}
