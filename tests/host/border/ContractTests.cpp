#include "host/border/Contract.h"

#include "engine/display/DisplayMode.h"
#include "host/app/PendingObjects.h"
#include "sdk/qncore/qncore.h"
#include "sdk/vexui/VexUi.h"
#include "tests/host/app/TestCommand.h"
#include "tests/host/border/BreachList.h"
#include "tests/host/document/DocumentFixtures.h"

#include <cstdlib>
#include <functional>
#include <optional>
#include <thread>
#include <utility>

namespace quarn::test {
namespace {

using Messages = std::vector<std::string>;

/// Sets an environment variable, or takes it away, as long as it lives.
class Environment {
public:
    Environment(const char* name, const char* value) : m_name(name) {
        if (const char* before = std::getenv(name))
            m_before = before;
        set(value);
    }
    ~Environment() { set(m_before ? m_before->c_str() : nullptr); }
    Environment(const Environment&) = delete;
    Environment& operator=(const Environment&) = delete;

private:
    void set(const char* value) {
        if (value)
            setenv(m_name, value, 1);
        else
            unsetenv(m_name);
    }

    const char* m_name;
    std::optional<std::string> m_before;
};

SessionOptions strictness(std::optional<bool> strict) {
    SessionOptions options{{}, {}, "C", {}};
    options.strict = strict;
    return options;
}

/// Breaks a rule: no command runs.
CQuarnGet::result askOutsideACommand() {
    return CQuarnGetString().GetString();
}

// ---- What a breach leads to

TEST(Strictness, TheEnvironmentChoosesWhetherABreachIsFatal) {
    for (const char* strict : {"1", "yes"}) {
        const Environment environment("QUARN_STRICT", strict);
        EXPECT_EQ(breachReceiverOfEnvironment(), &abortOnBreach) << strict;
    }
    for (const char* lenient : {"0", "", static_cast<const char*>(nullptr)}) {
        const Environment environment("QUARN_STRICT", lenient);
        EXPECT_EQ(breachReceiverOfEnvironment(), &logBreach) << (lenient ? lenient : "unset");
    }
}

TEST(Strictness, InUseABreachIsALineOnTheErrorOutputAndTheProgramGoesOn) {
    ScriptedFrontEnd front_end;
    const Session session(front_end, strictness(false));
    testing::internal::CaptureStderr();
    EXPECT_EQ(askOutsideACommand(), CQuarnGet::no_result);
    EXPECT_EQ(testing::internal::GetCapturedStderr(),
              "Quarn: CQuarnGetString::GetString: questions may be asked while a command runs\n");
    EXPECT_EQ(front_end.printed(), L"");
}

TEST(Strictness, ASessionLeavesTheReceiverAsItWas) {
    BreachList breaches;
    {
        ScriptedFrontEnd front_end;
        const Session session(front_end, strictness(true));
    }
    reportBreach("Call", "rule");
    EXPECT_EQ(breaches.take(), Messages{"Call: rule"});
}

class StrictnessDeathTest : public testing::Test {
protected:
    // Drawing may have started threads, which a plain fork leaves behind.
    void SetUp() override { GTEST_FLAG_SET(death_test_style, "threadsafe"); }
};

TEST_F(StrictnessDeathTest, AStrictSessionAbortsAfterNamingTheCallAndTheRule) {
    const auto break_rule = [] {
        ScriptedFrontEnd front_end;
        const Session session(front_end, strictness(true));
        askOutsideACommand();
    };
    EXPECT_DEATH(break_rule(), "Quarn: CQuarnGetString::GetString: questions may be asked while a "
                               "command runs");
}

TEST_F(StrictnessDeathTest, TheEnvironmentMakesASessionStrictThatChoosesNothing) {
    const auto break_rule = [] {
        const Environment environment("QUARN_STRICT", "1");
        ScriptedFrontEnd front_end;
        Session session(front_end, strictness(std::nullopt));
        CQuarnView& view = *QuarnApp().ActiveView();
        session.closeView(L"Perspective");
        view.Redraw();
    };
    EXPECT_DEATH(break_rule(), "Quarn: CQuarnView::Redraw: the view was closed");
}

// ---- The main thread

/// A call and its name.
struct ThreadCall {
    const char* name;
    std::function<void()> call;
};

class ThreadRule : public HostTest {
protected:
    void expectRefused(const std::vector<ThreadCall>& calls) {
        BreachList breaches;
        for (const ThreadCall& each : calls) {
            std::thread(each.call).join();
            EXPECT_EQ(breaches.take(),
                      Messages{std::string(each.name) + ": only the main thread may call it"});
        }
    }

