#include "tests/zoetrix/fixtures/PlugInFixture.h"
#include "zoetrix/commands/cmdZoetrix.h"

using testing::HasSubstr;

namespace {

constexpr KM_UUID some_mode = {1, 2, 3, {4, 5, 6, 7, 8, 9, 10, 11}};

class Options : public PlugInFixture {
protected:
    Options() = default;
    explicit Options(const std::string& language) : PlugInFixture("", language) {}

    void SetUp() override {
        props.SetCaptureMethod(L"Shaded");
        props.SetHtmlFilename(L"Walk");
        props.SetViewportName(L"Top");
        props.SetDisplayMode(some_mode);
    }

    /// Asks the options and answers the prompts in turn.
    int ask(std::initializer_list<std::wstring_view> answers, bool sun_filter = false) {
        answer(answers);
        int result = -1;
        insideCommand([&](CQuarnDoc& document) {
            result = GetAnimationOptions(document, props, sun_filter);
        });
        return result;
    }
    int askMethod(std::wstring_view method) {
        return ask({L"_Enter", method, L"_Enter", L"_Enter"});
    }
    const quarn::Question& question(std::size_t index) { return front_end.questions().at(index); }
    std::vector<std::wstring> optionsOf(std::size_t index) {
        std::vector<std::wstring> names;
        for (const quarn::QuestionOption& option : question(index).options)
            names.emplace_back(option.local_name.View());
        return names;
    }

    KM_3dmAnimationProperties props;
};

class GermanOptions : public Options {
protected:
    GermanOptions() : Options("de") {}
};

using Texts = std::vector<std::wstring>;

/// A display mode as a host of other modes would have it, for as long as the object lives.
class ChangedMode {
public:
    explicit ChangedMode(const wchar_t* english_name)
        : m_mode(const_cast<CDisplayPipelineAttributes*>(
              CQuarnDisplayAttrsMgr::FindDisplayAttrs(modeNamed(english_name)))),
          m_before(*m_mode) {}
    ~ChangedMode() { *m_mode = m_before; }
    ChangedMode(const ChangedMode&) = delete;
    ChangedMode& operator=(const ChangedMode&) = delete;

    CDisplayPipelineAttributes* operator->() const { return m_mode; }

private:
    CDisplayPipelineAttributes* m_mode;
    CDisplayPipelineAttributes m_before;
};

} // namespace

TEST_F(Options, EnterAtEveryPromptKeepsAllButTheViewport) {
    EXPECT_EQ(CQuarnCommand::success, ask({L"_Enter", L"_Enter", L"_Enter", L"_Enter"}));
    EXPECT_EQ(L"jpg", props.FileExtension().View());
    EXPECT_EQ(L"Shaded", props.CaptureMethod().View());
    EXPECT_EQ(some_mode, props.DisplayMode());
    EXPECT_EQ(L"Perspective", props.ViewportName().View());
    EXPECT_EQ(L"Walk", props.HtmlFilename().View());
}

TEST_F(Options, FourPromptsAreAskedInTheirOrder) {
    ask({L"_Enter", L"_Enter", L"_Enter", L"_Enter"});
    ASSERT_EQ(4U, front_end.questions().size());
    EXPECT_EQ(L"File type", question(0).prompt.View());
    EXPECT_EQ(L"Frame capture method", question(1).prompt.View());
    EXPECT_EQ(L"Viewport name to render", question(2).prompt.View());
    EXPECT_EQ(L"Animation sequence name", question(3).prompt.View());
    EXPECT_EQ(L"jpg", question(0).default_answer->View());
    EXPECT_EQ(L"Shaded", question(1).default_answer->View());
    EXPECT_EQ(L"Perspective", question(2).default_answer->View());
    EXPECT_EQ(L"Walk", question(3).default_answer->View());
    EXPECT_EQ(Texts({L"jpg", L"bmp", L"png", L"tga"}), optionsOf(0));
    EXPECT_EQ(Texts({L"RenderFull", L"RenderPreview", L"Wireframe", L"Shaded", L"RenderedViewport",
                     L"Translucent", L"XRay", L"Drawing", L"Clay"}),
              optionsOf(1));
    for (std::size_t i = 0; i < 3; ++i)
        EXPECT_TRUE(question(i).accepts_nothing) << i;
    EXPECT_FALSE(question(3).accepts_nothing);
}

TEST_F(Options, EachFileTypeCanBePicked) {
    for (const wchar_t* type : {L"jpg", L"bmp", L"png", L"tga"}) {
        EXPECT_EQ(CQuarnCommand::success, ask({type, L"_Enter", L"_Enter", L"_Enter"}));
        EXPECT_EQ(type, props.FileExtension().View());
    }
}

