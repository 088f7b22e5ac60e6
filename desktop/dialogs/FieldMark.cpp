#include "desktop/dialogs/FieldMark.h"

#include "desktop/texts/PlainTip.h"

#include <QAction>
#include <QLineEdit>
#include <QPainter>
#include <QPixmap>

namespace quarn::desktop {
namespace {

const char* const MARK_NAME = "mark";
const QColor WARNING(211, 47, 47);

QIcon warningSign() {
    QPixmap sign(64, 64);
    sign.fill(Qt::transparent);
    QPainter painter(&sign);
    painter.setRenderHint(QPainter::Antialiasing);
    painter.setPen(Qt::NoPen);
    painter.setBrush(WARNING);
    painter.drawEllipse(6, 6, 52, 52);
    painter.setBrush(Qt::white);
    painter.drawRoundedRect(28, 16, 8, 22, 4, 4);
    painter.drawEllipse(28, 42, 8, 8);
    return QIcon(sign);
}

QColor tinted(const QColor& ground) {
    constexpr double share = 0.18;
    const auto mix = [](int from, int to) { return static_cast<int>(from + share * (to - from)); };
    return {mix(ground.red(), WARNING.red()), mix(ground.green(), WARNING.green()),
            mix(ground.blue(), WARNING.blue())};
}

QAction* markOf(const QLineEdit& field) {
    return field.findChild<QAction*>(MARK_NAME, Qt::FindDirectChildrenOnly);
}

QAction* addMark(QLineEdit& field) {
    QAction* const mark = field.addAction(warningSign(), QLineEdit::TrailingPosition);
    mark->setObjectName(MARK_NAME);
    QPalette palette = field.palette();
    palette.setColor(QPalette::Base, tinted(palette.color(QPalette::Base)));
    field.setPalette(palette);
    return mark;
}

} // namespace

void markField(QLineEdit& field, const QString& why) {
    QAction* mark = markOf(field);
    if (why.isEmpty()) {
        delete mark;
        field.setPalette({});
        field.setAccessibleDescription({});
        return;
    }
    if (!mark)
        mark = addMark(field);
    mark->setText(why);
    mark->setToolTip(plainTip(why));
    field.setAccessibleDescription(why);
}

QColor warningColour(const QPalette& palette) {
    return palette.color(QPalette::Window).lightness() < 128 ? QColor(255, 138, 128)
                                                             : QColor(183, 28, 28);
}

bool isMarked(const QLineEdit& field) {
    return markOf(field) != nullptr;
}

} // namespace quarn::desktop
