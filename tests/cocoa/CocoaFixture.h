#pragma once

#include "host/front_end/ScriptedFrontEnd.h"
#include "host/session/Session.h"
#include "zoetrix/ui/QXTurnTableDialogController.h"
#include "zoetrix/ui/TurnTableDialog.h"

#include <functional>
#include <gtest/gtest.h>
#include <initializer_list>
#include <memory>
#include <string>

/// An application with a display, a running host, and a turntable dialog with filled lists.
class CocoaTest : public testing::Test {
protected:
    /// @param language  of the host's texts
    explicit CocoaTest(const std::string& language = "en");
    ~CocoaTest() override;

    static KM_ClassArray<KM_wString> list(std::initializer_list<const wchar_t*> texts);

    NSAutoreleasePool* pool;
    quarn::ScriptedFrontEnd front_end;
    quarn::Session session;
    CTurnTableDialog dialog;
};

/// Calls `action` once the next modal window has been on the display for a moment.
void onceTheWindowIsThere(std::function<void()> action);