TEST_F(Options, RenderMethodsSetTheirFlags) {
    for (const wchar_t* full : {L"_RenderFull", L"_Render_Full", L"_renderfull", L"[RenderFull]"}) {
        props.SetRenderFull(false);
        props.SetRenderPreview(true);
        EXPECT_EQ(CQuarnCommand::success, askMethod(full));
        EXPECT_EQ(L"RenderFull", props.CaptureMethod().View());
        EXPECT_TRUE(props.RenderFull());
        EXPECT_FALSE(props.RenderPreview());
        EXPECT_EQ(some_mode, props.DisplayMode());
    }
    for (const wchar_t* preview : {L"_RenderPreview", L"[RenderPreview]"}) {
        props.SetRenderFull(true);
        props.SetRenderPreview(false);
        EXPECT_EQ(CQuarnCommand::success, askMethod(preview));
        EXPECT_EQ(L"RenderPreview", props.CaptureMethod().View());
        EXPECT_FALSE(props.RenderFull());
        EXPECT_TRUE(props.RenderPreview());
    }
}

TEST_F(Options, DisplayModesClearTheFlagsAndAreStoredWithTheirId) {
    const struct {
        const wchar_t* answer;
        const wchar_t* method;
        const wchar_t* mode;
    } cases[] = {
        {L"_Wireframe", L"Wireframe", L"Wireframe"},
        {L"_shaded", L"Shaded", L"Shaded"},
        {L"_RenderedViewport", L"RenderedViewport", L"Rendered"},
        {L"_XRay", L"XRay", L"X-Ray"},
        {L"[XRay]", L"XRay", L"X-Ray"},
        {L"[Clay]", L"Clay", L"Clay"},
        {L"[Wireframe]", L"Wireframe", L"Wireframe"},
    };
    for (const auto& expected : cases) {
        props.SetRenderFull(true);
        props.SetRenderPreview(true);
        EXPECT_EQ(CQuarnCommand::success, askMethod(expected.answer));
        EXPECT_EQ(expected.method, props.CaptureMethod().View());
        EXPECT_EQ(modeNamed(expected.mode), props.DisplayMode());
        EXPECT_FALSE(props.RenderFull());
        EXPECT_FALSE(props.RenderPreview());
    }
}

TEST_F(Options, TypedMethodWithoutUnderscoreIsIgnored) {
    EXPECT_EQ(CQuarnCommand::success, askMethod(L"RenderFull"));
    EXPECT_EQ(L"Shaded", props.CaptureMethod().View());
    EXPECT_FALSE(props.RenderFull());
    EXPECT_EQ(L"Perspective", props.ViewportName().View());
}

TEST_F(Options, AFileTypeThatIsNoneIsToldAndTheOldOneStays) {
    EXPECT_EQ(CQuarnCommand::success, ask({L"gif", L"_Enter", L"Perspective", L"_Enter"}));
    EXPECT_EQ(L"jpg", props.FileExtension().View());
    EXPECT_EQ(L"\"gif\" is no option here. The options are jpg, bmp, png, tga.\n", printed());
}

TEST_F(Options, UnknownMethodWithUnderscoreFailsWithoutAWord) {
    EXPECT_EQ(CQuarnCommand::failure, ask({L"png", L"_Rendered"}));
    EXPECT_EQ(L"png", props.FileExtension().View());
    EXPECT_EQ(L"Shaded", props.CaptureMethod().View());
    EXPECT_TRUE(printed().find(L"Nothing done") == std::wstring::npos);
}

TEST_F(Options, AnUnderscoreAloneIsAnUnknownMethod) {
    EXPECT_EQ(CQuarnCommand::failure, ask({L"png", L"_"}));
    EXPECT_EQ(L"Shaded", props.CaptureMethod().View());
    EXPECT_TRUE(printed().find(L"Nothing done") == std::wstring::npos);
    EXPECT_EQ(2U, front_end.questions().size());
}

