#pragma once

#include "host/front_end/HeadlessDialogWindow.h"
#include "host/front_end/ScriptedFrontEnd.h"
#include "host/session/Session.h"
#include "kelmar/KM_Array.h"
#include "kelmar/KM_wString.h"
#include "sdk/qncore/QnDialog.h"

#include <gtest/gtest.h>

#include <string>
#include <utility>
#include <vector>

using Names = KM_ClassArray<KM_wString>;
using Texts = std::vector<std::wstring>;
using FormWindow = quarn::HeadlessDialogWindow;

/// A host without a person and without the plug-in's commands, whose templates are the plug-in's.
class FormFixture : public ::testing::Test {
protected:
    explicit FormFixture(const std::string& language = "C")
        : session(front_end, options(language)) {}

    /// Shows a form to a person who does this.
    int show(CDialog& form, FormWindow::Script script) {
        front_end.addDialog(std::move(script));
        return form.DoModal();
    }
    /// Confirms a form as it is shown.
    int confirm(CDialog& form) {
        return show(form, [](FormWindow& window) { window.pressOk(); });
    }
    /// What a person was told; empty when nothing was.
    std::wstring lastMessage() const {
        return front_end.messages().empty() ? L"" : front_end.messages().back().text;
    }

    /// `count` names that differ: A, B, C...
    static Names names(int count) {
        Names list;
        for (int i = 0; i < count; ++i)
            list.Append(KM_wString::FormatToString(L"%c", 'A' + i));
        return list;
    }

    quarn::ScriptedFrontEnd front_end;
    quarn::Session session;

private:
    static quarn::SessionOptions options(const std::string& language) {
        const std::filesystem::path sources = QUARN_SOURCE_DIR;
        quarn::SessionOptions options;
        options.language = language;
        options.locale_folders = {sources / "zoetrix" / "locale"};
        options.dialog_folders = {sources / "zoetrix" / "dialogs"};
        return options;
    }
};