    CQuarnDoc& doc = session.document();
    CQuarnView& view = *QuarnApp().ActiveView();
    CQuarnViewport& viewport = view.MainViewport();
    CQuarnDisplayPipeline& pipeline = *viewport.DisplayPipeline();
};

TEST_F(ThreadRule, HoldsForTheApplicationAndItsQuestions) {
    KM_UUID nobody = KM_nil_uuid;
    int place = 0;
    expectRefused({
        {"CQuarnApp::ActiveDoc", [] { EXPECT_EQ(QuarnApp().ActiveDoc(), nullptr); }},
        {"CQuarnApp::ActiveView", [] { EXPECT_EQ(QuarnApp().ActiveView(), nullptr); }},
        {"CQuarnApp::Print", [] { QuarnApp().Print(L"text"); }},
        {"CQuarnApp::RunScript", [] { EXPECT_FALSE(QuarnApp().RunScript(1, L"Help", 0)); }},
        {"CQuarnApp::Wait", [] { QuarnApp().Wait(1); }},
        {"CQuarnApp::MainWnd", [] { EXPECT_EQ(QuarnApp().MainWnd(), nullptr); }},
        {"QuarnMessageBox", [] { EXPECT_EQ(QuarnMessageBox(L"", L"", 0), 1); }},
        {"GetAsyncKeyState", [] { EXPECT_EQ(GetAsyncKeyState(27), 0); }},
        {"CWnd::FromHandle",
         [&] { EXPECT_EQ(CWnd::FromHandle(reinterpret_cast<HWND>(&place)), nullptr); }},
        {"CQuarnUiDirDialog::DoModal",
         [] { EXPECT_EQ(CQuarnUiDirDialog(L"", L"", L"", nullptr).DoModal(), 2); }},
        {"CQuarnPlugIn::PlugInIsLoaded",
         [&] { EXPECT_FALSE(CQuarnPlugIn::PlugInIsLoaded(nobody)); }},
        {"CQuarnPlugIn::LoadPlugIn",
         [&] { EXPECT_LT(CQuarnPlugIn::LoadPlugIn(nobody, true, true), 0); }},
        {"QnZoetrixVexUiTurnTable", [] { EXPECT_EQ(QnZoetrixVexUiTurnTable(), nullptr); }},
        {"QnZoetrixVexUiPathAnimation", [] { EXPECT_EQ(QnZoetrixVexUiPathAnimation(), nullptr); }},
        {"QnZoetrixVexUiDay", [] { EXPECT_EQ(QnZoetrixVexUiDay(), nullptr); }},
        {"QnZoetrixVexUiSeason", [] { EXPECT_EQ(QnZoetrixVexUiSeason(), nullptr); }},
        {"CQuarnGetOption::GetOption",
         [] { EXPECT_EQ(CQuarnGetOption().GetOption(), CQuarnGet::no_result); }},
        {"CQuarnGetString::GetString",
         [] { EXPECT_EQ(CQuarnGetString().GetString(), CQuarnGet::no_result); }},
        {"CQuarnGetNumber::GetNumber",
         [] { EXPECT_EQ(CQuarnGetNumber().GetNumber(), CQuarnGet::no_result); }},
        {"CQuarnGetInteger::GetNumber",
         [] { EXPECT_EQ(CQuarnGetInteger().GetNumber(), CQuarnGet::no_result); }},
        {"CQuarnGetObject::GetObjects",
         [] { EXPECT_EQ(CQuarnGetObject().GetObjects(), CQuarnGet::no_result); }},
        {"QnLocalizeString", [] { EXPECT_STREQ(QnLocalizeString(L"text", 41001), L"text"); }},
        {"QnLocalizeCommandOptionName",
         [] { EXPECT_EQ(QnLocalizeCommandOptionName(L"Top", 43101).m_local, L"Top"); }},
        {"QnLocalizeCommandOptionValue",
         [] { EXPECT_EQ(QnLocalizeCommandOptionValue(L"No", 42001).m_local, L"No"); }},
        {"Zoetrix_SetQuarnDynamicAccess", [] { Zoetrix_SetQuarnDynamicAccess(nullptr); }},
        {"Zoetrix_QuarnDynamicAccess", [] { EXPECT_EQ(Zoetrix_QuarnDynamicAccess(), nullptr); }},
    });
}

TEST_F(ThreadRule, HoldsForDocumentsAndTheirObjects) {
    addBox(Document::of(doc), {0, 0, 0}, {1, 1, 1});
    const CQuarnObject& box = *doc.FindObjectByName(L"Box");
    const CQuarnObjRef reference(box.Id());
    const unsigned int number = doc.RuntimeSerialNumber();
    KM_SimpleArray<CQuarnView*> views;
    expectRefused({
        {"CQuarnDoc::FromRuntimeSerialNumber",
         [&] { EXPECT_EQ(CQuarnDoc::FromRuntimeSerialNumber(number), nullptr); }},
        {"CQuarnDoc::RuntimeSerialNumber", [&] { EXPECT_EQ(doc.RuntimeSerialNumber(), number); }},
        {"CQuarnDoc::GetViewList", [&] { EXPECT_EQ(doc.GetViewList(views, true, true), 0); }},
        {"CQuarnDoc::AbsoluteTolerance",
         [&] { EXPECT_EQ(doc.AbsoluteTolerance(), Document::default_absolute_tolerance); }},
        {"CQuarnDoc::Properties", [&] { doc.Properties(); }},
        {"CQuarnDoc::LightTable", [&] { doc.LightTable(); }},
        {"CQuarnDoc::Sun", [&] { doc.Sun(); }},
        {"CQuarnDoc::FindObjectByName", [&] { EXPECT_EQ(doc.FindObjectByName(L"Box"), nullptr); }},
        {"CQuarnDoc::HideObject", [&] { EXPECT_FALSE(doc.HideObject(reference, true)); }},
        {"CQuarnDoc::ShowObject", [&] { EXPECT_FALSE(doc.ShowObject(reference, true)); }},
        {"CQuarnDoc::Regen", [&] { doc.Regen(); }},
        {"CQuarnObject::Id", [&] { EXPECT_EQ(box.Id(), KM_nil_uuid); }},
        {"CQuarnObject::Name", [&] { EXPECT_STREQ(box.Name(), L""); }},
        {"CQuarnObject::IsHidden", [&] { EXPECT_FALSE(box.IsHidden()); }},
        {"CQuarnObject::Curve", [&] { EXPECT_EQ(box.Curve(), nullptr); }},
        {"CQuarnObject::Point", [&] { EXPECT_EQ(box.Point(), nullptr); }},
        {"CQuarnObjRef::Object", [&] { EXPECT_EQ(reference.Object(), nullptr); }},
    });
    EXPECT_FALSE(box.IsHidden());
}

TEST_F(ThreadRule, HoldsForTheRecordTheLightsAndTheSun) {
    RecordKeeper keeper;
    keeper.record.SetFrameCount(7);
    CQuarnDocProperties& properties = doc.Properties();
    CQuarnLightTable& lights = doc.LightTable();
    CQuarnSun& sun = doc.Sun();
    KM_Light light;
    light.SetStyle(KM_LightStyle::world_point);
    light.SetLocation({0, 0, 5});
    ASSERT_EQ(lights.AddLight(light, nullptr), 0);
    expectRefused({
        {"CQuarnDocProperties::AnimationProperties",
         [&] { EXPECT_EQ(properties.AnimationProperties().FrameCount(), 100); }},
        {"CQuarnDocProperties::SetAnimationProperties",
         [&] { properties.SetAnimationProperties(KM_3dmAnimationProperties()); }},
        {"CQuarnLightTable::LightCount", [&] { EXPECT_EQ(lights.LightCount(), 0); }},
        {"CQuarnLightTable::operator[]", [&] { EXPECT_TRUE(lights[0].IsDeleted()); }},
        {"CQuarnLightTable::AddLight", [&] { EXPECT_EQ(lights.AddLight(light, nullptr), -1); }},
        {"CQuarnLightTable::DeleteLight", [&] { EXPECT_FALSE(lights.DeleteLight(0, false)); }},
        {"CQuarnSun::IsEnabled", [&] { EXPECT_FALSE(sun.IsEnabled()); }},
        {"CQuarnSun::BeginChange", [&] { sun.BeginChange(CQuarnSun::change_by_program); }},
        {"CQuarnSun::SetEnabled", [&] { sun.SetEnabled(false); }},
        {"CQuarnSun::EndChange", [&] { EXPECT_FALSE(sun.EndChange()); }},
        {"CQuarnSun::DirectionToSun",
         [&] { EXPECT_EQ(sun.DirectionToSun(), KM_3dVector(0, 0, 1)); }},
    });
    EXPECT_EQ(keeper.record.FrameCount(), 7);
    EXPECT_EQ(lights.LightCount(), 1);
    EXPECT_FALSE(lights[0].IsDeleted());
    EXPECT_TRUE(sun.IsEnabled());
}

TEST_F(ThreadRule, HoldsForViewsAndWhatDrawsThem) {
    const KM_Viewport before = viewport.VP();
    const CDisplayPipelineAttributes attributes = *pipeline.CurrentDisplayAttributes();
    CQuarnDib dib;
    expectRefused({
        {"CQuarnView::MainViewport", [&] { view.MainViewport(); }},
        {"CQuarnView::MainViewport", [&] { std::as_const(view).MainViewport(); }},
        {"CQuarnView::ActiveViewport", [&] { view.ActiveViewport(); }},
        {"CQuarnView::Document", [&] { view.Document(); }},
        {"CQuarnView::DisplayAttributes", [&] { EXPECT_EQ(view.DisplayAttributes(), nullptr); }},
        {"CQuarnView::Redraw", [&] { view.Redraw(); }},
        {"CQuarnViewport::Name", [&] { EXPECT_STREQ(viewport.Name(), L""); }},
        {"CQuarnViewport::VP", [&] { EXPECT_TRUE(viewport.VP() == KM_Viewport()); }},
        {"CQuarnViewport::Target",
         [&] { EXPECT_EQ(viewport.Target(), KM_Viewport().TargetPoint()); }},
        {"CQuarnViewport::SetVP", [&] { EXPECT_FALSE(viewport.SetVP(KM_Viewport(), true, true)); }},
        {"CQuarnViewport::SetTargetAndCameraLocation",
         [&] {
             EXPECT_FALSE(viewport.SetTargetAndCameraLocation({0, 0, 0}, {1, 1, 1}, true, true));
         }},
        {"CQuarnViewport::SetDisplayMode",
         [&] { EXPECT_FALSE(viewport.SetDisplayMode(wireframe_mode_id)); }},
        {"CQuarnViewport::DisplayPipeline", [&] { viewport.DisplayPipeline(); }},
        {"CQuarnDisplayPipeline::FrameWidth", [&] { EXPECT_EQ(pipeline.FrameWidth(), 0); }},
        {"CQuarnDisplayPipeline::FrameHeight", [&] { EXPECT_EQ(pipeline.FrameHeight(), 0); }},
        {"CQuarnDisplayPipeline::CurrentDisplayAttributes",
         [&] { EXPECT_EQ(pipeline.CurrentDisplayAttributes(), nullptr); }},
        {"CQuarnDisplayPipeline::DrawToDib",
         [&] { EXPECT_FALSE(pipeline.DrawToDib(dib, 4, 4, attributes)); }},
        {"CQuarnDisplayPipeline::CopyToFrameBuffer",
         [&] { EXPECT_FALSE(pipeline.CopyToFrameBuffer(dib)); }},
        {"CQuarnDib::WriteToFile", [&] { EXPECT_FALSE(dib.WriteToFile(L"never.png", 0)); }},
    });
    EXPECT_TRUE(viewport.VP() == before);
    EXPECT_EQ(ViewState::of(view).showCount(), 0U);
    EXPECT_EQ(view.DisplayAttributes()->Id(), shaded_mode_id);
}

// ---- The end of a session

/// Keeps a view and a document, and calls them when it is unloaded.
class KeepingPlugIn final : public CQuarnUtilityPlugIn {
public:
    const wchar_t* PlugInName() const override { return L"Keeping"; }
    const wchar_t* PlugInVersion() const override { return L"1"; }
    KM_UUID PlugInID() const override { return m_id; }
    void OnUnloadPlugIn() override {
        view->Redraw();
        document->Regen();
        found = QuarnApp().ActiveDoc();
    }

    CQuarnView* view = nullptr;
    CQuarnDoc* document = nullptr;
    CQuarnDoc* found = nullptr;

private:
    KM_UUID m_id = KM_CreateUuid();
};

TEST(SessionEnd, APlugInThatCallsAKeptViewWhileItIsUnloadedBreaksTheRuleAndNothingElse) {
    const PendingObjects of_other_tests = std::exchange(PendingObjects::program(), {});
    CWinApp application;
    KeepingPlugIn plug_in;
    {
        ScriptedFrontEnd front_end;
        Session session(front_end, strictness(false));
        const PlugInLoad load = session.adoptProgramPlugIn();
        ASSERT_TRUE(load.ok()) << load.message;
        plug_in.view = QuarnApp().ActiveView();
        plug_in.document = plug_in.found = QuarnApp().ActiveDoc();
        testing::internal::CaptureStderr();
    }
    EXPECT_EQ(testing::internal::GetCapturedStderr(),
              "Quarn: CQuarnView::Redraw: the view was closed\n"
              "Quarn: CQuarnDoc::Regen: the document was closed\n");
    EXPECT_EQ(plug_in.found, nullptr);
    PendingObjects::program() = of_other_tests;
}

} // namespace
} // namespace quarn::test
