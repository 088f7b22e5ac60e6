#include "sdk/qncore/QnApp.h"
#include "sdk/qncore/QnDoc.h"
#include "sdk/qncore/QnLocalize.h"
#include "sdk/qncore/QnPlatform.h"
#include "sdk/qncore/QnView.h"
#include "sdk/qncore/QnZoetrixDynamicAccess.h"
#include "sdk/vexui/VexUi.h"
#include "tests/host/app/TestCommand.h"
#include "tests/host/border/BreachList.h"
#include "tests/host/document/DocumentFixtures.h"

#include <thread>

namespace quarn::test {
namespace {

TEST_F(HostTest, ASessionStartsWithOneDocumentAndItsPerspectiveView) {
    EXPECT_EQ(QuarnApp().ActiveDoc(), &session.document());
    ASSERT_NE(QuarnApp().ActiveView(), nullptr);
    EXPECT_EQ(&QuarnApp().ActiveView()->Document(), &session.document());
}

TEST_F(HostTest, PrintShowsTextAsItStands) {
    QuarnApp().Print(L"100 %d %s\n");
    QuarnApp().Print(nullptr);
    EXPECT_EQ(printed(), "100 %d %s\n");
}

TEST_F(HostTest, MessagesWaitingAndKeysGoThroughTheFrontEnd) {
    EXPECT_EQ(QuarnMessageBox(L"Text", L"Animation", 48), 1);
    ASSERT_EQ(front_end.messages().size(), 1U);
    EXPECT_EQ(front_end.messages()[0].title, L"Animation");
    EXPECT_EQ(front_end.messages()[0].flags, 48U);
    const unsigned int before = GetTickCount();
    QuarnApp().Wait(10);
    EXPECT_GE(GetTickCount() - before, 9U);
    EXPECT_EQ(front_end.waited_ms(), 10U);
    EXPECT_EQ(GetAsyncKeyState(VK_ESCAPE), 0);
    front_end.setKeyDown(VK_ESCAPE, true);
    EXPECT_LT(GetAsyncKeyState(VK_ESCAPE), 0);
    EXPECT_EQ(QuarnApp().MainWnd(), nullptr);
    EXPECT_EQ(CWnd::FromHandle(nullptr), nullptr);
}

TEST_F(HostTest, OneWindowObjectStandsForOneWindow) {
    int place = 0;
    const HWND window = reinterpret_cast<HWND>(&place);
    ASSERT_NE(CWnd::FromHandle(window), nullptr);
    EXPECT_EQ(CWnd::FromHandle(window)->m_hWnd, window);
    EXPECT_EQ(CWnd::FromHandle(window), CWnd::FromHandle(window));
}

TEST_F(HostTest, CallsFromAnotherThreadAreIgnoredAndTold) {
    CQuarnDoc* seen = &session.document();
    BreachList breaches;
    std::thread([&] {
        QuarnApp().Print(L"from a thread");
        seen = QuarnApp().ActiveDoc();
    }).join();
    EXPECT_EQ(seen, nullptr);
    EXPECT_EQ(printed(), "");
    EXPECT_EQ(breaches.take(),
              (std::vector<std::string>{"CQuarnApp::Print: only the main thread may call it",
                                        "CQuarnApp::ActiveDoc: only the main thread may call it"}));
}

TEST(WithoutASession, CallsFindNothingAndDoNoHarm) {
    EXPECT_EQ(QuarnApp().ActiveDoc(), nullptr);
    EXPECT_EQ(QuarnApp().ActiveView(), nullptr);
    QuarnApp().Print(L"nobody listens");
    EXPECT_FALSE(QuarnApp().RunScript(1, L"Help", 1));
    EXPECT_EQ(QuarnMessageBox(L"x", L"y", 0), 1);
    EXPECT_FALSE(CQuarnPlugIn::PlugInIsLoaded(ZelVexUiPlugInId));
    EXPECT_EQ(CQuarnPlugIn::LoadPlugIn(ZelVexUiPlugInId, true, true), -1);
    EXPECT_EQ(QnZoetrixVexUiTurnTable(), nullptr);
    EXPECT_STREQ(QnLocalizeString(L"Text", 16714), L"Text");
}

// ---- Pictures of a recording

/// Keeps what it is told about written pictures.
class CountingFrontEnd : public ScriptedFrontEnd {
public:
    void frameWritten(const std::filesystem::path& file, int written, int total) override {
        told.push_back(file.string() + " " + std::to_string(written) + "/" + std::to_string(total));
    }
    std::vector<std::string> told;
};

TEST(Pictures, AreCountedForEachCommandAndToldWithTheFramesOfTheRecord) {
    CountingFrontEnd front_end;
    Session session(front_end, {{}, {}, "C", {}});
    TestCommand record(L"RecordTwo", [](const CQuarnCommandContext&) {
        Application::current()->pictureWritten("a0.png", Image{});
        Application::current()->pictureWritten("a1.png", Image{});
        return CQuarnCommand::success;
    });
    ASSERT_TRUE(Application::current()->commands().add(record));
    session.runCommand(L"RecordTwo");
    {
        RecordKeeper keeper;
        keeper.record.SetFrameCount(2);
        EXPECT_EQ(Zoetrix_QuarnDynamicAccess(), &keeper);
        session.runCommand(L"RecordTwo");
    }
    Application::current()->pictureWritten("outside.png", Image{});
    EXPECT_EQ(front_end.told,
              (std::vector<std::string>{"a0.png 1/0", "a1.png 2/0", "a0.png 1/2", "a1.png 2/2"}));
}

} // namespace
} // namespace quarn::test
