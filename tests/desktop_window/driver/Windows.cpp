#include "tests/desktop_window/driver/Windows.h"

#include <QJsonArray>
#include <QJsonDocument>
#include <QJsonObject>

#include <algorithm>
#include <stdexcept>

namespace quarn::test {

namespace {

QRect readPlace(const QJsonValue& json) {
    return {json["x"].toInt(), json["y"].toInt(), json["w"].toInt(), json["h"].toInt()};
}

QStringList readNames(const QJsonValue& json) {
    QStringList names;
    for (const QJsonValue name : json.toArray())
        names.append(name.toString());
    return names;
}

SeenItem readItem(const QJsonValue& json) {
    return {json["name"].toString(),  json["text"].toString(),  json["enabled"].toBool(),
            json["checked"].toBool(), readPlace(json["place"]), readNames(json["holds"])};
}

QList<SeenItem> readItems(const QJsonValue& json) {
    QList<SeenItem> items;
    for (const QJsonValue item : json.toArray())
        items.append(readItem(item));
    return items;
}

SeenWidget readWidget(const QJsonValue& json) {
    SeenWidget widget;
    widget.classes = readNames(json["classes"]);
    widget.name = json["name"].toString();
    widget.text = json["text"].toString();
    widget.is_enabled = json["enabled"].toBool();
    widget.has_focus = json["focus"].toBool();
    widget.window = json["window"].toString();
    widget.title = json["title"].toString();
    widget.window_id = static_cast<unsigned>(json["window_id"].toInteger());
    widget.is_window = json["is_window"].toBool();
    widget.is_modal = json["is_modal"].toBool();
    widget.is_in_front = json["is_in_front"].toBool();
    widget.value = json["value"].toInt();
    widget.minimum = json["minimum"].toInt();
    widget.maximum = json["maximum"].toInt();
    widget.place = readPlace(json["place"]);
    widget.items = readItems(json["items"]);
    return widget;
}

bool isCalled(const SeenItem& item, const QString& name_or_text) {
    return item.name == name_or_text || plainText(item.text) == plainText(name_or_text);
}

} // namespace

QString plainText(QString text) {
    return text.remove('&').remove(QChar(0x2026)).remove("...").trimmed();
}

const SeenItem* SeenWidget::item(const QString& name_or_text) const {
    const auto found = std::ranges::find_if(
        items, [&](const SeenItem& item) { return isCalled(item, name_or_text); });
    return found == items.end() ? nullptr : &*found;
}

const SeenWidget* Windows::widget(const QString& name) const {
    const SeenWidget* found = nullptr;
    for (const SeenWidget& widget : widgets)
        if (widget.name == name && !widget.place.isEmpty() && (!found || widget.is_in_front))
            found = &widget;
    return found;
}

const SeenWidget* Windows::button(const QString& text) const {
    const auto found = std::ranges::find_if(widgets, [&](const SeenWidget& widget) {
        return widget.isButton() && plainText(widget.text) == plainText(text);
    });
    return found == widgets.end() ? nullptr : &*found;
}

const SeenWidget* Windows::menuWith(const QString& name_or_text) const {
    const auto found = std::ranges::find_if(widgets, [&](const SeenWidget& widget) {
        return widget.classes.contains("QMenu") && widget.item(name_or_text);
    });
    return found == widgets.end() ? nullptr : &*found;
}

QList<const SeenWidget*> Windows::modalWindows() const {
    QList<const SeenWidget*> modal;
    for (const SeenWidget& widget : widgets)
        if (widget.is_window && widget.is_modal)
            modal.append(&widget);
    return modal;
}

const SeenItem* Windows::action(const QString& name) const {
    const auto found =
        std::ranges::find_if(actions, [&](const SeenItem& item) { return item.name == name; });
    return found == actions.end() ? nullptr : &*found;
}

bool Windows::isCommandRunning() const {
    const SeenItem* const stop = action("stop");
    return stop && stop->is_enabled;
}

QString Windows::description() const {
    QString told;
    for (const SeenWidget& widget : widgets) {
        if (!widget.is_window && widget.name.isEmpty() && !widget.isButton())
            continue;
        told +=
            QString("%1%2 %3 \"%4\"%5 %6,%7 %8x%9\n")
                .arg(widget.is_window ? "" : "    ", widget.classes.value(0), widget.name,
                     widget.text.right(300).replace('\n', " / "), widget.is_enabled ? "" : " (off)")
                .arg(widget.place.x())
                .arg(widget.place.y())
                .arg(widget.place.width())
                .arg(widget.place.height());
    }
    return told;
}

Windows readWindows(const QByteArray& json) {
    const QJsonDocument document = QJsonDocument::fromJson(json);
    if (!document.isObject())
        throw std::runtime_error("the probe told no JSON");
    Windows windows;
    for (const QJsonValue widget : document["widgets"].toArray())
        windows.widgets.append(readWidget(widget));
    windows.actions = readItems(document["actions"]);
    return windows;
}

} // namespace quarn::test
