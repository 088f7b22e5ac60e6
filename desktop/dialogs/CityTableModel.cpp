#include "desktop/dialogs/CityTableModel.h"

#include "desktop/dialogs/PlaceText.h"
#include "desktop/texts/Texts.h"

#include <algorithm>

namespace quarn::desktop {
namespace {

enum Column { name, country, coordinates, column_count };

QString qtName(std::string_view utf8) {
    return QString::fromUtf8(utf8.data(), static_cast<qsizetype>(utf8.size()));
}

} // namespace

void CityTableModel::show(std::span<const City* const> cities) {
    beginResetModel();
    m_cities.assign(cities.begin(), cities.end());
    endResetModel();
}

const City* CityTableModel::cityAt(int row) const {
    return row >= 0 && row < std::ssize(m_cities) ? m_cities[static_cast<std::size_t>(row)]
                                                  : nullptr;
}

int CityTableModel::rowOf(const City* city) const {
    const auto found = std::ranges::find(m_cities, city);
    return found == m_cities.end() ? -1 : static_cast<int>(found - m_cities.begin());
}

int CityTableModel::rowCount(const QModelIndex& parent) const {
    return parent.isValid() ? 0 : static_cast<int>(m_cities.size());
}

int CityTableModel::columnCount(const QModelIndex& parent) const {
    return parent.isValid() ? 0 : column_count;
}

QVariant CityTableModel::data(const QModelIndex& index, int role) const {
    const City* const city = cityAt(index.row());
    if (!city || role != Qt::DisplayRole)
        return {};
    switch (index.column()) {
    case name:
        return qtName(city->name);
    case country:
        return qtName(city->country);
    default:
        return placeText({city->latitude_deg, city->longitude_deg});
    }
}

QVariant CityTableModel::headerData(int section, Qt::Orientation orientation, int role) const {
    if (orientation == Qt::Horizontal && role == Qt::TextAlignmentRole)
        return QVariant(Qt::AlignLeft | Qt::AlignVCenter);
    if (orientation != Qt::Horizontal || role != Qt::DisplayRole)
        return {};
    switch (section) {
    case name:
        return localized(L"City", 45310);
    case country:
        return localized(L"Country", 45311);
    default:
        return localized(L"Coordinates", 45344);
    }
}

} // namespace quarn::desktop
