#include "tests/window_probe/WidgetReport.h"

#include <QAbstractButton>
#include <QAbstractItemView>
#include <QAbstractSpinBox>
#include <QAction>
#include <QApplication>
#include <QComboBox>
#include <QGroupBox>
#include <QHeaderView>
#include <QJsonArray>
#include <QLabel>
#include <QLineEdit>
#include <QMenu>
#include <QMenuBar>
#include <QPlainTextEdit>
#include <QProgressBar>
#include <QScrollBar>
#include <QSlider>
#include <QStyleOptionSlider>
#include <QStyleOptionSpinBox>
#include <QToolButton>

namespace quarn::test {

namespace {

constexpr qsizetype TEXT_KEPT = 20000;
constexpr int ROWS_KEPT = 200;

/// A part of a widget without what the widgets around it cut off.
QRect seenPart(const QWidget& widget, const QRect& part) {
    QRect seen = part & widget.rect();
    QPoint corner;
    for (const QWidget* inner = &widget; !inner->isWindow(); inner = inner->parentWidget()) {
        corner += inner->pos();
        seen &= inner->parentWidget()->rect().translated(-corner);
    }
    return seen;
}

/// A part of a widget as a place on the screen.
QJsonObject place(const QWidget& widget, const QRect& part) {
    const QRect seen = seenPart(widget, part);
    const QPoint corner = widget.mapToGlobal(seen.topLeft());
    return {{"x", corner.x()}, {"y", corner.y()}, {"w", seen.width()}, {"h", seen.height()}};
}

QString wordsOf(const QWidget& widget) {
    if (const auto* const output = qobject_cast<const QPlainTextEdit*>(&widget))
        return output->toPlainText().right(TEXT_KEPT);
    for (const char* const property : {"currentText", "text", "title", "windowTitle"})
        if (const QVariant value = widget.property(property); !value.toString().isEmpty())
            return value.toString();
    return {};
}

QJsonArray classesOf(const QWidget& widget) {
    QJsonArray names;
    for (const QMetaObject* kind = widget.metaObject(); kind; kind = kind->superClass())
        names.append(kind->className());
    return names;
}

QJsonObject itemOf(const QAction& action) {
    return {{"name", action.objectName()},
            {"text", action.text()},
            {"enabled", action.isEnabled() && !action.isSeparator()},
            {"checked", action.isChecked()}};
}

/// The names of what a menu offers, its submenus included.
QJsonArray namesIn(const QMenu& menu) {
    QJsonArray names;
    for (const QAction* const action : menu.actions())
        if (const QMenu* const inner = action->menu())
            for (const QJsonValue name : namesIn(*inner))
                names.append(name);
        else if (!action->objectName().isEmpty())
            names.append(action->objectName());
    return names;
}

template <class Menu> QJsonArray actionItems(const Menu& menu) {
    QJsonArray items;
    for (QAction* const action : menu.actions()) {
        if (!action->isVisible() || action->isSeparator())
            continue;
        QJsonObject item = itemOf(*action);
        if (const QMenu* const inner = action->menu())
            item["holds"] = namesIn(*inner);
        item["place"] = place(menu, menu.actionGeometry(action));
        items.append(item);
    }
    return items;
}

QJsonArray rowItems(const QAbstractItemView& view) {
    QJsonArray items;
    const QAbstractItemModel* const model = view.model();
    if (!model)
        return items;
    const QModelIndex root = view.rootIndex();
    for (int row = 0; row < model->rowCount(root) && items.size() < ROWS_KEPT; ++row)
        for (int column = 0; column < model->columnCount(root); ++column) {
            const QModelIndex index = model->index(row, column, root);
            const QRect part = view.visualRect(index) & view.viewport()->rect();
            if (part.isEmpty())
                continue;
            const bool is_enabled = (index.flags() & Qt::ItemIsEnabled) != 0;
            items.append(QJsonObject{{"text", index.data().toString()},
                                     {"enabled", is_enabled},
                                     {"checked", view.selectionModel()->isSelected(index)},
                                     {"place", place(*view.viewport(), part)}});
        }
    return items;
}

/// The protected option of a control, for the places of its arrows and its knob.
template <class Control, class Option> struct Opened : Control {
    static Option optionOf(const Control& control) {
        Option option;
        (control.*(&Opened::initStyleOption))(&option);
        return option;
    }
};

QJsonArray spinItems(const QAbstractSpinBox& box) {
    const auto option = Opened<QAbstractSpinBox, QStyleOptionSpinBox>::optionOf(box);
    QJsonArray items;
    const auto add = [&](const char* name, QStyle::SubControl arrow) {
        const QRect part = box.style()->subControlRect(QStyle::CC_SpinBox, &option, arrow, &box);
        items.append(QJsonObject{{"name", name}, {"enabled", true}, {"place", place(box, part)}});
    };
    add("up", QStyle::SC_SpinBoxUp);
    add("down", QStyle::SC_SpinBoxDown);
    return items;
}

QJsonArray sliderItems(const QSlider& slider) {
    const auto option = Opened<QSlider, QStyleOptionSlider>::optionOf(slider);
    const auto part = [&](const char* name, QStyle::SubControl control) {
        const QRect rect =
            slider.style()->subControlRect(QStyle::CC_Slider, &option, control, &slider);
        return QJsonObject{{"name", name}, {"enabled", true}, {"place", place(slider, rect)}};
    };
    return {part("knob", QStyle::SC_SliderHandle), part("groove", QStyle::SC_SliderGroove)};
}

QJsonArray itemsOf(const QWidget& widget) {
    if (const auto* const menu = qobject_cast<const QMenu*>(&widget))
        return actionItems(*menu);
    if (const auto* const bar = qobject_cast<const QMenuBar*>(&widget))
        return actionItems(*bar);
    if (const auto* const box = qobject_cast<const QAbstractSpinBox*>(&widget))
        return spinItems(*box);
    if (const auto* const slider = qobject_cast<const QSlider*>(&widget))
        return sliderItems(*slider);
    const auto* const view = qobject_cast<const QAbstractItemView*>(&widget);
    return view && !qobject_cast<const QHeaderView*>(view) ? rowItems(*view) : QJsonArray();
}

QJsonObject reportWidget(const QWidget& widget) {
    const QWidget& window = *widget.window();
    QJsonObject told{{"classes", classesOf(widget)},
                     {"name", widget.objectName()},
                     {"text", wordsOf(widget)},
                     {"enabled", widget.isEnabled()},
                     {"focus", widget.hasFocus()},
                     {"window", window.objectName()},
                     {"title", window.windowTitle()},
                     {"window_id", static_cast<qint64>(window.internalWinId())},
                     {"is_window", widget.isWindow()},
                     {"is_modal", widget.isModal()},
                     {"is_in_front", &window == QApplication::activeModalWidget()},
                     {"place", place(widget, widget.rect())},
                     {"items", itemsOf(widget)}};
    for (const char* const property : {"value", "minimum", "maximum", "checked"})
        if (const QVariant value = widget.property(property); value.canConvert<int>())
            told[QLatin1String(property)] = value.toInt();
    return told;
}

} // namespace

QJsonObject reportWindows() {
    QJsonArray widgets;
    QJsonArray actions;
    for (const QWidget* const widget : QApplication::allWidgets())
        if (widget->isVisible())
            widgets.append(reportWidget(*widget));
    for (const QWidget* const window : QApplication::topLevelWidgets())
        for (const QAction* const action : window->findChildren<QAction*>())
            if (!action->objectName().isEmpty() && action->isVisible())
                actions.append(itemOf(*action));
    return {{"widgets", widgets}, {"actions", actions}};
}

} // namespace quarn::test
