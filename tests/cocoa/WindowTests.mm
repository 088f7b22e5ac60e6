#include "host/cocoa/CocoaDialogs.h"
#include "sdk/cocoa/QXText.h"
#include "tests/cocoa/CocoaFixture.h"

#include <cstdlib>
#include <filesystem>
#include <string>

namespace {

/// The controller of the dialog whose window is shown now.
QXTurnTableDialogController* shownController() {
    return static_cast<QXTurnTableDialogController*>([[NSApp modalWindow] delegate]);
}

NSTextField* field(int control) {
    return [[[NSApp modalWindow] contentView] viewWithTag:control];
}

std::string titleOf(NSPopUpButton* button) {
    return [[button titleOfSelectedItem] UTF8String];
}

/// Types over what stands in a field, as a person does.
void type(int control, NSString* text) {
    [[NSApp modalWindow] makeFirstResponder:field(control)];
    NSText* const editor = [[NSApp modalWindow] fieldEditor:YES forObject:field(control)];
    [editor selectAll:nil];
    [editor insertText:text];
}

/// The button of the window that sends this; nil when it has none.
NSButton* buttonThatSends(SEL action) {
    NSArray* const views = [[[NSApp modalWindow] contentView] subviews];
    for (NSUInteger at = 0; at < [views count]; ++at) {
        const id view = [views objectAtIndex:at];
        if ([view isKindOfClass:[NSButton class]] && sel_isEqual([view action], action)) {
            return view;
        }
    }
    return nil;
}

void pressOK() {
    [buttonThatSends(@selector(confirmDialog:)) performClick:nil];
}

void pressCancel() {
    [buttonThatSends(@selector(cancelDialog:)) performClick:nil];
}

/// Takes a picture of the display. @return how many colours it has
int photograph(const std::string& name) {
    const std::string file = QUARN_PICTURES "/" + name;
    const std::string command = "import -window root '" + file + "' && identify -format %k '" +
                                file + "' > '" + file + ".colours'";
    [[NSApp modalWindow] display];
    if (std::system(command.c_str()) != 0) {
        return 0;
    }
    NSString* const colours = [NSString
        stringWithContentsOfFile:[NSString stringWithUTF8String:(file + ".colours").c_str()]
                        encoding:NSUTF8StringEncoding
                           error:nullptr];
    return [colours intValue];
}

class TurnTableWindow : public CocoaTest {
protected:
    using CocoaTest::CocoaTest;

    /// Shows the dialog, has a person do something in it, and says how it ended.
    int run(std::function<void()> action) {
        onceTheWindowIsThere(std::move(action));
        const quarn::Result<int> result = quarn::runCocoaDialog(dialog);
        EXPECT_TRUE(result.ok()) << (result.ok() ? "" : result.message());
        EXPECT_EQ([NSApp modalWindow], nil);
        return result.ok() ? result.value() : -100;
    }

