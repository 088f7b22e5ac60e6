#pragma once

#include "sdk/qncore/qncore.h"

/// Asks for the fog of a picture.
class CFogDialog : public CQuarnDialog {
public:
    static constexpr int template_id = 300;

    explicit CFogDialog(CWnd* parent) : CQuarnDialog(template_id, parent) {
        AttachComboBox(302, m_colors);
    }

    double m_density = 0.5;
    int m_color = 0;

protected:
    void DoDataExchange(CQnDialogExchange& exchange) override {
        CQuarnDialog::DoDataExchange(exchange);
        DDX_Text(exchange, 301, m_density);
        DDV_MinMaxDouble(exchange, m_density, 0.0, 1.0);
    }

    int OnInitDialog() override {
        CQuarnDialog::OnInitDialog(); // shows the members
        for (const wchar_t* color : {L"White", L"Grey"})
            m_colors.InsertString(-1, color);
        m_colors.SetCurSel(m_color);
        return 1;
    }

    void OnOK() override {
        m_color = m_colors.GetCurSel();
        CQuarnDialog::OnOK(); // reads the controls, and closes when all could be taken
    }

    void OnButton(int control) override {
        if (control == 303)
            SetDlgItemText(301, L"0.5");
    }

private:
    CComboBox m_colors;
};
