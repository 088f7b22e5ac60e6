#include "desktop/dialogs/UpAxisDialog.h"

#include "desktop/texts/Texts.h"

#include <QHBoxLayout>
#include <QKeyEvent>
#include <QLabel>
#include <QPainter>
#include <QVBoxLayout>

namespace quarn::desktop {

namespace {

constexpr qreal MARK_WIDTH = 2.0;

/// A picture to click on. The one with the keyboard has a frame: a picture leaves no room for the
/// style's own mark.
class PictureButton final : public QToolButton {
public:
    using QToolButton::QToolButton;

protected:
    void paintEvent(QPaintEvent* event) override {
        QToolButton::paintEvent(event);
        if (!hasFocus())
            return;
        QPainter painter(this);
        painter.setPen(QPen(palette().color(QPalette::Highlight), MARK_WIDTH));
        painter.drawRect(QRectF(rect()).adjusted(1, 1, -1, -1));
    }
};

QString axisName(ModelUp up) {
    return up == ModelUp::y ? "Y" : "Z";
}

/// The file's name is never taken for markup.
QLabel* makeQuestion(const QString& file, QWidget* parent) {
    auto* const label =
        new QLabel(localized(L"%1 does not say which of its axes points up.\nIn which picture does "
                             L"the model stand as it should?",
                             45434)
                       .arg(file),
                   parent);
    label->setObjectName("question");
    label->setTextFormat(Qt::PlainText);
    return label;
}

} // namespace

UpAxisDialog::UpAxisDialog(QWidget* owner, const QString& file, const Way& taken, const Way& other)
    : QDialog(owner), m_taken(makeButton(taken, localized(L"&%1 points up, as usual", 45435))) {
    setObjectName("upAxis");
    setWindowTitle(localized(L"Which way is up?", 45433));
    setWindowModality(Qt::ApplicationModal);
    auto* const pictures = new QHBoxLayout;
    pictures->setSpacing(16);
    pictures->addWidget(m_taken);
    pictures->addWidget(makeButton(other, localized(L"&%1 points up", 45436)));
    m_never_again = new QCheckBox(localized(L"&Don't ask again", 45437), this);
    m_never_again->setObjectName("neverAgain");
    m_never_again->setToolTip(
        localized(L"File > Ask which way is up brings the question back.", 45438));
    auto* const column = new QVBoxLayout(this);
    column->setContentsMargins(18, 18, 18, 14);
    column->setSpacing(14);
    column->addWidget(makeQuestion(file, this));
    column->addLayout(pictures);
    column->addWidget(m_never_again);
    column->setSizeConstraint(QLayout::SetFixedSize);
    m_taken->setFocus();
}

QToolButton* UpAxisDialog::makeButton(const Way& way, const QString& caption) {
    auto* const button = new PictureButton(this);
    button->setObjectName("up" + axisName(way.up));
    button->setText(caption.arg(axisName(way.up)));
    button->setIcon(way.picture);
    button->setIconSize(way.picture.deviceIndependentSize().toSize());
    button->setToolButtonStyle(Qt::ToolButtonTextUnderIcon);
    button->setFocusPolicy(Qt::StrongFocus);
    connect(button, &QToolButton::clicked, this, [this, up = way.up] {
        m_choice = up;
        accept();
    });
    return button;
}

/// Enter clicks the picture that has the keyboard, as it does with other buttons.
void UpAxisDialog::keyPressEvent(QKeyEvent* event) {
    if (event->key() != Qt::Key_Return && event->key() != Qt::Key_Enter) {
        QDialog::keyPressEvent(event);
        return;
    }
    auto* const focused = qobject_cast<QToolButton*>(focusWidget());
    (focused ? focused : m_taken)->click();
}

} // namespace quarn::desktop