TEST_F(Options, WithoutAnyModeToFallBackOnTheyFailWithoutAWord) {
    const ChangedMode rendered(L"Rendered");
    const ChangedMode clay(L"Clay");
    for (const ChangedMode* mode : {&rendered, &clay})
        (*mode)->m_uses_document_lights = (*mode)->m_casts_shadows = false;
    props.SetRenderPreview(true);
    EXPECT_EQ(CQuarnCommand::failure, ask({L"png"}, true));
    EXPECT_EQ(L"", printed());
    EXPECT_EQ(1U, front_end.questions().size()) << "the method is not asked for";
    EXPECT_EQ(L"png", props.FileExtension().View());
    EXPECT_EQ(L"Shaded", props.CaptureMethod().View());
    EXPECT_EQ(some_mode, props.DisplayMode());
    EXPECT_TRUE(props.RenderPreview());
    // A render method needs no mode.
    props.SetCaptureMethod(L"RenderFull");
    EXPECT_EQ(CQuarnCommand::success, ask({L"_Enter", L"_Enter", L"_Enter", L"_Enter"}, true));
    EXPECT_EQ(L"RenderFull", props.CaptureMethod().View());
}

TEST_F(Options, MethodThatIsGoneBecomesTheFirstModeByNameOnly) {
    props.SetCaptureMethod(L"Blueprint");
    props.SetRenderFull(true);
    EXPECT_EQ(CQuarnCommand::success, askMethod(L"_Enter"));
    EXPECT_EQ(L"Wireframe", props.CaptureMethod().View());
    EXPECT_EQ(some_mode, props.DisplayMode());
    EXPECT_TRUE(props.RenderFull());
}

TEST_F(Options, KnownMethodInOtherCaseStaysAsItIs) {
    for (const wchar_t* method : {L"renderfull", L"RENDERPREVIEW", L"xray", L"sHADED"}) {
        props.SetCaptureMethod(method);
        EXPECT_EQ(CQuarnCommand::success, askMethod(L"_Enter"));
        EXPECT_EQ(method, props.CaptureMethod().View());
    }
}

TEST_F(Options, SunStudiesAreOfferedNoWireframe) {
    EXPECT_EQ(CQuarnCommand::success, ask({L"_Enter", L"_Enter", L"_Enter", L"_Enter"}, true));
    EXPECT_EQ(Texts({L"RenderFull", L"RenderPreview", L"RenderedViewport", L"Clay"}), optionsOf(1));
    EXPECT_EQ(CQuarnCommand::failure, ask({L"_Enter", L"_Wireframe"}, true));
    EXPECT_EQ(CQuarnCommand::failure, ask({L"_Enter", L"_Shaded"}, true));
}

TEST_F(Options, SunStudiesAreOfferedShadedModesWithLightsOrShadowsAlone) {
    const ChangedMode wireframe(L"Wireframe");
    wireframe->m_uses_document_lights = wireframe->m_casts_shadows = true;
    const ChangedMode lit(L"Shaded");
    lit->m_uses_document_lights = true;
    lit->m_casts_shadows = false;
    const ChangedMode shadowed(L"Drawing");
    shadowed->m_uses_document_lights = false;
    shadowed->m_casts_shadows = true;
    const ChangedMode dark(L"Clay");
    dark->m_uses_document_lights = dark->m_casts_shadows = false;

    const Texts expected = {L"RenderFull", L"RenderPreview", L"Shaded", L"RenderedViewport",
                            L"Drawing"};
    EXPECT_EQ(CQuarnCommand::success, ask({L"_Enter", L"_Enter", L"_Enter", L"_Enter"}, true));
    EXPECT_EQ(expected, optionsOf(1));

    KM_ClassArray<KM_wString> types, methods, views;
    KM_SimpleArray<KM_UUID> ids;
    int type = 0, method = 0, view_index = 0;
    EXPECT_TRUE(GetDailogAnimationOptions(props, types, type, methods, method, views, view_index,
                                          ids, true));
    ASSERT_EQ(static_cast<int>(expected.size()), methods.Count());
    for (int i = 0; i < methods.Count(); ++i)
        EXPECT_EQ(expected[static_cast<std::size_t>(i)], methods[i].View());
    EXPECT_EQ(3, ids.Count());
}

TEST_F(Options, ModesAreNamedWithoutTheCharactersThatOptionsDoNotHold) {
    const ChangedMode ghosted(L"Translucent");
    ghosted->m_local_name = L"Ghost_ed - View, 2";
    ghosted->m_english_name = L"Ghosted";
    const ChangedMode rendered(L"Rendered");
    rendered->m_local_name = L"REN-dered";
    EXPECT_EQ(CQuarnCommand::success, askMethod(L"_ghosted"));
    EXPECT_EQ(L"GhostedView2", props.CaptureMethod().View());
    EXPECT_EQ(ghosted->m_id, props.DisplayMode());
    EXPECT_EQ(L"RenderedViewport", optionsOf(1).at(4));
    EXPECT_EQ(L"GhostedView2", optionsOf(1).at(5));
}

