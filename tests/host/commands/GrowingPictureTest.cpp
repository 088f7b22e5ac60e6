#include "host/document/Document.h"
#include "sdk/qncore/QnPlatform.h"
#include "tests/host/app/TestCommand.h"
#include "tests/host/document/DocumentFixtures.h"

#include <gtest/gtest.h>

#include <chrono>
#include <thread>
#include <vector>

namespace quarn::test {
namespace {

using Pixels = std::vector<std::uint8_t>;

/// A front end with a window, which takes its time between parts of the work.
class SlowWindow : public ScriptedFrontEnd {
public:
    HWND mainWindow() override { return has_window ? reinterpret_cast<HWND>(this) : nullptr; }
    void pumpEvents(unsigned) override {
        std::this_thread::sleep_for(std::chrono::milliseconds(150));
    }
    void renderWindowShown(const ShownPicture& picture) override {
        shown.emplace_back(picture.rgba.begin(), picture.rgba.end());
        if (stops_at_picture)
            setKeyDown(VK_ESCAPE, true);
    }

    bool has_window = true;
    bool stops_at_picture = false;
    std::vector<Pixels> shown;
};

class GrowingPictureTest : public testing::Test {
protected:
    GrowingPictureTest() {
        addBox(document(), {-5, -5, 0}, {5, 5, 5});
        document().renderWindow().settings = {24, 16, 64, 1};
    }
    Document& document() { return Document::of(session.document()); }
    CQuarnCommand::result run(const wchar_t* line) { return session.runCommand(line); }

    SlowWindow front_end;
    Session session{front_end, {{}, {}, "C", {}}};
};

TEST_F(GrowingPictureTest, WindowShowsThePictureSoFarAndThenTheWholeOne) {
    ASSERT_EQ(run(L"_Render"), CQuarnCommand::success);
    ASSERT_GE(front_end.shown.size(), 2U);
    EXPECT_EQ(front_end.shown.front().size(), 24U * 16U * 4U);
    EXPECT_TRUE(front_end.shown.back() == document().renderWindow().picture.rgba);
}

TEST_F(GrowingPictureTest, CancelledRenderBringsTheEarlierPictureBack) {
    ASSERT_EQ(run(L"_RenderPreview"), CQuarnCommand::success);
    const Pixels earlier = document().renderWindow().picture.rgba;
    front_end.stops_at_picture = true;
    EXPECT_EQ(run(L"_Render"), CQuarnCommand::cancel);
    ASSERT_GE(front_end.shown.size(), 3U);
    EXPECT_FALSE(front_end.shown[1] == earlier);
    EXPECT_TRUE(front_end.shown.back() == earlier);
    EXPECT_TRUE(document().renderWindow().picture.rgba == earlier);
}

TEST_F(GrowingPictureTest, CancelledFirstRenderLeavesNoPicture) {
    front_end.stops_at_picture = true;
    EXPECT_EQ(run(L"_Render"), CQuarnCommand::cancel);
    ASSERT_FALSE(front_end.shown.empty());
    EXPECT_TRUE(front_end.shown.back().empty());
    EXPECT_FALSE(document().renderWindow().isOpen());
}

TEST_F(GrowingPictureTest, WithoutAWindowOnlyTheWholePictureIsShown) {
    front_end.has_window = false;
    ASSERT_EQ(run(L"_Render"), CQuarnCommand::success);
    EXPECT_EQ(front_end.shown.size(), 1U);
}

} // namespace
} // namespace quarn::test
