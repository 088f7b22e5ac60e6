#include "sdk/cocoa/QXText.h"
#include "tests/cocoa/CocoaFixture.h"
#include "zoetrix/ui/PathAnimationDialog.h"

#include <string>
#include <vector>

namespace {
std::vector<std::string> forgotten;
}

/// A pop-up button that says when it dies.
@interface NamedPopUpButton : NSPopUpButton
@end

@implementation NamedPopUpButton
- (void)dealloc {
    forgotten.emplace_back([[self toolTip] UTF8String]);
    [super dealloc];
}
@end

namespace {

NSPopUpButton* makeButton(NSString* name) {
    NSPopUpButton* const button = [[NamedPopUpButton alloc] initWithFrame:NSMakeRect(0, 0, 100, 24)
                                                                pullsDown:NO];
    [button setToolTip:name];
    return button;
}

class TurnTableController : public CocoaTest {
protected:
    TurnTableController() : controller([[QXTurnTableDialogController alloc] init]) {
        forgotten.clear();
    }
    ~TurnTableController() override { [controller release]; }

    void serve(CQuarnDialog& served) { [controller setQuarnDialog:&served]; }

    /// Sets the outlets as a nib does, to buttons that the caller owns.
    void makeOutlets() {
        direction = makeButton(@"direction");
        file_type = makeButton(@"file type");
        capture = makeButton(@"capture");
        viewport = makeButton(@"viewport");
        [controller setDirectionCtrl:direction];
        [controller setFileTypeCtrl:file_type];
        [controller setCaptureMethodCtrl:capture];
        [controller setViewportCtrl:viewport];
    }

    std::vector<NSPopUpButton*> outlets() const {
        return {direction, file_type, capture, viewport};
    }

