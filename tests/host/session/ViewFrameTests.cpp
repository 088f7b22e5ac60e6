#include "host/session/ViewFrame.h"

#include "engine/images/Image.h"
#include "host/session/Session.h"
#include "tests/host/app/TestCommand.h"
#include "tests/host/document/DocumentFixtures.h"

#include <functional>

namespace quarn::test {
namespace {

/// A window that remembers what it was told to show, and does things while it works on events.
class WatchingFrontEnd : public ScriptedFrontEnd {
public:
    struct Shown {
        std::wstring view;
        int width_px;
        int height_px;
        std::size_t bytes;
        std::uint8_t first_red;
    };

    void viewShown(CQuarnView& view, const ShownPicture& picture) override {
        shown.push_back({view.MainViewport().Name(), picture.width_px, picture.height_px,
                         picture.rgba.size(), picture.rgba[0]});
    }
    void pumpEvents(unsigned milliseconds) override {
        if (while_pumping)
            while_pumping();
        ScriptedFrontEnd::pumpEvents(milliseconds);
    }

    std::vector<Shown> shown;
    std::function<void()> while_pumping;
};

class ViewFrameTest : public testing::Test {
protected:
    CQuarnView& perspective() { return activeView(document.face()); }
    ViewState& state(const wchar_t* name) { return *document.findView(name); }

