#pragma once

#include "host/commands/FormAsking.h"
#include "tests/host/app/TestCommand.h"
#include "tests/host/document/DocumentFixtures.h"

#include <gmock/gmock.h>

namespace quarn::test {

/// A session whose commands find the host's own forms, and a person who answers them.
class FormTest : public ::testing::Test {
protected:
    static SessionOptions options() {
        SessionOptions options;
        options.language = "C";
        options.dialog_folders = {std::filesystem::path(QUARN_SOURCE_DIR) / "host" / "dialogs" /
                                  "templates"};
        return options;
    }

    /// Runs a command as one that a person chose in a menu, who then does this in its form.
    CQuarnCommand::result answer(const wchar_t* line, HeadlessDialogWindow::Script script) {
        front_end.addDialog(std::move(script));
        return session.runCommand(line, true);
    }
    /// What a person is told who enters this and presses OK. The form must stay open.
    std::wstring refusal(const wchar_t* line, int control, std::wstring_view text) {
        const std::size_t before = front_end.messages().size();
        const auto ended = answer(line, [&](HeadlessDialogWindow& form) {
            EXPECT_TRUE(form.type(control, text));
            form.pressOk();
            EXPECT_TRUE(form.isOpen());
            EXPECT_EQ(form.focusedControl(), control);
            form.pressCancel();
        });
        EXPECT_EQ(ended, CQuarnCommand::cancel);
        return front_end.messages().size() > before ? front_end.messages().back().text : L"";
    }
    Document& document() { return Document::of(session.document()); }
    ViewState& view() { return document().activeView(); }
    std::string printed() const { return KM_wString(front_end.printed()).ToUtf8(); }

    ScriptedFrontEnd front_end;
    Session session{front_end, options()};
};

} // namespace quarn::test