    void expectNothingChanged() const {
        EXPECT_EQ(dialog.m_frame_count, 120);
        EXPECT_EQ(dialog.m_name, L"Turn");
        EXPECT_EQ(dialog.m_direction.m_selection, 1);
        EXPECT_EQ(dialog.m_file_type.m_selection, 0);
        EXPECT_EQ(dialog.m_capture.m_selection, 2);
        EXPECT_EQ(dialog.m_viewport.m_selection, 3);
    }
};

TEST_F(TurnTableWindow, AppearsWithEveryListAndFieldFilled) {
    int colours = 0;
    run([&] {
        EXPECT_TRUE([[NSApp modalWindow] isVisible]);
        EXPECT_STREQ([[[NSApp modalWindow] title] UTF8String], "Turntable Animation");
        QXTurnTableDialogController* const controller = shownController();
        EXPECT_EQ([[controller directionCtrl] numberOfItems], 2);
        EXPECT_EQ([[controller fileTypeCtrl] numberOfItems], 4);
        EXPECT_EQ([[controller captureMethodCtrl] numberOfItems], 3);
        EXPECT_EQ([[controller viewportCtrl] numberOfItems], 4);
        EXPECT_EQ(titleOf([controller directionCtrl]), "AntiClockwise");
        EXPECT_EQ(titleOf([controller fileTypeCtrl]), "jpg");
        EXPECT_EQ(titleOf([controller captureMethodCtrl]), "Rendered");
        EXPECT_EQ(titleOf([controller viewportCtrl]), "Perspective");
        EXPECT_STREQ([[field(6005) stringValue] UTF8String], "120");
        EXPECT_STREQ([[field(6009) stringValue] UTF8String], "Turn");
        colours = photograph("turntable.png");
        pressCancel();
    });
    EXPECT_GT(colours, 8) << "an empty display has one colour, a window with texts many";
}

TEST_F(TurnTableWindow, OKStoresWhatWasChosenAndTyped) {
    const int result = run([] {
        [[shownController() directionCtrl] selectItemAtIndex:0];
        [[shownController() fileTypeCtrl] selectItemAtIndex:1];
        [[shownController() captureMethodCtrl] selectItemAtIndex:0];
        [[shownController() viewportCtrl] selectItemAtIndex:2];
        type(6009, [NSString stringWithLPCTSTR:L"Haus \u56DE"]);
        type(6005, @"48");
        pressOK();
    });
    EXPECT_EQ(result, 1);
    EXPECT_EQ(dialog.m_frame_count, 48);
    EXPECT_EQ(dialog.m_name, L"Haus \u56DE");
    EXPECT_EQ(dialog.m_direction.m_selection, 0);
    EXPECT_EQ(dialog.m_file_type.m_selection, 1);
    EXPECT_EQ(dialog.m_capture.m_selection, 0);
    EXPECT_EQ(dialog.m_viewport.m_selection, 2);
    EXPECT_FALSE(dialog.m_direction.m_combo.HasControl());
}

TEST_F(TurnTableWindow, CancelChangesNothing) {
    const int result = run([] {
        [[shownController() viewportCtrl] selectItemAtIndex:0];
        type(6005, @"48");
        type(6009, @"Other");
        pressCancel();
    });
    EXPECT_EQ(result, 2);
    expectNothingChanged();
}

TEST_F(TurnTableWindow, TheButtonOfTheWindowItselfIsCancel) {
    const int result = run([] {
        type(6005, @"48");
        [[NSApp modalWindow] performClose:nil];
    });
    EXPECT_EQ(result, 2);
    expectNothingChanged();
}

TEST_F(TurnTableWindow, ATextThatIsNoNumberIsToldAndCanBeMended) {
    const int result = run([&] {
        type(6005, @"many");
        pressOK();
        ASSERT_EQ(front_end.messages().size(), 1u);
        EXPECT_STREQ([[field(6005) stringValue] UTF8String], "many");
        ASSERT_TRUE([[NSApp modalWindow] isVisible]);
        type(6005, @"36");
        pressOK();
    });
    EXPECT_EQ(result, 1);
    EXPECT_EQ(dialog.m_frame_count, 36);
}

TEST_F(TurnTableWindow, ARefusedCountIsForgottenWhenThePersonGivesUp) {
    const int result = run([&] {
        type(6005, @"many");
        pressOK();
        pressCancel();
    });
    EXPECT_EQ(result, 2);
    EXPECT_EQ(dialog.m_frame_count, 120);
}

TEST_F(TurnTableWindow, CanBeShownAgain) {
    for (const int count : {24, 25, 26}) {
        const int result = run([&] {
            type(6005, [NSString stringWithFormat:@"%d", count]);
            pressOK();
        });
        EXPECT_EQ(result, 1);
        EXPECT_EQ(dialog.m_frame_count, count);
    }
}

TEST_F(TurnTableWindow, ASecondDialogIsRefusedWhileOneIsOpen) {
    int second_result = 0;
    const int result = run([&] {
        CTurnTableDialog second(1, L"Second", list({L"a"}), 0, list({L"b"}), 0, list({L"c"}), 0,
                                list({L"d"}), 0, nullptr);
        const quarn::Result<int> refused = quarn::runCocoaDialog(second);
        second_result = refused.ok() ? refused.value() : -100;
        EXPECT_EQ(second.m_frame_count, 1);
        type(6005, @"60");
        pressOK();
    });
    EXPECT_EQ(second_result, -1);
    EXPECT_EQ(result, 1);
    EXPECT_EQ(dialog.m_frame_count, 60);
}

/// A turntable dialog that cannot be shown, each time for another reason.
class NamedControllerDialog : public CQuarnDialog {
public:
    explicit NamedControllerDialog(const wchar_t* name) : CQuarnDialog(1, nullptr), m_name(name) {}
    const wchar_t* ControllerName() const override { return m_name; }

private:
    const wchar_t* m_name;
};

TEST_F(TurnTableWindow, ADialogThatCannotBeShownSaysWhy) {
    const auto why = [](const wchar_t* controller) {
        NamedControllerDialog shown(controller);
        const quarn::Result<int> result = quarn::runCocoaDialog(shown);
        return result.ok() ? std::string("it was shown") : result.message();
    };
    EXPECT_EQ(why(nullptr), "The dialog 1 names no Cocoa controller.");
    EXPECT_EQ(why(L"QXNobody"), "No library that is open has the Cocoa controller \"QXNobody\".");
    EXPECT_EQ(why(L"NSWindowController"), "\"NSWindowController\" is no controller of dialogs.");
    EXPECT_EQ(why(L"QXTurnTableDialogController"),
              "The Cocoa controller \"QXTurnTableDialogController\" does not serve the dialog 1.");
    EXPECT_EQ(why(L"QXDialogController"), "The nib \"\" was not found, or holds no window.");
}

class GermanTurnTableWindow : public TurnTableWindow {
protected:
    GermanTurnTableWindow() : TurnTableWindow("de") {
        const quarn::PlugInLoad load = session.loadPlugIn(ZOETRIX_PLUGIN_PATH);
        EXPECT_TRUE(load.ok()) << load.message;
    }
};

TEST_F(GermanTurnTableWindow, SpeaksTheLanguageOfTheUser) {
    run([] {
        EXPECT_STREQ([[field(40007) stringValue] UTF8String], "Drehrichtung");
        EXPECT_STREQ([[[NSApp modalWindow] title] UTF8String], "Drehteller-Animation");
        EXPECT_FALSE([field(40007) isEditable]);
        EXPECT_STREQ([[buttonThatSends(@selector(cancelDialog:)) title] UTF8String], "Abbrechen");
        EXPECT_GT(photograph("turntable-de.png"), 8);
        pressCancel();
    });
}

TEST(CocoaLibraries, NeitherTheHostNorThePlugInNeedsObjectiveC) {
    for (const std::string file : {QNCORE_LIBRARY, ZOETRIX_PLUGIN_PATH}) {
        ASSERT_TRUE(std::filesystem::exists(file));
        const std::string reads = "'" QUARN_READELF "' -d '" + file + "' | grep NEEDED | ";
        EXPECT_EQ(std::system((reads + "grep -q libKelmar").c_str()), 0) << file;
        EXPECT_NE(std::system((reads + "grep -qE 'libobjc|gnustep|QnCocoa'").c_str()), 0) << file;
    }
}

} // namespace
