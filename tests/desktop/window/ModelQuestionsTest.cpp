// What the window asks of a model that was read, and what its file states.
#include "tests/desktop/dialogs/DialogDriver.h"
#include "tests/desktop/window/WindowFixture.h"

#include <QLineEdit>

namespace quarn::desktop::test {
namespace {

class ModelQuestionsTest : public WindowTest {
protected:
    /// A wall, 4 wide, 3 high along its y and 1 thick along its z.
    QString wall(const char* name) {
        quarn::test::writeFile(folder / name, "v 0 0 0\nv 4 0 0\nv 0 3 0\nv 0 0 1\n"
                                              "f 1 3 2\nf 1 2 4\nf 1 4 3\nf 2 3 4\n");
        return '"' + qtText(folder / name) + '"';
    }
};

TEST_F(ModelQuestionsTest, AModelOfUnknownAxisIsOpenedAsThePersonSeesItStand) {
    onceShown("upAxis", [](QWidget& asked) { click(part<QWidget>(asked, "upY")); });
    run("_Open " + wall("wall.obj"));
    EXPECT_TRUE(printed().contains("wall.obj: 1 object with 4 triangles\n"));
    EXPECT_FALSE(window.isWindowModified());
    const KM_3dPoint target = hostView("Front").MainViewport().VP().TargetPoint();
    EXPECT_EQ(target, KM_3dPoint(2, -0.5, 1.5)) << "what is 3 high along y is 3 high";
}

TEST_F(ModelQuestionsTest, TheSameFileIsOpenedThatWayFromThenOn) {
    onceShown("upAxis", [](QWidget& asked) { click(part<QWidget>(asked, "upY")); });
    run("_Open " + wall("wall.obj"));
    run("_Open " + wall("wall.obj"));
    EXPECT_EQ(hostView("Front").MainViewport().VP().TargetPoint(), KM_3dPoint(2, -0.5, 1.5));
}

TEST_F(ModelQuestionsTest, TheQuestionIsOnAMenuSwitch) {
    auto* const asks = window.findChild<QAction*>("askUpAxis");
    ASSERT_TRUE(asks);
    asks->trigger();
    run("_Import " + wall("wall.obj"));
    EXPECT_EQ(hostView("Front").MainViewport().VP().TargetPoint(), KM_3dPoint(2, 1.5, 0.5));
}

TEST_F(ModelQuestionsTest, AProgramThatStopsLeavesTheQuestionUnasked) {
    front_end.requestStop();
    EXPECT_EQ(front_end.chooseUpAxis({"wall.obj", ModelUp::z, {}}), std::nullopt);
}

TEST_F(ModelQuestionsTest, SunFormsBeginWithThePlaceThatAModelStates) {
    run(QString("_Open \"") + QUARN_SAMPLE_MODELS + "/IFC/AC14-FZK-Haus.ifc\"");
    EXPECT_TRUE(printed().contains("latitude 52.52, longitude 13.4, north angle 0."))
        << printed().toStdString();
    EXPECT_FALSE(window.isWindowModified());
    const std::pair<const char*, const char*> forms[] = {{"dayForm", "SetOneDaySunAnimation"},
                                                         {"seasonForm", "SetSeasonalSunAnimation"}};
    for (const auto& [form, command] : forms) {
        onceShown(form, [](QWidget& asked) {
            EXPECT_EQ(part<QLineEdit>(asked, "latitude").text(), "52.516667");
            EXPECT_EQ(part<QLineEdit>(asked, "longitude").text(), "13.4");
            asked.close();
        });
        run(command);
    }
}

TEST_F(ModelQuestionsTest, ScriptsBeginWithThePlaceThatTheyAlwaysDid) {
    run(QString("_-Open \"") + QUARN_SAMPLE_MODELS + "/IFC/AC14-FZK-Haus.ifc\"");
    EXPECT_EQ(session.document().Properties().AnimationProperties().Latitude(), 51.2838);
}

} // namespace
} // namespace quarn::desktop::test
