#include "sdk/qncore/QnZoetrixDynamicAccess.h"
#include "tests/zoetrix/fixtures/SunFixture.h"
#include "zoetrix/plugin/ZoetrixUtilities.h"

#include <map>

using testing::HasSubstr;
using testing::Not;

namespace {

using Record = KM_3dmAnimationProperties;

/// A study that the command has set up, of four frames at the hours 9, 12, 15 and 18, shown and
/// recorded.
class SunStudyPlayback : public SunFixture {
protected:
    void SetUp() override {
        SunFixture::SetUp();
        importObj("v -9 -9 0\nv 9 -9 0\nv 9 9 0\nv -9 9 0\nv 1 2 8\nv 4 2 0\n"
                  "f 1 2 3 4\nf 1 5 6\n");
        placeCamera(L"Perspective", {20.0, -30.0, 25.0}, {0.0, 0.0, 1.0});
        ASSERT_EQ(CQuarnCommand::success, setUp(DayAnswers{.start_hour = L"9", .minutes = L"180"}));
        ASSERT_EQ(4, record().FrameCount());
        front_end.clearPrinted();
    }

    static KM_3dPoint sunOf(int frame) {
        return CZoetrixUtilities::GetSunPoint(9 + 3 * frame, 0, 2026, 6, 21, 0.0, 51.5, -0.12);
    }
    void switchSun(bool on) {
        doc().Sun().BeginChange(CQuarnSun::change_by_user);
        doc().Sun().SetEnabled(on);
        doc().Sun().EndChange();
        ASSERT_EQ(on, doc().Sun().IsEnabled());
    }
    std::vector<KM_Light> liveLights() {
        std::vector<KM_Light> lights;
        const CQuarnLightTable& table = doc().LightTable();
        for (int i = 0; i < table.LightCount(); ++i)
            if (!table[i].IsDeleted())
                lights.push_back(table[i].Light());
        return lights;
    }
    /// Watches that the frames that are shown from now on are lit by their own sun alone.
    void watchFrames();
    /// That nothing of the study is left in the document and its sun is as it was.
    void expectPutBack(bool sun_was_on);
    std::filesystem::path frameFile(const char* name) const {
        return folder.path() / "frames" / name;
    }
    bool isWritten(const char* name) const { return std::filesystem::exists(frameFile(name)); }

    std::map<int, int> watched; ///< how often a frame was seen lit, by its number
};

void SunStudyPlayback::watchFrames() {
    watched.clear();
    front_end.while_waiting = [this] {
        EXPECT_FALSE(doc().Sun().IsEnabled());
        const std::vector<KM_Light> lights = liveLights();
        if (lights.empty())
            return; // Before the first frame.
        ASSERT_EQ(1U, lights.size());
        int frame = 0;
        while (frame < 4 && sunOf(frame) != lights[0].Location())
            ++frame;
        EXPECT_LT(frame, 4) << "the sun of no frame";
        EXPECT_EQ(KM_LightStyle::world_directional, lights[0].Style());
        EXPECT_TRUE(near(lights[0].Direction(), KM_3dPoint::Origin - sunOf(frame), 0.0)) << frame;
        EXPECT_NEAR(lights[0].Direction().Length(), 1.0, 1e-15);
        ++watched[frame];
    };
}

void SunStudyPlayback::expectPutBack(bool sun_was_on) {
    front_end.while_waiting = nullptr;
    EXPECT_EQ(sun_was_on, doc().Sun().IsEnabled());
    EXPECT_TRUE(liveLights().empty());
    EXPECT_EQ(-1, record().LightIndex());
}

} // namespace

TEST_F(SunStudyPlayback, EachFrameIsLitByTheSunOfItsTimeAlone) {
    for (const bool sun_is_on : {true, false}) {
        switchSun(sun_is_on);
        const KM_UUID mode_before = view(L"Perspective").DisplayAttributes()->Id();
        watchFrames();
        ASSERT_EQ(CQuarnCommand::success, run(L"PlayAnimation"));
        EXPECT_EQ(4U, watched.size());
        EXPECT_EQ(3, record().CurrentFrame());
        EXPECT_EQ(mode_before, view(L"Perspective").DisplayAttributes()->Id());
        EXPECT_EQ(CQuarnDisplayAttrsMgr::RenderedModeId(), record().DisplayMode());
        expectPutBack(sun_is_on);
    }
}

