#include "desktop/animation/SharedFileRow.h"

#include "desktop/documents/StartedLine.h"
#include "desktop/texts/PlainTip.h"
#include "desktop/texts/Texts.h"

#include <QHBoxLayout>
#include <QLabel>
#include <QStyle>
#include <QToolButton>

namespace quarn::desktop {

namespace {

/// The line that opens what is there with the desktop's program for it; nothing for a path that no
/// command line can hold.
std::optional<QString> openingLine(const std::filesystem::path& path) {
    const QString quoted = quotedPath(path);
    return quoted.isEmpty() ? std::nullopt : std::optional("_Run " + quoted);
}

bool isPage(const std::filesystem::path& file) {
    return file.extension() == ".html";
}

} // namespace

/// One line that gives way to the buttons: what has no room is left out in its middle.
class SharedFileRow::NarrowLabel final : public QLabel {
public:
    explicit NarrowLabel(QWidget* parent) : QLabel(parent) {
        setTextFormat(Qt::PlainText);
        setSizePolicy(QSizePolicy::Ignored, QSizePolicy::Preferred);
    }
    void showWhole(const QString& text) {
        m_whole = text;
        setAccessibleName(text);
        leaveOut();
    }

protected:
    void resizeEvent(QResizeEvent*) override { leaveOut(); }

private:
    void leaveOut() { setText(fontMetrics().elidedText(m_whole, Qt::ElideMiddle, width())); }

    QString m_whole;
};

SharedFileRow::SharedFileRow(QWidget* parent) : QWidget(parent), m_text(new NarrowLabel(this)) {
    setObjectName("sharedFileRow");
    m_text->setObjectName("sharedFileText");
    auto* const row = new QHBoxLayout(this);
    row->setContentsMargins(0, 0, 0, 0);
    row->addWidget(m_text, 1);
    m_open = addButton("sharedFileOpen", localized(L"Open", 45330),
                       localized(L"Opens the page in the browser", 45448), m_open_line);
    m_open_picture = addButton(
        "sharedFilePicture", localized(L"Open picture", 45598),
        localized(L"Opens the picture with the desktop's program for it", 45599), m_picture_line);
    m_show_in_folder =
        addButton("showInFolder", localized(L"Show in folder", 45447),
                  localized(L"Opens the folder that the file is in", 45449), m_folder_line);
    auto* const close = new QToolButton(this);
    close->setObjectName("sharedFileClose");
    close->setIcon(style()->standardIcon(QStyle::SP_TitleBarCloseButton));
    close->setToolTip(localized(L"Takes this line away; the file stays", 45450));
    close->setAccessibleName(close->toolTip());
    close->setAutoRaise(true);
    row->addWidget(close);
    connect(close, &QToolButton::clicked, this, &QWidget::hide);
}

/// @param line  that a click chooses; a member
QPushButton* SharedFileRow::addButton(const char* name, const QString& text, const QString& tip,
                                      std::optional<QString>& line) {
    auto* const button = new QPushButton(text, this);
    button->setObjectName(name);
    button->setToolTip(tip);
    connect(button, &QPushButton::clicked, this, [this, &line] { emit lineChosen(*line); });
    layout()->addWidget(button);
    return button;
}

/// The line has room for the name; the whole path is in the tip, and in the output.
void SharedFileRow::showReport(const SharedFileReport& report) {
    const QString text = qtText(report.text);
    m_text->showWhole(QString(text).replace(qtText(report.file), qtText(report.file.filename())));
    m_text->setToolTip(plainTip(text));
    std::error_code unknown;
    const std::filesystem::path file = std::filesystem::absolute(report.file, unknown);
    m_folder_line = report.is_made ? openingLine(file.parent_path()) : std::nullopt;
    m_open_line = report.is_made && isPage(file) ? openingLine(file) : std::nullopt;
    m_picture_line = report.is_made && !report.picture.empty()
                         ? openingLine(std::filesystem::absolute(report.picture, unknown))
                         : std::nullopt;
    m_open_picture->setVisible(m_picture_line.has_value());
    m_show_in_folder->setVisible(m_folder_line.has_value());
    m_open->setVisible(m_open_line.has_value());
    show();
}

void SharedFileRow::setFree(bool is_free) {
    m_show_in_folder->setEnabled(is_free);
    m_open->setEnabled(is_free);
    m_open_picture->setEnabled(is_free);
}

} // namespace quarn::desktop
