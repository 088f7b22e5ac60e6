#include "desktop/views/ViewWidget.h"

#include "desktop/front_end/ShownImage.h"
#include "desktop/texts/Texts.h"
#include "desktop/views/PicturePlace.h"

#include <QPainter>

namespace quarn::desktop {

namespace {

constexpr double ACTIVE_BORDER = 2.0;
constexpr int NAME_MARGIN = 7;
constexpr QRgb BORDER = qRgb(150, 153, 158);
constexpr QRgb BEHIND_PICTURE = qRgb(52, 54, 58);

/// Readable on any picture, so it does not follow the palette.
constexpr const char* NAME_STYLE =
    "QToolButton { color: white; background: rgba(24, 26, 30, %1); border: none;"
    " border-radius: 4px; padding: 3px; font-weight: %2; }"
    "QToolButton[popupMode=\"2\"] { padding: 3px 18px 3px 8px; }"
    "QToolButton:hover, QToolButton:open { background: rgba(24, 26, 30, 230); }"
    "QToolButton:focus { border: 1px solid white; }"
    "QToolButton::menu-indicator { subcontrol-position: right center;"
    " subcontrol-origin: padding; left: -5px; }";

/// One frame for "alone", a frame in four for "all".
QIcon cornerIcon(bool is_four) {
    QPixmap pixmap(32, 32);
    pixmap.fill(Qt::transparent);
    QPainter painter(&pixmap);
    painter.setPen(QPen(Qt::white, 3));
    painter.drawRect(QRectF(5.5, 7.5, 21, 17));
    if (is_four) {
        painter.drawLine(QLineF(16, 8, 16, 24));
        painter.drawLine(QLineF(6, 16, 26, 16));
    }
    return pixmap;
}

} // namespace

ViewWidget::ViewWidget(const QString& view_name, QWidget* parent)
    : QWidget(parent), m_view_name(view_name), m_menu(new QMenu(this)),
      m_name_button(new QToolButton(this)), m_maximize_button(new QToolButton(this)) {
    setObjectName("view " + view_name);
    setAccessibleName(view_name);
    setAttribute(Qt::WA_OpaquePaintEvent);
    setFocusPolicy(Qt::ClickFocus);
    setMouseTracking(false);
    m_menu->setObjectName("menu of view " + view_name);
    m_name_button->setObjectName("name of view " + view_name);
    m_name_button->setText(QString(view_name).replace('&', "&&"));
    m_name_button->setMenu(m_menu);
    m_name_button->setPopupMode(QToolButton::InstantPopup);
    m_name_button->setToolTip(localized(L"Display mode, direction and size of this view", 45002));
    m_name_button->setCursor(Qt::ArrowCursor);
    m_maximize_button->setObjectName("maximize view " + view_name);
    m_maximize_button->setCursor(Qt::ArrowCursor);
    m_maximize_button->setFocusPolicy(Qt::TabFocus);
    m_maximize_button->setStyleSheet(QString(NAME_STYLE).arg("150", "normal"));
    connect(m_maximize_button, &QToolButton::clicked, this, &ViewWidget::maximizeClicked);
    setMaximized(false);
    styleName();
}

void ViewWidget::styleName() {
    const QString style = QString(NAME_STYLE);
    m_name_button->setStyleSheet(m_is_active ? style.arg("205", "bold")
                                             : style.arg("150", "normal"));
    placeButtons();
}

void ViewWidget::placeButtons() {
    m_name_button->adjustSize();
    m_name_button->move(NAME_MARGIN, NAME_MARGIN);
    m_maximize_button->adjustSize();
    m_maximize_button->move(width() - m_maximize_button->width() - NAME_MARGIN, NAME_MARGIN);
}

void ViewWidget::setMaximized(bool is_maximized) {
    const QString tip = is_maximized ? localized(L"Show all views", 45003)
                                     : localized(L"Show this view alone", 45004);
    m_maximize_button->setToolTip(tip);
    m_maximize_button->setAccessibleName(tip);
    m_maximize_button->setIcon(cornerIcon(is_maximized));
    placeButtons();
}

void ViewWidget::setPicture(const ShownPicture& picture) {
    m_picture = imageOf(picture);
    update();
}

QSize ViewWidget::wantedFrame() const {
    if (m_fixed_frame)
        return *m_fixed_frame;
    const QSizeF size_px = QSizeF(size()) * devicePixelRatioF();
    return {std::max(1, qRound(size_px.width())), std::max(1, qRound(size_px.height()))};
}

QSize ViewWidget::frameSize_px() const {
    return m_picture.isNull() ? wantedFrame() : m_picture.size();
}

QPointF ViewWidget::framePoint(const QPointF& point) const {
    const QSize frame_px = frameSize_px();
    return picturePoint(point, picturePlace(size(), frame_px), frame_px);
}

double ViewWidget::framePixelsPerUnit() const {
    const QSize frame_px = frameSize_px();
    return frame_px.width() / picturePlace(size(), frame_px).width();
}

void ViewWidget::setActive(bool is_active) {
    if (m_is_active == is_active)
        return;
    m_is_active = is_active;
    styleName();
    update();
}

void ViewWidget::setHint(const QString& hint) {
    if (m_hint == hint)
        return;
    m_hint = hint;
    update();
}

void ViewWidget::paintEvent(QPaintEvent*) {
    QPainter painter(this);
    painter.fillRect(rect(), QColor(BEHIND_PICTURE));
    painter.setRenderHint(QPainter::SmoothPixmapTransform);
    if (!m_picture.isNull())
        painter.drawImage(picturePlace(size(), m_picture.size()), m_picture);
    if (!m_hint.isEmpty()) {
        painter.setPen(QColor(40, 42, 46));
        painter.drawText(rect().adjusted(20, 20, -20, -20), Qt::AlignCenter | Qt::TextWordWrap,
                         m_hint);
    }
    paintBorder(painter);
}

/// Every view has its border, so that pale pictures side by side stay apart.
void ViewWidget::paintBorder(QPainter& painter) {
    const double width = m_is_active ? ACTIVE_BORDER : 1.0;
    const QColor colour = m_is_active ? palette().color(QPalette::Highlight) : QColor(BORDER);
    QPen pen(colour, width);
    pen.setJoinStyle(Qt::MiterJoin);
    painter.setPen(pen);
    const double half = width / 2.0;
    painter.drawRect(QRectF(rect()).adjusted(half, half, -half, -half));
}

void ViewWidget::resizeEvent(QResizeEvent* event) {
    QWidget::resizeEvent(event);
    placeButtons();
    emit frameChanged();
}

void ViewWidget::showEvent(QShowEvent* event) {
    QWidget::showEvent(event);
    emit frameChanged();
}

} // namespace quarn::desktop