    QXTurnTableDialogController* controller;
    NSPopUpButton* direction = nil;
    NSPopUpButton* file_type = nil;
    NSPopUpButton* capture = nil;
    NSPopUpButton* viewport = nil;
};

TEST_F(TurnTableController, NamesItsNibAndTheKeysThatAreBound) {
    EXPECT_STREQ([[controller nibName] UTF8String], "QXTurnTableDialog");
    NSArray* const keys = [controller bindingKeyNames];
    ASSERT_EQ([keys count], 2u);
    EXPECT_STREQ([[keys objectAtIndex:0] UTF8String], "frameCount");
    EXPECT_STREQ([[keys objectAtIndex:1] UTF8String], "name");
}

TEST_F(TurnTableController, WithoutADialogCountIsZeroAndNameEmpty) {
    EXPECT_EQ([controller quarnDialog], nullptr);
    [controller setFrameCount:7];
    [controller setName:@"Nobody"];
    EXPECT_EQ([controller frameCount], 0);
    ASSERT_NE([controller name], nil);
    EXPECT_EQ([[controller name] length], 0u);
    EXPECT_STREQ([[controller valueForKey:@"name"] UTF8String], "");
}

TEST_F(TurnTableController, ShowsAndStoresCountAndNameOfItsDialog) {
    serve(dialog);
    EXPECT_EQ([controller frameCount], 120);
    EXPECT_STREQ([[controller name] UTF8String], "Turn");
    [controller setFrameCount:-3];
    [controller setName:@"Haus"];
    EXPECT_EQ(dialog.m_frame_count, -3);
    EXPECT_EQ(dialog.m_name, L"Haus");
}

TEST_F(TurnTableController, ItsKeysAreReadAndWrittenByKeyValueCoding) {
    serve(dialog);
    EXPECT_EQ([[controller valueForKey:@"frameCount"] intValue], 120);
    EXPECT_STREQ([[controller valueForKey:@"name"] UTF8String], "Turn");
    [controller setValue:[NSNumber numberWithInt:48] forKey:@"frameCount"];
    [controller setValue:[NSString stringWithLPCTSTR:L"\u56DE\U0001F3A5"] forKey:@"name"];
    EXPECT_EQ(dialog.m_frame_count, 48);
    EXPECT_EQ(dialog.m_name, L"\u56DE\U0001F3A5");
    [controller setValue:@"96" forKey:@"frameCount"];
    EXPECT_EQ(dialog.m_frame_count, 96);
}

TEST_F(TurnTableController, ANilNameIsAnEmptyName) {
    serve(dialog);
    [controller setName:nil];
    EXPECT_TRUE(dialog.m_name.IsEmpty());
    dialog.m_name = L"Again";
    [controller setValue:nil forKey:@"name"];
    EXPECT_TRUE(dialog.m_name.IsEmpty());
}

TEST_F(TurnTableController, ServesATurntableDialogAndNoOther) {
    CQuarnDialog* const turntable = &dialog;
    [controller setQuarnDialog:turntable];
    EXPECT_EQ([controller quarnDialog], turntable);

    CPathAnimationDialog path(9, L"Path", list({L"jpg"}), 0, list({L"Shaded"}), 0, list({L"Top"}),
                              0, nullptr);
    [controller setQuarnDialog:&path];
    EXPECT_EQ([controller quarnDialog], nullptr);
    [controller setFrameCount:1];
    EXPECT_EQ(path.m_frame_count, 9);
    EXPECT_EQ(dialog.m_frame_count, 120);

    [controller setQuarnDialog:turntable];
    [controller setQuarnDialog:nullptr];
    EXPECT_EQ([controller quarnDialog], nullptr);
}

TEST_F(TurnTableController, HandsEachPopUpButtonToTheComboBoxOfItsList) {
    serve(dialog);
    makeOutlets();
    [controller windowDidLoad];
    dialog.m_direction.m_combo.InsertString(-1, L"of the direction");
    dialog.m_file_type.m_combo.InsertString(-1, L"of the file type");
    dialog.m_capture.m_combo.InsertString(-1, L"of the capture method");
    dialog.m_viewport.m_combo.InsertString(-1, L"of the viewport");
    EXPECT_STREQ([[direction itemTitleAtIndex:0] UTF8String], "of the direction");
    EXPECT_STREQ([[file_type itemTitleAtIndex:0] UTF8String], "of the file type");
    EXPECT_STREQ([[capture itemTitleAtIndex:0] UTF8String], "of the capture method");
    EXPECT_STREQ([[viewport itemTitleAtIndex:0] UTF8String], "of the viewport");
    [controller willCloseDialog];
    for (NSPopUpButton* button : outlets()) {
        [button release];
    }
}

TEST_F(TurnTableController, ComboBoxesRetainTheirButtonsUntilTheDialogCloses) {
    serve(dialog);
    makeOutlets();
    std::vector<NSUInteger> before;
    for (NSPopUpButton* button : outlets()) {
        before.push_back([button retainCount]);
    }
    [controller windowDidLoad];
    for (std::size_t at = 0; at < before.size(); ++at) {
        EXPECT_EQ([outlets()[at] retainCount], before[at] + 1) << at;
    }
    [controller willCloseDialog];
    for (std::size_t at = 0; at < before.size(); ++at) {
        EXPECT_EQ([outlets()[at] retainCount], before[at]) << at;
        [outlets()[at] release];
    }
    EXPECT_FALSE(dialog.m_direction.m_combo.HasControl());
    EXPECT_FALSE(dialog.m_file_type.m_combo.HasControl());
    EXPECT_FALSE(dialog.m_capture.m_combo.HasControl());
    EXPECT_FALSE(dialog.m_viewport.m_combo.HasControl());
}

TEST_F(TurnTableController, AComboBoxReleasesTheButtonItHadForASecondOne) {
    serve(dialog);
    makeOutlets();
    const NSUInteger first_before = [direction retainCount];
    [controller windowDidLoad];
    NSPopUpButton* const second = makeButton(@"second direction");
    const NSUInteger second_before = [second retainCount];
    [controller setDirectionCtrl:second];
    [controller windowDidLoad];
    EXPECT_EQ([direction retainCount], first_before);
    EXPECT_EQ([second retainCount], second_before + 1);
    EXPECT_EQ([file_type retainCount], first_before + 1) << "handed over twice, retained once";
    [controller willCloseDialog];
    EXPECT_EQ([second retainCount], second_before);
    [second release];
    for (NSPopUpButton* button : outlets()) {
        [button release];
    }
}

TEST_F(TurnTableController, ButtonsAreReleasedInTheOrderOfTheLists) {
    serve(dialog);
    makeOutlets();
    [controller windowDidLoad];
    for (NSPopUpButton* button : outlets()) {
        [button release];
    }
    EXPECT_TRUE(forgotten.empty()) << "the combo boxes are the last to hold them";
    [controller willCloseDialog];
    EXPECT_EQ(forgotten,
              (std::vector<std::string>{"direction", "file type", "capture", "viewport"}));
}

TEST_F(TurnTableController, EntriesOfTheSameTextStayApart) {
    serve(dialog);
    makeOutlets();
    [controller windowDidLoad];
    CComboBox& combo = dialog.m_viewport.m_combo;
    combo.InsertString(-1, L"Top");
    combo.InsertString(-1, L"Top");
    EXPECT_EQ(combo.GetCount(), 2);
    EXPECT_EQ(combo.SetCurSel(1), 1);
    EXPECT_EQ(combo.GetCurSel(), 1);
    EXPECT_EQ(combo.SetCurSel(-1), -1);
    EXPECT_EQ(combo.GetCurSel(), -1);
    [controller willCloseDialog];
    for (NSPopUpButton* button : outlets()) {
        [button release];
    }
}

TEST_F(TurnTableController, WithoutADialogOrOutletsNothingIsHandedOver) {
    [controller windowDidLoad];
    [controller willCloseDialog];
    serve(dialog);
    [controller windowDidLoad];
    EXPECT_FALSE(dialog.m_direction.m_combo.HasControl());
    EXPECT_FALSE(dialog.m_viewport.m_combo.HasControl());
}

} // namespace