TEST_F(Options, ModeThatShowsNoSunBecomesTheFirstOneThatDoesByNameOnly) {
    EXPECT_EQ(CQuarnCommand::success, ask({L"_Enter", L"_Enter", L"_Enter", L"_Enter"}, true));
    EXPECT_EQ(L"RenderedViewport", props.CaptureMethod().View());
    EXPECT_EQ(L"RenderedViewport", question(1).default_answer->View());
    EXPECT_EQ(some_mode, props.DisplayMode());
}

TEST_F(Options, ViewportIsFoundInAnyCaseAndStoredAsTyped) {
    EXPECT_EQ(CQuarnCommand::success, ask({L"_Enter", L"_Enter", L" fRONT ", L"_Enter"}));
    EXPECT_EQ(L"fRONT", props.ViewportName().View());
}

TEST_F(Options, UnknownViewportFails) {
    EXPECT_EQ(CQuarnCommand::failure, ask({L"_Enter", L"_Enter", L"Back"}));
    EXPECT_THAT(printed(), HasSubstr(L"Invalid viewport name. Nothing done\n"));
    EXPECT_EQ(L"Top", props.ViewportName().View());
    EXPECT_EQ(3U, front_end.questions().size());
}

TEST_F(Options, BlankViewportFails) {
    EXPECT_EQ(CQuarnCommand::failure, ask({L"_Enter", L"_Enter", L"   "}));
    EXPECT_THAT(printed(), HasSubstr(L"Invalid viewport name. Nothing done\n"));
    EXPECT_EQ(L"Top", props.ViewportName().View());
}

TEST_F(Options, SequenceNameIsAskedAndNotStored) {
    EXPECT_EQ(CQuarnCommand::success, ask({L"_Enter", L"_Enter", L"_Enter", L"Run"}));
    EXPECT_EQ(L"Walk", props.HtmlFilename().View());
}

TEST_F(Options, EachCancelledPromptSaysItsMessageAndKeepsEarlierAnswers) {
    EXPECT_EQ(CQuarnCommand::cancel, ask({L"_Cancel"}));
    EXPECT_THAT(printed(), HasSubstr(L"Failed to select file type. Nothing done\n"));
    EXPECT_EQ(L"jpg", props.FileExtension().View());

    EXPECT_EQ(CQuarnCommand::cancel, ask({L"tga", L"_Cancel"}));
    EXPECT_THAT(printed(), HasSubstr(L"Failed to select capture method. Nothing done\n"));
    EXPECT_EQ(L"tga", props.FileExtension().View());

    front_end.clearPrinted();
    EXPECT_EQ(CQuarnCommand::cancel, ask({L"_Enter", L"_XRay", L"_Cancel"}));
    EXPECT_THAT(printed(), HasSubstr(L"Invalid name. Nothing done\n"));
    EXPECT_EQ(L"XRay", props.CaptureMethod().View());

    front_end.clearPrinted();
    EXPECT_EQ(CQuarnCommand::cancel, ask({L"_Enter", L"_Enter", L"Front", L"_Cancel"}));
    EXPECT_THAT(printed(), HasSubstr(L"Invalid name. Nothing done\n"));
    EXPECT_EQ(L"Front", props.ViewportName().View());
}

TEST_F(GermanOptions, ModesAreRecognisedByTheirLocalNames) {
    props.SetCaptureMethod(L"GerenderteAnsicht");
    EXPECT_EQ(CQuarnCommand::success, askMethod(L"_Enter"));
    EXPECT_EQ(L"GerenderteAnsicht", props.CaptureMethod().View());
    const Texts offered = optionsOf(1);
    EXPECT_EQ(L"RendernVoll", offered.at(0));
    EXPECT_EQ(L"RendernVorschau", offered.at(1));
    EXPECT_EQ(L"Drahtmodell", offered.at(2));
    EXPECT_EQ(L"GerenderteAnsicht", offered.at(4));
    EXPECT_EQ(L"Röntgen", offered.at(6));
}

TEST_F(GermanOptions, ScriptsInEnglishStillWork) {
    EXPECT_EQ(CQuarnCommand::success, ask({L"_png", L"_XRay", L"_Enter", L"_Enter"}));
    EXPECT_EQ(L"png", props.FileExtension().View());
    EXPECT_EQ(L"Röntgen", props.CaptureMethod().View());
    EXPECT_EQ(modeNamed(L"X-Ray"), props.DisplayMode());
    EXPECT_EQ(CQuarnCommand::success, askMethod(L"_RenderFull"));
    EXPECT_EQ(L"RendernVoll", props.CaptureMethod().View());
    EXPECT_TRUE(props.RenderFull());
    EXPECT_EQ(L"", printed());
}
