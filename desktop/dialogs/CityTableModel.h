#pragma once

#include "host/cities/Cities.h"

#include <QAbstractTableModel>

#include <span>
#include <vector>

namespace quarn::desktop {

/// Cities as a table: name, country, coordinates.
class CityTableModel final : public QAbstractTableModel {
public:
    using QAbstractTableModel::QAbstractTableModel;

    /// Shows these cities, in their order.
    void show(std::span<const City* const> cities);
    /// The city of a row; null for a row that is not there.
    const City* cityAt(int row) const;
    /// The row of a city; -1 when it is not shown.
    int rowOf(const City* city) const;

    int rowCount(const QModelIndex& parent = {}) const override;
    int columnCount(const QModelIndex& parent = {}) const override;
    QVariant data(const QModelIndex& index, int role) const override;
    QVariant headerData(int section, Qt::Orientation orientation, int role) const override;

private:
    std::vector<const City*> m_cities;
};

} // namespace quarn::desktop
