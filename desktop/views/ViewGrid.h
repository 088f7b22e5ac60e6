#pragma once

#include <QSplitter>
#include <QStringList>

namespace quarn::desktop {

/// How views stand beside and below each other: as many columns as rows or one more. Of four the
/// last, the perspective, stands in the upper right corner.
QList<QStringList> gridRows(const QStringList& view_names);

/// Widgets in rows, whose borders can be dragged; a border between columns goes through all rows
/// of equal length. One of the widgets can have all the room.
class ViewGrid final : public QWidget {
    Q_OBJECT

public:
    explicit ViewGrid(QWidget* parent = nullptr);

    /// Lays widgets out; the ones that it had before belong to nobody and are hidden.
    void setRows(const QList<QWidgetList>& rows);
    /// Gives one of the widgets all the room; null shows all of them.
    void maximize(QWidget* widget);
    QWidget* maximized() const { return m_maximized; }

    /// Where the borders are, for the next run of the program.
    QByteArray saveBorders() const;
    void restoreBorders(const QByteArray& state);

private:
    void alignColumns(const QSplitter& moved);
    void showRows();

    QSplitter* m_rows;
    QList<QWidgetList> m_widgets;
    QWidget* m_maximized = nullptr;
};

} // namespace quarn::desktop
