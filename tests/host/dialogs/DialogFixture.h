#pragma once

#include "host/app/Application.h"
#include "host/front_end/HeadlessDialogWindow.h"
#include "host/front_end/ScriptedFrontEnd.h"
#include "host/session/Session.h"
#include "sdk/qncore/QnDialog.h"
#include "tests/support/TempFolder.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <functional>
#include <string>

namespace quarn::test {

/// The ids of the sample template.
enum SampleId : int {
    sample_form = 7001,
    text_id = 7101,
    number_id = 7102,
    integer_id = 7103,
    date_id = 7104,
    time_id = 7105,
    list_id = 7106,
    button_id = 7107,
    no_id = 7999, ///< of no control
};

inline constexpr const char* SAMPLE_FORM = R"({
    "id": 7001,
    "title": {"text": "Sample", "id": 90001},
    "controls": [
        {"id": 7101, "kind": "text", "label": {"text": "Name", "id": 90002},
         "hint": {"text": "What it is called", "id": 90003}},
        {"id": 7102, "kind": "number", "label": {"text": "Angle"}},
        {"id": 7103, "kind": "integer", "label": {"text": "Count"}},
        {"id": 7104, "kind": "date", "label": {"text": "Day"}},
        {"id": 7105, "kind": "time", "label": {"text": "Hour"}},
        {"id": 7106, "kind": "combo_box", "label": {"text": "Colour"}},
        {"id": 7107, "kind": "button", "label": {"text": "Mix..."}, "joins_row": true}
    ]
})";

/// A dialog of every kind of control.
class SampleDialog : public CQuarnDialog {
public:
    explicit SampleDialog(CWnd* parent = nullptr) : CQuarnDialog(sample_form, parent) {
        AttachComboBox(list_id, colours);
    }
    using CDialog::EndDialog;

    KM_wString name = L"Walk";
    double angle = 12.5;
    int count = 24;
    COleDateTime day{2026, 6, 21, 4, 5, 6};
    COleDateTime hour{1999, 12, 31, 14, 30, 15};
    CComboBox colours;
    int buttons_clicked = 0;
    int last_button = 0;
    int inits = 0;
    int give_ups = 0;
    /// Called instead of, or in, the operation of this name.
    std::function<void(SampleDialog&)> on_init;
    std::function<void(SampleDialog&)> on_button;
    std::function<void(SampleDialog&)> on_ok;

protected:
    void DoDataExchange(CQnDialogExchange& exchange) override {
        CQuarnDialog::DoDataExchange(exchange);
        DDX_Text(exchange, text_id, name);
        DDX_Text(exchange, number_id, angle);
        DDV_MinMaxDouble(exchange, angle, -90.0, 90.0);
        DDX_Text(exchange, integer_id, count);
        DDX_DateTimeCtrl(exchange, date_id, day);
        DDX_DateTimeCtrl(exchange, time_id, hour);
    }
    int OnInitDialog() override {
        ++inits;
        CQuarnDialog::OnInitDialog();
        for (const wchar_t* colour : {L"red", L"green", L"blue"})
            colours.InsertString(-1, colour);
        colours.SetCurSel(1);
        if (on_init)
            on_init(*this);
        return 1;
    }
    void OnOK() override {
        if (on_ok)
            on_ok(*this);
        else
            CQuarnDialog::OnOK();
    }
    void OnCancel() override {
        ++give_ups;
        CQuarnDialog::OnCancel();
    }
    void OnButton(int control) override {
        ++buttons_clicked;
        last_button = control;
        if (on_button)
            on_button(*this);
    }
};

/// A session in English whose templates stand in a folder of the test, with the sample in it.
class DialogTest : public ::testing::Test {
protected:
    DialogTest() : session(front_end, options(folder.path())) {
        writeFile(folder / "7001.dialog.json", SAMPLE_FORM);
    }

    static SessionOptions options(const std::filesystem::path& dialogs) {
        SessionOptions options;
        options.language = "C";
        options.dialog_folders = {dialogs};
        return options;
    }

    /// Shows the dialog to a person who does this.
    int show(CDialog& dialog, HeadlessDialogWindow::Script script) {
        front_end.addDialog(std::move(script));
        return dialog.DoModal();
    }
    /// What a person was told last when the sample's control holds `text` and OK is pressed; empty
    /// when it was taken.
    std::wstring refusal(int control, std::wstring_view text) {
        const std::size_t before = front_end.messages().size();
        show(sample, [&](HeadlessDialogWindow& window) {
            EXPECT_TRUE(window.type(control, text));
            window.pressOk();
        });
        return front_end.messages().size() > before ? front_end.messages().back().text : L"";
    }
    std::string printed() const { return KM_wString(front_end.printed()).ToUtf8(); }

    TempFolder folder;
    ScriptedFrontEnd front_end;
    Session session;
    SampleDialog sample;
};

} // namespace quarn::test