TEST_F(SunStudyPlayback, ASingleFrameIsLitByItsSunAndLeavesNoLight) {
    switchSun(true);
    watchFrames();
    ASSERT_EQ(CQuarnCommand::success, run(L"ViewFrameNumber 2"));
    EXPECT_EQ(1U, watched.size());
    EXPECT_EQ(1U, watched.count(2));
    EXPECT_EQ(CQuarnDisplayAttrsMgr::RenderedModeId(),
              view(L"Perspective").DisplayAttributes()->Id());
    expectPutBack(true);
    watchFrames();
    ASSERT_EQ(CQuarnCommand::success, run(L"ViewNextFrame"));
    EXPECT_EQ(1U, watched.count(3));
    expectPutBack(true);
}

TEST_F(SunStudyPlayback, IsRecordedWithItsDatesOnThePage) {
    switchSun(true);
    watchFrames();
    ASSERT_EQ(CQuarnCommand::success, run(L"RecordAnimation _Enter"));
    EXPECT_EQ(4U, watched.size());
    expectPutBack(true);
    for (const char* name : {"Sun000.jpg", "Sun001.jpg", "Sun002.jpg", "Sun003.jpg"})
        EXPECT_TRUE(isJpeg(frameFile(name))) << name;
    EXPECT_NE(readFile(frameFile("Sun000.jpg")), readFile(frameFile("Sun003.jpg")));
    const std::string page = readFile(frameFile("Sun.html"));
    EXPECT_THAT(page, HasSubstr("var ImageCount = 4;"));
    EXPECT_THAT(page, HasSubstr("bDisplayDate = 1;"));
    EXPECT_THAT(page, HasSubstr("Dates[0] = \"2026-06-21 09:00:00\""));
    EXPECT_THAT(page, HasSubstr("Dates[3] = \"2026-06-21 18:00:00\""));
    EXPECT_THAT(page, Not(HasSubstr("Dates[4]")));
}

TEST_F(SunStudyPlayback, ARecordingThatStopsInTheMiddlePutsTheSunBack) {
    // A folder stands where the third frame would.
    std::filesystem::create_directories(frameFile("Sun002.jpg") / "in the way");
    switchSun(true);
    watchFrames();
    ASSERT_EQ(CQuarnCommand::success, run(L"RecordAnimation _Enter"));
    expectPutBack(true);
    EXPECT_TRUE(isWritten("Sun000.jpg"));
    EXPECT_TRUE(isWritten("Sun001.jpg"));
    EXPECT_FALSE(isWritten("Sun003.jpg"));
    EXPECT_THAT(readFile(frameFile("Sun.html")), HasSubstr("var ImageCount = 2;"));
    EXPECT_EQ(2, record().CurrentFrame());
}

TEST_F(SunStudyPlayback, OtherLightsOfTheDocumentShineOnAfterwards) {
    KM_Light lamp;
    lamp.SetStyle(KM_LightStyle::world_directional);
    lamp.SetDirection({1.0, 0.0, -1.0});
    doc().LightTable().AddLight(lamp, nullptr);
    ASSERT_EQ(CQuarnCommand::success, run(L"PlayAnimation"));
    ASSERT_EQ(1U, liveLights().size());
    EXPECT_TRUE(near(liveLights()[0].Direction(), KM_3dVector(1.0, 0.0, -1.0), 0.0));
}

TEST_F(SunStudyPlayback, NightFramesAreShownToo) {
    ASSERT_EQ(CQuarnCommand::success,
              setUp(DayAnswers{.start_hour = L"0", .end_hour = L"3", .minutes = L"60"}));
    for (const KM_3dPoint& sun : record().CameraPoints())
        ASSERT_LT(sun.z, 0.0);
    ASSERT_EQ(CQuarnCommand::success, run(L"RecordAnimation _Enter"));
    EXPECT_TRUE(isWritten("Sun003.jpg"));
}

TEST_F(SunStudyPlayback, AStudyWithoutFramesIsNeitherShownNorRecorded) {
    ASSERT_EQ(CQuarnCommand::success, setUp(DayAnswers{.day = L"31", .month = L"4"}));
    for (const wchar_t* line : {L"PlayAnimation", L"ViewFirstFrame", L"ViewNextFrame",
                                L"ViewFrameNumber 0", L"RecordAnimation _Enter"}) {
        EXPECT_EQ(CQuarnCommand::failure, run(line)) << KM_wString(line).ToUtf8();
    }
    EXPECT_FALSE(isWritten("Sun.html"));
}

