#pragma once

#include "sdk/cocoa/QXDialogController.h"

class CTurnTableDialog;

/// Shows the turntable dialog in a Cocoa window: the frame count and the name by bound keys, the
/// four lists by pop-up buttons that it hands to the dialog's combo boxes.
///
/// Made for manual retain and release. The pop-up buttons belong to the window; a combo box retains
/// the one it has.
@interface QXTurnTableDialogController : QXDialogController {
@private
    CTurnTableDialog* _turnTableDialog;
    NSPopUpButton* directionCtrl;
    NSPopUpButton* fileTypeCtrl;
    NSPopUpButton* captureMethodCtrl;
    NSPopUpButton* viewportCtrl;
}

@property(nonatomic, assign) IBOutlet NSPopUpButton* directionCtrl;
@property(nonatomic, assign) IBOutlet NSPopUpButton* fileTypeCtrl;
@property(nonatomic, assign) IBOutlet NSPopUpButton* captureMethodCtrl;
@property(nonatomic, assign) IBOutlet NSPopUpButton* viewportCtrl;

/// @return "QXTurnTableDialog"
- (NSString*)nibName;
/// The text "Turntable Animation".
- (int)titleTextId;
/// @return "frameCount" and "name"
- (NSArray*)bindingKeyNames;

/// The dialog's frame count; 0 without a dialog, and setting it does nothing then.
- (int)frameCount;
- (void)setFrameCount:(int)count;

/// The dialog's name for the animation; empty without a dialog, and setting it does nothing then.
- (NSString*)name;
/// @param name  nil gives an empty name
- (void)setName:(NSString*)name;

/// The dialog that is served, a CTurnTableDialog; null when there is none.
- (CQuarnDialog*)quarnDialog;
/// Keeps a CTurnTableDialog; with any other dialog, and with null, there is none from then on.
- (void)setQuarnDialog:(CQuarnDialog*)dialog;

/// Hands the pop-up buttons to the combo boxes of the dialog.
- (void)windowDidLoad;
/// Has the combo boxes release their pop-up buttons and forget them.
- (void)willCloseDialog;

@end
