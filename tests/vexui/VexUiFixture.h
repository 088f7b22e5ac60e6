#pragma once

#include "sdk/qncore/qncore.h"
#include "sdk/vexui/VexUi.h"
#include "tests/vexui/VexUiSession.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <QApplication>
#include <QComboBox>
#include <QDateEdit>
#include <QDialog>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QSpinBox>
#include <QTest>
#include <QTimeEdit>

#include <functional>
#include <memory>

/// The lists of a dialog, as the animation plug-in hands them over.
class DialogLists final : public IZoetrixDataUI {
public:
    using Texts = KM_ClassArray<KM_wString>;
    struct List {
        Texts entries;
        int selection = 0;
    };

    const Texts& FileList() const override { return files.entries; }
    void SetFileList(const Texts& list) override { files.entries = list; }
    int FileListSelection() const override { return files.selection; }
    void SetFileListSelection(int selection) override { files.selection = selection; }
    const Texts& CaptureList() const override { return captures.entries; }
    void SetCaptureList(const Texts& list) override { captures.entries = list; }
    int CaptureListSelection() const override { return captures.selection; }
    void SetCaptureListSelection(int selection) override { captures.selection = selection; }
    const Texts& ViewportList() const override { return viewports.entries; }
    void SetViewportList(const Texts& list) override { viewports.entries = list; }
    int ViewportListSelection() const override { return viewports.selection; }
    void SetViewportListSelection(int selection) override { viewports.selection = selection; }
    const Texts& DirectionList() const override { return directions.entries; }
    void SetDirectionList(const Texts& list) override { directions.entries = list; }
    int DirectionListSelection() const override { return directions.selection; }
    void SetDirectionListSelection(int selection) override { directions.selection = selection; }
    HWND Parent() const override { return reinterpret_cast<HWND>(parent); }
    int EVF(const wchar_t*, void*) override { return 0; }

    List files;
    List captures;
    List viewports;
    List directions;
    QWidget* parent = nullptr;
};

/// A list of these entries.
DialogLists::List listOf(std::initializer_list<const wchar_t*> entries, int selection = 0);

/// A host with both plug-ins, as files, in a program with Qt's application. Whoever opens a form
/// says first what the person does in it.
class VexUiFixture : public ::testing::Test {
protected:
    explicit VexUiFixture(const std::string& language = "C");
    ~VexUiFixture() override;

    void start(const std::string& language);

    using Person = std::function<void(QDialog&)>;
    /// Has the person answer the next form. A form that is still open then is closed, and the test
    /// fails.
    void next(Person person);
    /// Opens a form on `lists` and `record`. @return whether it was confirmed
    bool open(QnZoetrixVexUiDialog dialog, Person person);
    bool openTurntable(Person person);
    bool openPath(Person person);
    bool openDay(Person person);
    bool openSeason(Person person);

    std::wstring printed() const { return front_end.printed(); }
    KM_3dmAnimationProperties stored() {
        return session->document().Properties().AnimationProperties();
    }

    quarn::test::TempFolder folder;
    quarn::ScriptedFrontEnd front_end;
    std::unique_ptr<quarn::Session> session;
    DialogLists lists;
    KM_3dmAnimationProperties record;

private:
    void answer();

    QObject m_alive; ///< a form that does not come is not waited for after the test
    std::string m_language;
    Person m_person;
    bool m_was_opened = true;
};

// ---- What a person sees and does

/// The field with this name.
template <class Field> Field& field(QDialog& form, const char* name) {
    auto* const found = form.findChild<Field*>(QString::fromLatin1(name));
    if (!found)
        throw std::runtime_error(std::string("the form has no field ") + name);
    return *found;
}

/// Types over all that stands in a field, key by key.
void type(QWidget& field, const char* text);
void typeInto(QDialog& form, const char* name, const char* text);
/// What stands in a field.
std::string textIn(QDialog& form, const char* name);
/// The line beneath the fields.
std::string lineOf(QDialog& form);
/// Whether a field is marked as one that cannot be taken.
bool isMarked(QDialog& form, const char* name);
void choose(QDialog& form, const char* name, int entry);
void press(QWidget& widget, Qt::Key key);
void click(QDialog& form, const char* button);
