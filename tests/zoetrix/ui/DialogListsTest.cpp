#include "tests/zoetrix/fixtures/PlugInFixture.h"
#include "zoetrix/commands/cmdZoetrix.h"
#include "zoetrix/ui/ZoetrixDataUI.h"

#include <cstdlib>
#include <dlfcn.h>

namespace {

using Names = KM_ClassArray<KM_wString>;

class DialogLists : public PlugInFixture {
protected:
    void fill(bool sun_filter) {
        EXPECT_TRUE(GetDailogAnimationOptions(record(), file_types, file_type, methods, method,
                                              views, view_index, mode_ids, sun_filter));
    }

    Names file_types = {L"before"};
    Names methods = {L"before"};
    Names views = {L"before"};
    int file_type = -1;
    int method = -1;
    int view_index = -1;
    KM_SimpleArray<KM_UUID> mode_ids = {KM_nil_uuid};
};

class DialogPlugIn : public PlugInFixture {
protected:
    DialogPlugIn() : PlugInFixture("dialogs") {}
};

/// How often the host was asked to load a plug-in by its id.
int loads_asked_for = 0;

/// A dialog plug-in that is as the environment says.
class OddDialogPlugIn : public PlugInFixture {
protected:
    OddDialogPlugIn() : PlugInFixture("no-dialogs") {}
    ~OddDialogPlugIn() override { unsetenv("QUARN_DIALOG_PLUG_IN"); }
};

} // namespace

/// Stands before the host's own for all that this program links, and counts.
int CQuarnPlugIn::LoadPlugIn(const KM_UUID& id, bool quietly, bool ignore_disabled) {
    ++loads_asked_for;
    using Load = int (*)(const KM_UUID&, bool, bool);
    const auto load =
        reinterpret_cast<Load>(dlsym(RTLD_NEXT, "_ZN12CQuarnPlugIn10LoadPlugInERK7KM_UUIDbb"));
    return load(id, quietly, ignore_disabled);
}

TEST_F(DialogLists, OfferEveryChoiceInItsOrder) {
    fill(false);
    EXPECT_EQ(Names({L"jpg", L"bmp", L"png", L"tga"}), file_types);
    EXPECT_EQ(Names({L"RenderFull", L"RenderPreview", L"Wireframe", L"Shaded", L"RenderedViewport",
                     L"Translucent", L"XRay", L"Drawing", L"Clay"}),
              methods);
    EXPECT_EQ(Names({L"Top", L"Front", L"Right", L"Perspective"}), views);
    ASSERT_EQ(methods.Count() - 2, mode_ids.Count());
    EXPECT_EQ(CQuarnDisplayAttrsMgr::WireframeModeId(), mode_ids[0]);
    EXPECT_EQ(CQuarnDisplayAttrsMgr::RenderedModeId(), mode_ids[2]);
}

TEST_F(DialogLists, SelectWhatTheRecordHolds) {
    record().SetFileExtension(L"png");
    record().SetCaptureMethod(L"XRay");
    record().SetViewportName(L"Right");
    fill(false);
    EXPECT_EQ(2, file_type);
    EXPECT_EQ(6, method);
    EXPECT_EQ(2, view_index);
}

TEST_F(DialogLists, SelectTheFirstEntryForWhatDiffersEvenInCase) {
    record().SetFileExtension(L"PNG");
    record().SetCaptureMethod(L"xray");
    record().SetViewportName(L"right");
    fill(false);
    EXPECT_EQ(0, file_type);
    EXPECT_EQ(0, method);
    EXPECT_EQ(0, view_index);
}

TEST_F(DialogLists, SunStudiesAreOfferedLitShadedModesOnly) {
    fill(true);
    ASSERT_GE(mode_ids.Count(), 1);
    EXPECT_EQ(mode_ids.Count() + 2, methods.Count());
    EXPECT_GE(methods.Search(L"RenderedViewport"), 2);
    EXPECT_EQ(-1, methods.Search(L"Wireframe"));
    KM_SimpleArray<const CDisplayPipelineAttributes*> modes;
    CQuarnDisplayAttrsMgr::GetDisplayAttrsList(modes);
    for (const CDisplayPipelineAttributes* mode : modes) {
        const bool shows_sun =
            mode->m_mode_kind == 2 && (mode->m_uses_document_lights || mode->m_casts_shadows);
        EXPECT_EQ(shows_sun, mode_ids.Search(mode->Id()) >= 0) << mode->EnglishName().ToUtf8();
    }
}

TEST_F(DialogLists, AreEmptyWithSelectionZeroAtFirst) {
    const CZoetrixDataUI lists;
    EXPECT_TRUE(lists.FileList().IsEmpty());
    EXPECT_TRUE(lists.CaptureList().IsEmpty());
    EXPECT_TRUE(lists.ViewportList().IsEmpty());
    EXPECT_TRUE(lists.DirectionList().IsEmpty());
    EXPECT_EQ(0, lists.FileListSelection());
    EXPECT_EQ(0, lists.CaptureListSelection());
    EXPECT_EQ(0, lists.ViewportListSelection());
    EXPECT_EQ(0, lists.DirectionListSelection());
}

