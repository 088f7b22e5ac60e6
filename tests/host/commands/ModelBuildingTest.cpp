// Large models, whose scene is built while they are loaded.
#include "engine/display/DisplayMode.h"
#include "engine/images/Image.h"
#include "host/document/Document.h"
#include "host/document/DocumentDrawing.h"
#include "host/document/DocumentScene.h"
#include "sdk/qncore/QnPlatform.h"
#include "tests/host/app/TestCommand.h"
#include "tests/import/ModelFixtures.h"

#include <gmock/gmock.h>

#include <algorithm>
#include <chrono>
#include <thread>

namespace quarn::test {
namespace {

using testing::HasSubstr;

constexpr int SQUARES_A_SIDE = 500; // 500 000 triangles

/// Waits a moment at first in each reading, so that all that follows is shown, and notes it.
class NotingFrontEnd final : public ScriptedFrontEnd {
public:
    struct Step {
        ModelStep step;
        double share;
    };

    void pumpEvents(unsigned) override {
        if (!std::exchange(has_waited, true))
            std::this_thread::sleep_for(std::chrono::milliseconds(310));
    }
    void modelRead(const std::filesystem::path&, ModelStep step, double share) override {
        steps.push_back({step, share});
        const bool is_building = step == ModelStep::built && share < 1.0;
        if (is_building && cancels_building)
            setKeyDown(VK_ESCAPE, true);
    }
    bool hasSeenBuilding() const {
        return std::ranges::any_of(steps, [](const Step& step) {
            return step.step == ModelStep::built && step.share < 1.0;
        });
    }

    std::vector<Step> steps;
    bool cancels_building = false;
    bool has_waited = false;
};

/// A wavy field.
std::string largeObj() {
    std::string text;
    for (int i = 0; i <= SQUARES_A_SIDE; ++i)
        for (int j = 0; j <= SQUARES_A_SIDE; ++j)
            text += "v " + std::to_string(i) + ' ' + std::to_string(j) + ' ' +
                    std::to_string((i * 7 + j * 5) % 11) + '\n';
    for (int i = 0; i < SQUARES_A_SIDE; ++i)
        for (int j = 1; j <= SQUARES_A_SIDE; ++j) {
            const int corner = i * (SQUARES_A_SIDE + 1) + j;
            const int above = corner + SQUARES_A_SIDE + 1;
            for (const int third : {corner + 1, above})
                text += "f " + std::to_string(third == above ? corner : above) + ' ' +
                        std::to_string(third == above ? above + 1 : corner) + ' ' +
                        std::to_string(third) + '\n';
        }
    return text;
}

class ModelBuildingTest : public testing::Test {
protected:
    static SessionOptions optionsThatBuild() {
        SessionOptions options{{}, {}, "C", {}};
        options.builds_scenes = true;
        return options;
    }

    Document& document() { return Document::of(session.document()); }
    CQuarnCommand::result load(const wchar_t* command, const std::filesystem::path& file) {
        const KM_wString line =
            KM_wString(command) + L" \"" + KM_wString::FromUtf8(file.string()) + L"\"";
        front_end.has_waited = false;
        return session.runCommand(line.View());
    }
    /// How often the scene that is drawn had something built.
    std::size_t buildCount() {
        const auto scene = document().drawing().scene();
        EXPECT_TRUE(scene.ok());
        return scene.ok() ? scene.value()->display().rays().buildCount() : 0;
    }
    std::vector<std::uint8_t> pictureBy(DocumentDrawing& drawing) {
        const ViewState& view = document().activeView();
        Image picture;
        EXPECT_TRUE(drawing.draw(view.viewport(), standardDisplayModes()[1], 160, 90, picture));
        return picture.rgba;
    }

    NotingFrontEnd front_end;
    Session session{front_end, optionsThatBuild()};
    TemporaryFolder folder;
    std::filesystem::path large() { return folder.write("large.obj", largeObj()); }
};

TEST_F(ModelBuildingTest, IsShownAfterTheReadingAndLeavesNothingToBuild) {
    ASSERT_EQ(load(L"_-Open", large()), CQuarnCommand::success);
    ASSERT_FALSE(front_end.steps.empty());
    EXPECT_TRUE(std::ranges::is_sorted(front_end.steps, {}, &NotingFrontEnd::Step::step));
    EXPECT_TRUE(front_end.hasSeenBuilding());
    EXPECT_EQ(front_end.steps.back().share, 1.0);
    EXPECT_EQ(buildCount(), 1U) << "once, for the loading and the picture";
    DocumentDrawing fresh(document());
    EXPECT_EQ(pictureBy(document().drawing()), pictureBy(fresh));
}

TEST_F(ModelBuildingTest, ThatIsCancelledLeavesTheDocumentAsItWas) {
    ASSERT_EQ(session.runCommand(L"_Point 1,2,3"), CQuarnCommand::success);
    const std::uint64_t changes = document().objects().changeCount();
    const unsigned number = document().serialNumber();
    front_end.cancels_building = true;
    const std::filesystem::path file = large();
    for (const wchar_t* const command : {L"_-Import", L"_-Open"}) {
        EXPECT_EQ(load(command, file), CQuarnCommand::cancel);
        EXPECT_TRUE(front_end.hasSeenBuilding());
        EXPECT_EQ(document().serialNumber(), number);
        EXPECT_EQ(document().objects().changeCount(), changes);
        front_end.setKeyDown(VK_ESCAPE, false);
        front_end.steps.clear();
    }
    EXPECT_THAT(KM_wString(front_end.printed()).ToUtf8(),
                HasSubstr("large.obj was not read: it was given up."));
    front_end.cancels_building = false;
    EXPECT_EQ(load(L"_-Import", file), CQuarnCommand::success);
    EXPECT_EQ(buildCount(), 1U);
}

TEST_F(ModelBuildingTest, BuildsOnlyTheMeshesThatAreNew) {
    ASSERT_EQ(load(L"_-Import", large()), CQuarnCommand::success);
    const auto saved = folder.path() / "large.quarn";
    ASSERT_EQ(load(L"_-SaveAs", saved), CQuarnCommand::success);
    ASSERT_EQ(load(L"_-Import", saved), CQuarnCommand::success);
    EXPECT_EQ(document().objects().objects().size(), 2U);
    EXPECT_EQ(buildCount(), 2U) << "the second mesh and what stands above both";
    DocumentDrawing fresh(document());
    EXPECT_EQ(pictureBy(document().drawing()), pictureBy(fresh));
}

TEST_F(ModelBuildingTest, OfASmallModelIsLeftToThePicture) {
    const auto small = folder.write("small.obj", "v 0 0 0\nv 1 0 0\nv 0 1 0\nf 1 2 3\n");
    ASSERT_EQ(load(L"_-Open", small), CQuarnCommand::success);
    EXPECT_TRUE(front_end.steps.empty());
    EXPECT_EQ(buildCount(), 1U);
}

} // namespace
} // namespace quarn::test
