#pragma once

#include <QByteArray>
#include <QList>
#include <QRect>
#include <QString>
#include <QStringList>

namespace quarn::test {

/// A part of a widget that can be clicked: an entry of a menu or a list, an arrow, a knob.
struct SeenItem {
    QString name;
    QString text;
    bool is_enabled = false;
    bool is_checked = false;
    QRect place;
    QStringList holds; ///< of a menu's title: the names of the entries behind it
};

/// A widget that can be seen.
struct SeenWidget {
    QStringList classes; ///< its own first
    QString name;
    QString text;
    bool is_enabled = false;
    bool has_focus = false;
    QString window; ///< name of the window it is in
    QString title;  ///< of that window
    unsigned window_id = 0;
    bool is_window = false;
    bool is_modal = false;
    bool is_in_front = false; ///< in the modal window that all others wait for
    int value = 0;
    int minimum = 0;
    int maximum = 0;
    QRect place; ///< the part of it that is not clipped away, on the screen
    QList<SeenItem> items;

    /// The item with this name or text, mnemonics aside; null where there is none.
    const SeenItem* item(const QString& name_or_text) const;
    bool isButton() const { return classes.contains("QAbstractButton"); }
};

/// What can be seen of the program at one moment.
struct Windows {
    QList<SeenWidget> widgets;
    QList<SeenItem> actions; ///< all that have names, whether their menus are open or not

    /// The widget with this name, that of the modal window in front where several have it; null
    /// where none is seen.
    const SeenWidget* widget(const QString& name) const;
    /// The button on which that stands, mnemonics aside; null where none is seen.
    const SeenWidget* button(const QString& text) const;
    /// The newest open menu that has an entry; null where there is none.
    const SeenWidget* menuWith(const QString& name_or_text) const;
    /// The modal windows, in no order.
    QList<const SeenWidget*> modalWindows() const;
    const SeenItem* action(const QString& name) const;
    /// Whether a command runs.
    bool isCommandRunning() const;
    /// For a message: the windows, and what they have.
    QString description() const;
};

/// Reads what the probe tells.
Windows readWindows(const QByteArray& json);

/// A text without its mnemonics and dots: "&Open…" is "Open".
QString plainText(QString text);

} // namespace quarn::test
