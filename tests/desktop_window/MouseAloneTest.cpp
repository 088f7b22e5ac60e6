#include "tests/desktop_window/HouseDesk.h"
#include "tests/desktop_window/driver/ReferencePicture.h"
#include "tests/quarn/Pictures.h"

#include <QRegularExpression>

#include <algorithm>
#include <gtest/gtest.h>

namespace quarn::test {

namespace {

/// Plays the animation to its end and sees the slider move.
void play(Desk& desk, int last_frame) {
    desk.click("play");
    desk.lookUntil("a frame in the middle", [&](const Windows& seen) {
        const SeenWidget* const number = seen.widget("frameNumber");
        return number && number->value > 0 && number->value < last_frame;
    });
    const Windows ended = desk.waitUntilIdle();
    EXPECT_EQ(ended.widget("frameNumber")->value, last_frame);
}

/// Records into the folder that the folder chooser offers.
void record(Desk& desk) {
    desk.click("record");
    desk.click("option_TargetFolder");
    desk.clickButton("Choose");
    desk.click("promptOk");
    desk.waitUntilIdle();
}

std::vector<std::string> frameNames(const std::string& name, const std::string& type, int count) {
    std::vector<std::string> names = {name + ".frames.json", name + ".html", name + ".recording"};
    for (int frame = 0; frame < count; ++frame) {
        const std::string number = std::to_string(frame);
        names.push_back(name + std::string(3 - number.size(), '0') + number + '.' + type);
    }
    std::ranges::sort(names);
    return names;
}

void expectRecording(const std::filesystem::path& folder, const std::string& type, int count,
                     QSize size_px) {
    EXPECT_EQ(filesIn(folder), frameNames(folder.filename(), type, count));
    for (const std::string& name : filesIn(folder)) {
        if (name.ends_with(".json") || name.ends_with(".html") || name.ends_with(".recording"))
            continue;
        const std::optional<PictureHeader> header = readPictureHeader(folder / name);
        ASSERT_TRUE(header) << name;
        EXPECT_EQ(header->format, type) << name;
        EXPECT_EQ(header->width_px, size_px.width()) << name;
        EXPECT_EQ(header->height_px, size_px.height()) << name;
    }
}

/// "638 × 305", as it stands beside the Record button.
QSize toldFrameSize(Desk& desk) {
    const QRegularExpressionMatch told =
        QRegularExpression("(\\d+) × (\\d+)").match(desk.widget("frameSize").text);
    return {told.captured(1).toInt(), told.captured(2).toInt()};
}

QImage frame(const Desk& desk, int number) {
    return QImage(QString("%1/Animation/Animation%2.jpg")
                      .arg(QString::fromStdString(desk.documents()))
                      .arg(number, 3, 10, QChar('0')));
}

/// Where a place is on a map of the whole earth.
QPoint onMap(const QRect& map, double latitude_deg, double longitude_deg) {
    const double pixels_per_degree = map.width() / 360.0;
    return map.topLeft() + QPoint(qRound((longitude_deg + 180.0) * pixels_per_degree),
                                  qRound((90.0 - latitude_deg) * pixels_per_degree));
}

void openPage(Desk& desk, const std::filesystem::path& page) {
    desk.click("openPageButton");
    desk.lookUntil("the opener called",
                   [&](const Windows&) { return !desk.openedFiles().empty(); });
    EXPECT_EQ(desk.openedFiles(), page.string() + '\n');
    desk.waitUntilIdle();
}

/// Makes the page for others of the folder that the chooser begins at, and looks where it is.
void sharePage(Desk& desk, const std::filesystem::path& folder) {
    const std::string opened = desk.openedFiles();
    desk.chooseInMenu("command_ViewerPage");
    desk.clickButton("Choose");
    desk.click("promptOk");
    desk.waitUntilIdle();
    EXPECT_TRUE(std::filesystem::exists(folder / (folder.filename().string() + "-viewer.html")));
    desk.click("showInFolder");
    desk.lookUntil("the opener called",
                   [&](const Windows&) { return desk.openedFiles() != opened; });
    EXPECT_EQ(desk.openedFiles(), opened + folder.string() + '\n');
    desk.waitUntilIdle();
}

TEST(MouseAlone, ATurntableIsSetUpPlayedRecordedAndItsPagesAreOpenedAndShared) {
    HouseDesk desk;
    desk.start();
    desk.openHouse();

    desk.chooseInMenu("command_SetTurntableAnimation");
    desk.choose("direction", "AntiClockwise");
    desk.choose("fileType", "png");
    desk.choose("captureMethod", "RenderedViewport");
    desk.stepTo("frames", 96);
    EXPECT_EQ(desk.widget("viewport").text, "Perspective");
    EXPECT_EQ(compareWithReference(desk.stillPicture(), "turntable-form"), "");
    desk.click("ok");
    desk.waitUntilIdle();

    play(desk, 95);
    EXPECT_EQ(compareWithReference(desk.stillPicture(), "turntable-played"), "");
    record(desk);
    expectRecording(desk.documents() / "Animation", "png", 96, toldFrameSize(desk));
    openPage(desk, desk.documents() / "Animation" / "Animation.html");
    sharePage(desk, desk.documents() / "Animation");
}

/// The place is Athens, whose coordinates the table of cities has.
TEST(MouseAlone, ADayOfSunAtAPlaceOfTheMapIsSetUpPlayedAndRecorded) {
    HouseDesk desk;
    desk.start();
    desk.openHouse();

    desk.chooseInMenu("command_SetOneDaySunAnimation");
    desk.choose("namedDay", "Longest day");
    desk.click("choosePlace");
    desk.display().click(onMap(desk.widget("map").place, 37.98, 23.73));
    desk.waitForText("latitude", "37.98");
    desk.waitForText("longitude", "23.73");
    EXPECT_EQ(compareWithReference(desk.stillPicture(), "place-picker"), "");
    desk.click("ok");
    desk.waitUntilGone("map");
    desk.waitForText("latitude", "37.98");
    desk.waitForText("longitude", "23.73");
    EXPECT_EQ(desk.widget("captureMethod").text, "RenderedViewport");
    EXPECT_EQ(desk.widget("viewport").text, "Perspective");
    desk.stepTo("minutes", 60);
    desk.click("ok");
    desk.waitUntilIdle();

    // On the hour, while the sun is up: from seven to eight in the evening by the clocks there.
    play(desk, 13);
    EXPECT_TRUE(desk.widget("frameDate").text.contains("20:00 EEST"));
    record(desk);
    expectRecording(desk.documents() / "Animation", "jpg", 14, toldFrameSize(desk));
    const QImage morning = frame(desk, 0);
    const QImage noon = frame(desk, 7);
    EXPECT_GT(differenceOf(morning, noon).differing_share, 0.02) << "no shadow has moved";
    openPage(desk, desk.documents() / "Animation" / "Animation.html");
}

TEST(MouseAlone, HoursOfSunAndASunPathDiagramAreMadeAndOpenedFromTheMenu) {
    HouseDesk desk;
    desk.start();
    desk.openHouse();

    desk.chooseInMenu("sunHours");
    desk.choose("namedDay", "Equinox in March");
    desk.click("ok");
    desk.waitUntilIdle();
    const std::filesystem::path plan = desk.documents() / "model-sunhours.png";
    const std::optional<PictureHeader> header = readPictureHeader(plan);
    ASSERT_TRUE(header);
    EXPECT_GE(header->width_px, 1280);
    desk.click("sharedFilePicture");
    desk.lookUntil("the opener called",
                   [&](const Windows&) { return !desk.openedFiles().empty(); });
    EXPECT_EQ(desk.openedFiles(), plan.string() + '\n');
    desk.waitUntilIdle();

    desk.chooseInMenu("sunPath");
    desk.choose("projection", "Both, side by side");
    desk.click("ok");
    desk.waitUntilIdle();
    const std::filesystem::path diagram = desk.documents() / "model-sunpath.svg";
    EXPECT_NE(readFile(diagram).find("orthographic-hour-12"), std::string::npos);
}

/// References are worth something only where another window is told from them.
TEST(MouseAlone, AnotherWindowIsToldFromTheReferences) {
    Desk desk;
    desk.start();
    const QImage empty = desk.stillPicture();
    for (const char* const name : {"turntable-form", "turntable-played", "place-picker"})
        EXPECT_NE(compareWithReference(empty, name), "") << name;
}

} // namespace

} // namespace quarn::test
