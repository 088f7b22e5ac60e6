#include "zoetrix/ui/ZoetrixDataUI.h"

#include <gtest/gtest.h>

using Names = KM_ClassArray<KM_wString>;

/// The interface as the dialog plug-in was built against it, written down a second time: nothing
/// here follows when the header changes. Calls find their operation by its place alone. It stands
/// in no unnamed namespace, so that the compiler must expect objects of classes that it cannot see.
class BuiltDialogsView {
public:
    virtual ~BuiltDialogsView() = default;
    virtual const Names& slot2() const = 0;
    virtual void slot3(const Names& list) = 0;
    virtual int slot4() const = 0;
    virtual void slot5(int selection) = 0;
    virtual const Names& slot6() const = 0;
    virtual void slot7(const Names& list) = 0;
    virtual int slot8() const = 0;
    virtual void slot9(int selection) = 0;
    virtual const Names& slot10() const = 0;
    virtual void slot11(const Names& list) = 0;
    virtual int slot12() const = 0;
    virtual void slot13(int selection) = 0;
    virtual const Names& slot14() const = 0;
    virtual void slot15(const Names& list) = 0;
    virtual int slot16() const = 0;
    virtual void slot17(int selection) = 0;
    virtual HWND slot18() const = 0;
    virtual int slot19(const wchar_t* name, void* data) = 0;
};

namespace {

/// The checker of types would see that the object is of no class of the view.
#define UNRELATED_CLASSES __attribute__((noinline, no_sanitize("vptr")))

UNRELATED_CLASSES void setAll(BuiltDialogsView& view) {
    view.slot3({L"file"});
    view.slot5(5);
    view.slot7({L"capture"});
    view.slot9(9);
    view.slot11({L"viewport"});
    view.slot13(13);
    view.slot15({L"direction"});
    view.slot17(17);
}

UNRELATED_CLASSES void expectAll(BuiltDialogsView& view) {
    EXPECT_EQ(Names({L"file"}), view.slot2());
    EXPECT_EQ(5, view.slot4());
    EXPECT_EQ(Names({L"capture"}), view.slot6());
    EXPECT_EQ(9, view.slot8());
    EXPECT_EQ(Names({L"viewport"}), view.slot10());
    EXPECT_EQ(13, view.slot12());
    EXPECT_EQ(Names({L"direction"}), view.slot14());
    EXPECT_EQ(17, view.slot16());
    EXPECT_EQ(nullptr, view.slot18());
    int data = 99;
    EXPECT_EQ(0, view.slot19(L"anything", &data));
    EXPECT_EQ(99, data);
}

/// The object as the dialog plug-in sees it. Nothing of its own class is known behind it.
BuiltDialogsView& seenByBuiltDialogs(IZoetrixDataUI& lists) {
    IZoetrixDataUI* volatile hidden = &lists;
    return *reinterpret_cast<BuiltDialogsView*>(hidden);
}

} // namespace

TEST(DataUISlots, StandWhereBuiltDialogPlugInsLookForThem) {
    CZoetrixDataUI lists;
    setAll(seenByBuiltDialogs(lists));
    EXPECT_EQ(Names({L"file"}), lists.FileList());
    EXPECT_EQ(5, lists.FileListSelection());
    EXPECT_EQ(Names({L"capture"}), lists.CaptureList());
    EXPECT_EQ(9, lists.CaptureListSelection());
    EXPECT_EQ(Names({L"viewport"}), lists.ViewportList());
    EXPECT_EQ(13, lists.ViewportListSelection());
    EXPECT_EQ(Names({L"direction"}), lists.DirectionList());
    EXPECT_EQ(17, lists.DirectionListSelection());
    expectAll(seenByBuiltDialogs(lists));
}
