#pragma once

#include <AppKit/AppKit.h>

class CQuarnDialog;
namespace quarn {
class DialogEvents;
} // namespace quarn

/// The window controller that shows a CQuarnDialog where windows are made with Cocoa. A dialog
/// names its controller class (CQuarnDialog::ControllerName); the host makes an object of it, hands
/// it the dialog, loads its window and runs that until it is closed. docs/cocoa.md has the whole
/// way.
///
/// The window comes from the nib that `nibName` names, with the controller as its File's Owner:
/// - a control of the dialog has the control's id as its tag;
/// - the value of a control may be bound to a key of the controller;
/// - OK, Cancel and other buttons send `confirmDialog:`, `cancelDialog:` and `pressDialogButton:`;
/// - a label shows the text with the id that is its tag in the user's language.
///
/// Made for manual retain and release: compile it, and what stands on it, without ARC.
@interface QXDialogController : NSWindowController {
@private
    CQuarnDialog* _quarnDialog;
    quarn::DialogEvents* _dialogEvents;
}

/// The name of the nib, without an ending, which is looked for among the resources of the bundle
/// and in `share/quarn/cocoa/` of the tree that the controller's library lies in. The base has
/// none.
- (NSString*)nibName;

/// The id of the window's title in the string tables; 0, as the base has it, leaves the nib's.
- (int)titleTextId;

/// The keys of the controller that the nib binds to controls of the window. They are shown when the
/// window opens, written when it is confirmed, and put back when it is given up after all.
/// @return NSStrings; the base has none
- (NSArray*)bindingKeyNames;

/// The dialog that is served; null when there is none. Not owned: it outlives the window.
- (CQuarnDialog*)quarnDialog;
/// A subclass that serves one class of dialogs keeps no other.
- (void)setQuarnDialog:(CQuarnDialog*)dialog;

/// Called once the nib's outlets are set, before the dialog fills its controls.
- (void)windowDidLoad;

/// Called when the dialog ends, before its window closes. The base does nothing.
- (void)willCloseDialog;

/// What the buttons of the window send. Without an open dialog they do nothing.
- (IBAction)confirmDialog:(id)sender;
- (IBAction)cancelDialog:(id)sender;
/// @param sender  the button; its tag is the id that the dialog is told
- (IBAction)pressDialogButton:(id)sender;

@end