TEST_F(DialogLists, KeepCopiesAndUncheckedSelections) {
    CZoetrixDataUI lists;
    Names names = {L"a", L"b"};
    lists.SetFileList(names);
    lists.SetCaptureList({L"c"});
    lists.SetViewportList({L"d"});
    lists.SetDirectionList({L"e"});
    names[0] = L"changed";
    EXPECT_EQ(Names({L"a", L"b"}), lists.FileList());
    EXPECT_EQ(Names({L"c"}), lists.CaptureList());
    EXPECT_EQ(Names({L"d"}), lists.ViewportList());
    EXPECT_EQ(Names({L"e"}), lists.DirectionList());
    lists.SetFileListSelection(-7);
    lists.SetCaptureListSelection(8);
    lists.SetViewportListSelection(9);
    lists.SetDirectionListSelection(10);
    EXPECT_EQ(-7, lists.FileListSelection());
    EXPECT_EQ(8, lists.CaptureListSelection());
    EXPECT_EQ(9, lists.ViewportListSelection());
    EXPECT_EQ(10, lists.DirectionListSelection());
}

TEST_F(DialogLists, UnderstandNoExtension) {
    CZoetrixDataUI lists;
    int data = 0;
    EXPECT_EQ(0, lists.EVF(L"", &data));
    EXPECT_EQ(0, lists.EVF(L"Anything", &data));
    EXPECT_EQ(0, lists.EVF(nullptr, nullptr));
}

TEST_F(DialogLists, StandBeforeTheMainWindowWhereThereIsOne) {
    const CZoetrixDataUI lists;
    EXPECT_EQ(nullptr, lists.Parent());
    int window = 0;
    front_end.main_window = reinterpret_cast<HWND>(&window);
    EXPECT_EQ(front_end.main_window, lists.Parent());
    front_end.main_window = nullptr;
}

TEST_F(DialogLists, MissingDialogPlugInIsToldWithAWarning) {
    EXPECT_FALSE(LoadVexUi(true));
    ASSERT_EQ(1U, front_end.messages().size());
    EXPECT_EQ(L"Vex UI (ZEL_VexUI.qnp) cannot be loaded.", front_end.messages()[0].text);
    EXPECT_EQ(L"Animation", front_end.messages()[0].title);
    EXPECT_EQ(48U, front_end.messages()[0].flags);
}

TEST_F(DialogLists, MissingDialogPlugInIsPassedOverInSilenceWithoutTheFlag) {
    EXPECT_FALSE(LoadVexUi(false));
    EXPECT_TRUE(front_end.messages().empty());
    EXPECT_TRUE(printed().empty());
}

TEST_F(OddDialogPlugIn, IsLoadedAlsoWhenItIsMarkedAsNeverToBeLoaded) {
    setenv("QUARN_DIALOG_PLUG_IN", "disabled", 1);
    EXPECT_TRUE(LoadVexUi(true));
    EXPECT_TRUE(CQuarnPlugIn::PlugInIsLoaded(ZelVexUiPlugInId));
    EXPECT_TRUE(front_end.messages().empty());
}

TEST_F(OddDialogPlugIn, ThatRefusesIsToldLikeAMissingOne) {
    setenv("QUARN_DIALOG_PLUG_IN", "refuses", 1);
    EXPECT_FALSE(LoadVexUi(false));
    EXPECT_TRUE(front_end.messages().empty());
    EXPECT_FALSE(LoadVexUi(true));
    ASSERT_EQ(1U, front_end.messages().size());
    EXPECT_EQ(L"Vex UI (ZEL_VexUI.qnp) cannot be loaded.", front_end.messages()[0].text);
    EXPECT_EQ(L"", printed()) << "the host was asked to load it quietly";
    EXPECT_EQ(CQuarnCommand::failure, session->runCommand(L"SetTurntableAnimation", true));
    EXPECT_EQ(2U, front_end.messages().size());
    EXPECT_EQ(KM_3dmAnimationProperties::none, record().CaptureType());
}

TEST_F(DialogPlugIn, IsLoadedOnceAndThenFoundLoaded) {
    EXPECT_FALSE(CQuarnPlugIn::PlugInIsLoaded(ZelVexUiPlugInId));
    const int loads_before = loads_asked_for;
    EXPECT_TRUE(LoadVexUi(true));
    EXPECT_EQ(loads_before + 1, loads_asked_for);
    EXPECT_TRUE(CQuarnPlugIn::PlugInIsLoaded(ZelVexUiPlugInId));
    EXPECT_TRUE(LoadVexUi(true));
    EXPECT_TRUE(LoadVexUi(false));
    EXPECT_EQ(loads_before + 1, loads_asked_for) << "it was loaded: nobody tries again";
    EXPECT_TRUE(front_end.messages().empty());
    EXPECT_TRUE(printed().empty());
}