TEST_F(SunStudyPlayback, OtherPlugInsGetTheSunOfEachFrame) {
    IQnZoetrixDynamicAccess& access = *Zoetrix_QuarnDynamicAccess();
    KM_Light light;
    KM_Viewport camera;
    for (int frame = 1; frame <= 4; ++frame) {
        ASSERT_TRUE(access.AnimatedSunAtFrame(doc(), record(), frame, light));
        EXPECT_EQ(KM_LightStyle::world_directional, light.Style());
        EXPECT_TRUE(near(light.Location(), sunOf(frame - 1), 0.0));
        EXPECT_TRUE(near(light.Direction(), KM_3dPoint::Origin - sunOf(frame - 1), 0.0));
        EXPECT_FALSE(access.AnimatedViewAtFrame(doc(), record(), frame, camera));
    }
    const KM_Light last = light;
    for (const int frame : {0, -1, 5})
        EXPECT_FALSE(access.AnimatedSunAtFrame(doc(), record(), frame, light));
    record().SetViewportName(L" ");
    EXPECT_FALSE(access.AnimatedSunAtFrame(doc(), record(), 1, light));
    record().SetViewportName(L"Nowhere");
    EXPECT_FALSE(access.AnimatedSunAtFrame(doc(), record(), 1, light));
    EXPECT_TRUE(last == light);
}

TEST_F(SunStudyPlayback, ASeasonIsLitTheSameWay) {
    ASSERT_EQ(CQuarnCommand::success, setUp(SeasonAnswers{.days = L"100"}));
    ASSERT_EQ(3, record().FrameCount());
    KM_Light light;
    ASSERT_TRUE(Zoetrix_QuarnDynamicAccess()->AnimatedSunAtFrame(doc(), record(), 2, light));
    // 21 March and 100 days are 29 June.
    EXPECT_TRUE(near(light.Location(),
                     CZoetrixUtilities::GetSunPoint(14, 30, 2026, 6, 29, 0.0, 51.5, 0.12), 0.0));
    ASSERT_EQ(CQuarnCommand::success, run(L"RecordAnimation _Enter"));
    EXPECT_THAT(readFile(frameFile("Sun.html")), HasSubstr("Dates[1] = \"2026-06-29 14:30:00\""));
}

TEST_F(SunStudyPlayback, AStoredStudyIsRecordedTheSameAfterItWasOpened) {
    ASSERT_EQ(CQuarnCommand::success, run(L"RecordAnimation _Enter"));
    std::vector<std::string> before;
    const char* const names[] = {"Sun000.jpg", "Sun001.jpg", "Sun002.jpg", "Sun003.jpg",
                                 "Sun.html"};
    for (const char* name : names) {
        before.push_back(readFile(frameFile(name)));
        EXPECT_FALSE(before.back().empty()) << name;
    }
    const std::vector<std::wstring> dates_before = dates();
    const KM_wString file = wide(folder / "study.quarn");
    ASSERT_EQ(CQuarnCommand::success, run(L"_-SaveAs \"" + file + L"\""));
    ASSERT_EQ(CQuarnCommand::success, run(L"_-New"));
    ASSERT_EQ(Record::none, record().CaptureType());
    std::filesystem::remove_all(folder.path() / "frames");

    ASSERT_EQ(CQuarnCommand::success, run(L"_-Open \"" + file + L"\""));
    EXPECT_EQ(Record::one_day_sun, record().CaptureType());
    EXPECT_EQ(dates_before, dates());
    expectFrames({{2026, 6, 21, 9}, {2026, 6, 21, 12}, {2026, 6, 21, 15}, {2026, 6, 21, 18}}, 0.0,
                 51.5, -0.12);
    EXPECT_EQ(51.5, record().Latitude());
    EXPECT_EQ(-0.12, record().Longitude());
    ASSERT_EQ(CQuarnCommand::success, run(L"RecordAnimation _Enter"));
    for (std::size_t k = 0; k < std::size(names); ++k)
        EXPECT_TRUE(before[k] == readFile(frameFile(names[k]))) << names[k];
}
