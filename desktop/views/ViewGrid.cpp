#include "desktop/views/ViewGrid.h"

#include <QDataStream>
#include <QIODevice>
#include <QVBoxLayout>

#include <cmath>

namespace quarn::desktop {

QList<QStringList> gridRows(const QStringList& view_names) {
    if (view_names.size() == 4)
        return {{view_names[0], view_names[3]}, {view_names[1], view_names[2]}};
    const auto columns =
        static_cast<qsizetype>(std::ceil(std::sqrt(static_cast<double>(view_names.size()))));
    QList<QStringList> rows;
    for (qsizetype first = 0; first < view_names.size(); first += columns)
        rows.append(view_names.mid(first, columns));
    return rows;
}

ViewGrid::ViewGrid(QWidget* parent) : QWidget(parent), m_rows(new QSplitter(Qt::Vertical, this)) {
    auto* const layout = new QVBoxLayout(this);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->addWidget(m_rows);
    m_rows->setChildrenCollapsible(false);
    m_rows->setHandleWidth(4);
}

void ViewGrid::setRows(const QList<QWidgetList>& rows) {
    const QByteArray borders = saveBorders();
    for (const QWidgetList& row : m_widgets)
        for (QWidget* const widget : row) {
            widget->hide();
            widget->setParent(nullptr);
        }
    while (m_rows->count() > 0)
        delete m_rows->widget(0);
    m_widgets = rows;
    m_maximized = nullptr;
    for (const QWidgetList& row : rows) {
        auto* const splitter = new QSplitter(Qt::Horizontal, m_rows);
        splitter->setChildrenCollapsible(false);
        splitter->setHandleWidth(4);
        for (QWidget* const widget : row)
            splitter->addWidget(widget);
        splitter->setSizes(QList<int>(row.size(), 1000));
        connect(splitter, &QSplitter::splitterMoved, this,
                [this, splitter] { alignColumns(*splitter); });
        m_rows->addWidget(splitter);
    }
    m_rows->setSizes(QList<int>(rows.size(), 1000));
    restoreBorders(borders);
    showRows();
}

void ViewGrid::maximize(QWidget* widget) {
    m_maximized = widget;
    showRows();
}

void ViewGrid::showRows() {
    for (qsizetype i = 0; i < m_widgets.size(); ++i) {
        const QWidgetList& row = m_widgets[i];
        m_rows->widget(static_cast<int>(i))->setVisible(!m_maximized || row.contains(m_maximized));
        for (QWidget* const widget : row)
            widget->setVisible(!m_maximized || widget == m_maximized);
    }
}

void ViewGrid::alignColumns(const QSplitter& moved) {
    for (int i = 0; i < m_rows->count(); ++i) {
        auto* const row = static_cast<QSplitter*>(m_rows->widget(i));
        if (row != &moved && row->count() == moved.count())
            row->setSizes(moved.sizes());
    }
}

QByteArray ViewGrid::saveBorders() const {
    QByteArray state;
    QDataStream stream(&state, QIODevice::WriteOnly);
    stream << static_cast<qint32>(m_rows->count()) << m_rows->saveState();
    for (int i = 0; i < m_rows->count(); ++i)
        stream << static_cast<const QSplitter*>(m_rows->widget(i))->saveState();
    return state;
}

/// The borders of a grid of another form mean nothing here.
void ViewGrid::restoreBorders(const QByteArray& state) {
    QDataStream stream(state);
    qint32 row_count = 0;
    QByteArray rows;
    stream >> row_count >> rows;
    if (stream.status() != QDataStream::Ok || row_count != m_rows->count() || row_count == 0)
        return;
    m_rows->restoreState(rows);
    for (int i = 0; i < row_count; ++i) {
        QByteArray row;
        stream >> row;
        static_cast<QSplitter*>(m_rows->widget(i))->restoreState(row);
    }
}

} // namespace quarn::desktop
