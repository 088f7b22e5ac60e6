#include "zoetrix/ui/QXTurnTableDialogController.h"

#include "sdk/cocoa/QXPopUpButton.h"
#include "sdk/cocoa/QXText.h"
#include "zoetrix/ui/TurnTableDialog.h"

@implementation QXTurnTableDialogController

@synthesize directionCtrl;
@synthesize fileTypeCtrl;
@synthesize captureMethodCtrl;
@synthesize viewportCtrl;

- (NSString*)nibName {
    return @"QXTurnTableDialog";
}

- (int)titleTextId {
    return 40501;
}

- (NSArray*)bindingKeyNames {
    return [NSArray arrayWithObjects:@"frameCount", @"name", nil];
}

- (int)frameCount {
    return _turnTableDialog ? _turnTableDialog->m_frame_count : 0;
}

- (void)setFrameCount:(int)count {
    if (_turnTableDialog) {
        _turnTableDialog->m_frame_count = count;
    }
}

- (NSString*)name {
    return [NSString stringWithLPCTSTR:_turnTableDialog ? _turnTableDialog->m_name.Array() : L""];
}

- (void)setName:(NSString*)name {
    if (_turnTableDialog) {
        _turnTableDialog->m_name = name ? [name KMwString] : KM_wString();
    }
}

- (CQuarnDialog*)quarnDialog {
    return _turnTableDialog;
}

- (void)setQuarnDialog:(CQuarnDialog*)dialog {
    _turnTableDialog = dynamic_cast<CTurnTableDialog*>(dialog);
}

- (void)windowDidLoad {
    [super windowDidLoad];
    if (!_turnTableDialog) {
        return;
    }
    _turnTableDialog->m_direction.m_combo.SetControl(QXMakePopUpControl(directionCtrl));
    _turnTableDialog->m_file_type.m_combo.SetControl(QXMakePopUpControl(fileTypeCtrl));
    _turnTableDialog->m_capture.m_combo.SetControl(QXMakePopUpControl(captureMethodCtrl));
    _turnTableDialog->m_viewport.m_combo.SetControl(QXMakePopUpControl(viewportCtrl));
}

- (void)willCloseDialog {
    [super willCloseDialog];
    if (!_turnTableDialog) {
        return;
    }
    _turnTableDialog->m_direction.m_combo.SetControl(nullptr);
    _turnTableDialog->m_file_type.m_combo.SetControl(nullptr);
    _turnTableDialog->m_capture.m_combo.SetControl(nullptr);
    _turnTableDialog->m_viewport.m_combo.SetControl(nullptr);
}

@end