    WatchingFrontEnd front_end;
    Session session{front_end, {{}, {}, "C", {}}};
    Document& document = Document::of(session.document());
};

// ---- What the window is told to show

TEST_F(ViewFrameTest, ADrawnViewIsShownWithThePictureOfItsFrameBuffer) {
    ASSERT_TRUE(setFrameSize(perspective(), 40, 30));
    perspective().Redraw();
    ASSERT_EQ(front_end.shown.size(), 1U);
    const auto& shown = front_end.shown[0];
    EXPECT_EQ(shown.view, L"Perspective");
    EXPECT_EQ(shown.width_px, 40);
    EXPECT_EQ(shown.height_px, 30);
    EXPECT_EQ(shown.bytes, 4U * 40U * 30U);
}

TEST_F(ViewFrameTest, AFrameBufferThatIsShownWithoutDrawingIsSeenTooSoThatARecordingIs) {
    ASSERT_TRUE(setFrameSize(perspective(), 2, 1));
    ViewState& view = state(L"Perspective");
    Image picture;
    picture.resize(2, 1);
    picture.rgba[0] = 77;
    ASSERT_TRUE(view.copyToFrameBuffer(picture));
    perspective().Redraw(CQuarnView::show_frame_buffer);
    ASSERT_EQ(front_end.shown.size(), 1U);
    EXPECT_EQ(front_end.shown[0].first_red, 77);
    EXPECT_EQ(view.drawCount(), 0U);
}

TEST_F(ViewFrameTest, AViewThatWasNeverDrawnShowsNothing) {
    perspective().Redraw(CQuarnView::show_frame_buffer);
    EXPECT_TRUE(front_end.shown.empty());
}

// ---- Sizes

TEST_F(ViewFrameTest, AViewGetsTheSizeAndTheCameraItsAspect) {
    ASSERT_TRUE(setFrameSize(perspective(), 900, 300));
    const ViewState& view = state(L"Perspective");
    EXPECT_EQ(view.frameWidth(), 900);
    EXPECT_EQ(view.frameHeight(), 300);
    EXPECT_NEAR(view.viewport().FrustumAspect(), 3.0, 1e-12);
}

TEST_F(ViewFrameTest, SidesFrom1To16384PixelsAreTakenAndNoOthers) {
    for (const auto& [width_px, height_px] : {std::pair(0, 10), std::pair(10, 0), std::pair(-1, 10),
                                              std::pair(16385, 10), std::pair(10, 16385)})
        EXPECT_FALSE(setFrameSize(perspective(), width_px, height_px)) << width_px;
    EXPECT_EQ(state(L"Perspective").frameWidth(), ViewState::default_width_px);
    EXPECT_TRUE(setFrameSize(perspective(), 16384, 1));
    EXPECT_EQ(state(L"Perspective").frameWidth(), 16384);
}

TEST_F(ViewFrameTest, ThePictureStaysWhenTheSizeIsTheSameAndGoesWhenItIsAnother) {
    ASSERT_TRUE(setFrameSize(perspective(), 40, 30));
    perspective().Redraw();
    ASSERT_TRUE(setFrameSize(perspective(), 40, 30));
    EXPECT_EQ(state(L"Perspective").frameBuffer().width, 40);
    ASSERT_TRUE(setFrameSize(perspective(), 40, 31));
    EXPECT_EQ(state(L"Perspective").frameBuffer().width, 0);
}

TEST_F(ViewFrameTest, AClosedViewIsLeftAlone) {
    CQuarnView& closed = perspective();
    ASSERT_TRUE(session.closeView(L"Perspective"));
    EXPECT_FALSE(setFrameSize(closed, 10, 10));
    activateView(closed);
    EXPECT_STREQ(activeView(document.face()).MainViewport().Name(), L"Right");
}

// ---- While a command runs

TEST_F(ViewFrameTest, ASizeGivenWhileACommandRunsWaitsUntilItHasEnded) {
    std::vector<int> widths;
    TestCommand command(L"Work", [&](const CQuarnCommandContext&) {
        front_end.pumpEvents(0);
        widths.push_back(state(L"Perspective").frameWidth());
        return CQuarnCommand::success;
    });
    ASSERT_TRUE(Application::current()->commands().add(command));
    front_end.while_pumping = [&] {
        EXPECT_FALSE(setFrameSize(perspective(), 0, 10));
        EXPECT_TRUE(setFrameSize(perspective(), 300, 200));
        EXPECT_TRUE(setFrameSize(perspective(), 320, 200));
    };
    session.runCommand(L"Work");
    EXPECT_EQ(widths, std::vector<int>{ViewState::default_width_px});
    EXPECT_EQ(state(L"Perspective").frameWidth(), 320);
    Application::current()->commands().remove(command);
}

TEST_F(ViewFrameTest, AViewActivatedWhileACommandRunsIsActiveWhenItHasEnded) {
    TestCommand command(L"Work", [&](const CQuarnCommandContext&) {
        activateView(state(L"Top").face());
        EXPECT_STREQ(perspective().MainViewport().Name(), L"Perspective");
        return CQuarnCommand::success;
    });
    ASSERT_TRUE(Application::current()->commands().add(command));
    session.runCommand(L"Work");
    EXPECT_STREQ(perspective().MainViewport().Name(), L"Top");
    Application::current()->commands().remove(command);
}

TEST_F(ViewFrameTest, AViewThatIsResizedActivatedAndClosedWhileACommandRunsIsGoneAfterIt) {
    TestCommand command(L"Work", [&](const CQuarnCommandContext&) {
        CQuarnView& top = state(L"Top").face();
        activateView(top);
        setFrameSize(top, 30, 30);
        session.closeView(L"Top");
        return CQuarnCommand::success;
    });
    ASSERT_TRUE(Application::current()->commands().add(command));
    session.runCommand(L"Work");
    EXPECT_EQ(document.findView(L"Top"), nullptr);
    EXPECT_STREQ(perspective().MainViewport().Name(), L"Front");
    Application::current()->commands().remove(command);
}

TEST_F(ViewFrameTest, SizesGivenToADocumentThatTheCommandReplacesAreForgotten) {
    CQuarnView& old = perspective();
    TestCommand command(L"Work", [&](const CQuarnCommandContext&) {
        setFrameSize(old, 30, 30);
        activateView(old);
        document.list().openNew();
        return CQuarnCommand::success;
    });
    ASSERT_TRUE(Application::current()->commands().add(command));
    session.runCommand(L"Work");
    const Document& opened = Document::of(session.document());
    EXPECT_NE(&opened, &document);
    EXPECT_EQ(opened.activeView().frameWidth(), ViewState::default_width_px);
    Application::current()->commands().remove(command);
}

} // namespace
} // namespace quarn::test
