#include "sdk/cocoa/QXDialogController.h"

#include "host/cocoa/DialogEvents.h"
#include "host/cocoa/NibFile.h"

@implementation QXDialogController

- (id)init {
    NSString* const name = [self nibName];
    return name ? [self initWithWindowNibName:name] : [self initWithWindow:nil];
}

- (NSString*)nibName {
    return nil;
}

- (NSString*)windowNibPath {
    NSString* const name = [self nibName];
    return name ? quarn::nibFile(name, [self class]) : nil;
}

- (int)titleTextId {
    return 0;
}

- (NSArray*)bindingKeyNames {
    return [NSArray array];
}

- (CQuarnDialog*)quarnDialog {
    return _quarnDialog;
}

- (void)setQuarnDialog:(CQuarnDialog*)dialog {
    _quarnDialog = dialog;
}

- (void)windowDidLoad {
    [super windowDidLoad];
}

- (void)willCloseDialog {
}

- (void)setDialogEvents:(quarn::DialogEvents*)events {
    _dialogEvents = events;
}

- (IBAction)confirmDialog:(id)sender {
    (void)sender;
    // Ends what is being typed, so that the bound key has it.
    [[self window] makeFirstResponder:nil];
    if (_dialogEvents) {
        _dialogEvents->confirmed();
    }
}

- (IBAction)cancelDialog:(id)sender {
    (void)sender;
    if (_dialogEvents) {
        _dialogEvents->givenUp();
    }
}

- (IBAction)pressDialogButton:(id)sender {
    if (_dialogEvents) {
        _dialogEvents->buttonClicked(static_cast<int>([sender tag]));
    }
}

/// The window's own button gives up; who closes the window is the dialog.
- (BOOL)windowShouldClose:(id)sender {
    [self cancelDialog:sender];
    return _dialogEvents == nullptr;
}

@end
