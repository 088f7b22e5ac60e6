#include "host/cocoa/CocoaDialogs.h"

#include "host/cocoa/BoundKeys.h"
#include "host/cocoa/CocoaDialogWindow.h"
#include "host/cocoa/TextOf.h"
#include "host/cocoa/WindowTexts.h"
#include "sdk/cocoa/QXDialogController.h"
#include "sdk/cocoa/QXText.h"

#include <string>

namespace quarn {
namespace {

/// What is made and autoreleased while this lives is released when it ends.
class Pool {
public:
    Pool() : m_pool([[NSAutoreleasePool alloc] init]) {}
    ~Pool() { [m_pool drain]; }
    Pool(const Pool&) = delete;
    Pool& operator=(const Pool&) = delete;

private:
    NSAutoreleasePool* m_pool;
};

/// The controller of one dialog, closed and released at the end.
class Controller {
public:
    Controller(Class type, CQuarnDialog& dialog) : m_controller([[type alloc] init]) {
        [m_controller setQuarnDialog:&dialog];
    }
    ~Controller() {
        // The window belongs to the controller, whatever its nib says.
        NSWindow* const window = [m_controller isWindowLoaded] ? [m_controller window] : nil;
        [window setDelegate:nil];
        [window setReleasedWhenClosed:NO];
        [m_controller close];
        [m_controller setQuarnDialog:nullptr];
        [m_controller release];
    }
    Controller(const Controller&) = delete;
    Controller& operator=(const Controller&) = delete;

    QXDialogController* get() const { return m_controller; }

private:
    QXDialogController* m_controller;
};

std::string quoted(const KM_wString& text) {
    return "\"" + text.ToUtf8() + "\"";
}

Result<Class> controllerClass(const CQuarnDialog& dialog) {
    const wchar_t* const name = dialog.ControllerName();
    if (!name) {
        return Error{"The dialog " + std::to_string(dialog.TemplateId()) +
                     " names no Cocoa controller."};
    }
    const Class found = NSClassFromString([NSString stringWithLPCTSTR:name]);
    if (!found) {
        return Error{"No library that is open has the Cocoa controller " + quoted(name) + "."};
    }
    if (![found isSubclassOfClass:[QXDialogController class]]) {
        return Error{quoted(name) + " is no controller of dialogs."};
    }
    return found;
}

Result<void> loadWindow(QXDialogController* controller, const CQuarnDialog& dialog) {
    if ([controller quarnDialog] != &dialog) {
        return Error{"The Cocoa controller " + quoted(dialog.ControllerName()) +
                     " does not serve the dialog " + std::to_string(dialog.TemplateId()) + "."};
    }
    if (![controller windowNibPath] || ![controller window]) {
        return Error{"The nib " + quoted(textOf([controller nibName])) +
                     " was not found, or holds no window."};
    }
    return {};
}

int runWindow(QXDialogController* controller, const BoundKeys& keys, CQuarnDialog& dialog) {
    CocoaDialogWindow window(controller, keys);
    const int result = dialog.DoModalIn(window);
    if (result != QnDialogConfirmed) {
        keys.putBack();
    }
    return result;
}

} // namespace

Result<int> runCocoaDialog(CQuarnDialog& dialog) {
    const Pool pool;
    [NSApplication sharedApplication];
    const Result<Class> type = controllerClass(dialog);
    if (!type) {
        return type.error();
    }
    const Controller controller(type.value(), dialog);
    if (const Result<void> loaded = loadWindow(controller.get(), dialog); !loaded) {
        return loaded.error();
    }
    const Result<BoundKeys> keys = BoundKeys::takeOver(controller.get());
    if (!keys) {
        return keys.error();
    }
    localizeWindow(controller.get());
    return runWindow(controller.get(), keys.value(), dialog);
}

} // namespace quarn
