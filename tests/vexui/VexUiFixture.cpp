#include "tests/vexui/VexUiFixture.h"

#include <QKeyEvent>
#include <QTimer>

#include <cstdlib>

DialogLists::List listOf(std::initializer_list<const wchar_t*> entries, int selection) {
    DialogLists::List list;
    for (const wchar_t* entry : entries)
        list.entries.Append(entry);
    list.selection = selection;
    return list;
}

VexUiFixture::VexUiFixture(const std::string& language) {
    start(language);
    lists.files = listOf({L"jpg", L"bmp", L"png", L"tga"}, 2);
    lists.captures = listOf({L"RenderFull", L"RenderPreview", L"Wireframe", L"Rendered"}, 3);
    lists.viewports = listOf({L"Top", L"Front", L"Right", L"Perspective"}, 3);
    lists.directions = listOf({L"Clockwise", L"AntiClockwise"}, 1);
    record.SetHtmlFilename(L"Walk");
    record.SetFrameCount(36);
}

VexUiFixture::~VexUiFixture() = default;

void VexUiFixture::start(const std::string& language) {
    session.reset();
    m_language = language;
    session = std::make_unique<quarn::Session>(front_end, vexUiOptions(folder.path(), language));
    for (const char* file : {ZOETRIX_PLUGIN_PATH, VEXUI_PLUGIN_PATH}) {
        const quarn::PlugInLoad load = session->loadPlugIn(file);
        EXPECT_TRUE(load.ok()) << load.message;
    }
}

void VexUiFixture::next(Person person) {
    m_person = std::move(person);
    m_was_opened = false;
    QTimer::singleShot(0, &m_alive, [this] { answer(); });
}

void VexUiFixture::answer() {
    auto* const form = dynamic_cast<QDialog*>(QApplication::activeModalWidget());
    if (!form)
        return;
    m_was_opened = true;
    EXPECT_TRUE(QTest::qWaitForWindowActive(form));
    if (const char* pictures = std::getenv("QUARN_FORM_PICTURES"))
        form->grab().save(QString::fromUtf8(pictures) + QLatin1Char('/') + form->objectName() +
                          QLatin1Char('-') + QString::fromStdString(m_language) +
                          QString::fromLatin1(".png"));
    const QPointer<QDialog> alive(form);
    try {
        m_person(*form);
    } catch (const std::exception& error) {
        ADD_FAILURE() << error.what();
    }
    if (!alive || !alive->isVisible())
        return;
    ADD_FAILURE() << "the form is still open: " << lineOf(*form);
    form->reject();
}

bool VexUiFixture::open(QnZoetrixVexUiDialog dialog, Person person) {
    if (!dialog)
        throw std::runtime_error("there is no such dialog");
    next(std::move(person));
    const bool confirmed = dialog(lists, record);
    EXPECT_TRUE(m_was_opened) << "no form was opened";
    return confirmed;
}

bool VexUiFixture::openTurntable(Person person) {
    return open(QnZoetrixVexUiTurnTable(), std::move(person));
}

bool VexUiFixture::openPath(Person person) {
    return open(QnZoetrixVexUiPathAnimation(), std::move(person));
}

bool VexUiFixture::openDay(Person person) {
    return open(QnZoetrixVexUiDay(), std::move(person));
}

bool VexUiFixture::openSeason(Person person) {
    return open(QnZoetrixVexUiSeason(), std::move(person));
}

void type(QWidget& field, const char* text) {
    field.setFocus();
    QTest::keyClick(&field, Qt::Key_A, Qt::ControlModifier);
    QTest::keyClick(&field, Qt::Key_Delete);
    for (const QChar letter : QString::fromUtf8(text)) {
        QKeyEvent key(QEvent::KeyPress, 0, Qt::NoModifier, QString(letter));
        QApplication::sendEvent(&field, &key);
    }
}

void typeInto(QDialog& form, const char* name, const char* text) {
    type(field<QWidget>(form, name), text);
}

std::string textIn(QDialog& form, const char* name) {
    QWidget& widget = field<QWidget>(form, name);
    if (const auto* box = qobject_cast<QComboBox*>(&widget))
        return box->currentText().toStdString();
    if (const auto* spin = qobject_cast<QAbstractSpinBox*>(&widget))
        return spin->text().toStdString();
    if (const auto* label = qobject_cast<QLabel*>(&widget))
        return label->text().toStdString();
    return field<QLineEdit>(form, name).text().toStdString();
}

std::string lineOf(QDialog& form) {
    return textIn(form, "outcome");
}

bool isMarked(QDialog& form, const char* name) {
    QWidget& widget = field<QWidget>(form, name);
    const bool has_colour =
        widget.palette().color(QPalette::Base) != form.palette().color(QPalette::Base);
    EXPECT_EQ(has_colour, !widget.accessibleDescription().isEmpty()) << name;
    return has_colour;
}

void choose(QDialog& form, const char* name, int entry) {
    QComboBox& box = field<QComboBox>(form, name);
    box.setFocus();
    press(box, Qt::Key_Home);
    for (int i = 0; i < entry; ++i)
        press(box, Qt::Key_Down);
}

void press(QWidget& widget, Qt::Key key) {
    QTest::keyClick(&widget, key);
}

void click(QDialog& form, const char* button) {
    QTest::mouseClick(&field<QPushButton>(form, button), Qt::LeftButton);
}
