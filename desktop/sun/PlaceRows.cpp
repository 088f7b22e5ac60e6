#include "desktop/sun/PlaceRows.h"

#include "desktop/dialogs/LocationDialog.h"
#include "desktop/texts/Texts.h"
#include "host/cities/Cities.h"
#include "host/cities/LocationChoice.h"

#include <QCompleter>
#include <QDoubleSpinBox>
#include <QLineEdit>
#include <QPushButton>
#include <QStringListModel>

#include <cmath>

namespace quarn::desktop {

namespace {

/// "48.14, 11.58"; where a comma parts digits a semicolon parts the numbers.
std::optional<Place> placeFromText(const QString& text) {
    const QStringList parts = text.split(text.contains(';') ? ';' : ',');
    if (parts.size() != 2)
        return std::nullopt;
    const auto latitude = angleFromText(parts[0].toStdWString(), L'N');
    const auto longitude = angleFromText(parts[1].toStdWString(), L'E');
    if (!latitude || !longitude || std::abs(*latitude) > 90.0 || std::abs(*longitude) > 180.0)
        return std::nullopt;
    return Place{*latitude, *longitude};
}

QString textOfPlace(const Place& place) {
    return qtText(textFromAngle(place.latitude_deg)) + ", " +
           qtText(textFromAngle(place.longitude_deg));
}

std::string utf8(const QString& text) {
    return text.trimmed().toStdString();
}

} // namespace

PlaceRows::PlaceRows(const StudiedSite& offered, QWidget* form)
    : QObject(form), m_place(new QLineEdit(form)),
      m_map(new QPushButton(localized(L"Map…", 45522), form)), m_zone(new QLineEdit(form)),
      m_north(new QDoubleSpinBox(form)), m_has_own_zone(false) {
    m_place->setObjectName("place");
    m_place->setToolTip(localized(L"A city, or latitude and longitude: 48.14, 11.58", 45523));
    m_place->setMinimumWidth(m_place->fontMetrics().averageCharWidth() * 34);
    m_map->setObjectName("map");
    m_map->setToolTip(localized(L"Find the place among the cities or on a map", 45524));
    m_map->setAutoDefault(false);
    m_zone->setObjectName("zone");
    m_zone->setToolTip(localized(
        L"Whose clocks times are told by: Europe/Berlin, +05:30 or solar; empty: the place's",
        45525));
    m_north->setObjectName("north");
    m_north->setRange(-360.0, 360.0);
    m_north->setSuffix("°");
    m_north->setToolTip(localized(
        L"Where north is in the model: clockwise from its Y axis, seen from above", 45526));
    m_north->setValue(offered.north_deg);

    auto* const completer = new QCompleter(new QStringListModel(this), this);
    completer->setCompletionMode(QCompleter::UnfilteredPopupCompletion);
    m_place->setCompleter(completer);
    show({offered.latitude_deg, offered.longitude_deg});
    if (!offered.city.empty())
        m_place->setText(QString::fromStdString(offered.city));
    followPlace();
    const QString own_zone = QString::fromStdString(offered.zone);
    m_has_own_zone = !own_zone.isEmpty() && own_zone != m_zone->text();
    if (m_has_own_zone)
        m_zone->setText(own_zone);

    connect(m_map, &QPushButton::clicked, this, &PlaceRows::choose);
    connect(m_place, &QLineEdit::textEdited, this, &PlaceRows::suggest);
    connect(m_place, &QLineEdit::textChanged, this, &PlaceRows::followPlace);
    connect(m_zone, &QLineEdit::textEdited, this, [this](const QString& text) {
        m_has_own_zone = !text.trimmed().isEmpty();
        emit changed();
    });
    connect(m_north, &QDoubleSpinBox::valueChanged, this, &PlaceRows::changed);
}

std::optional<PlaceRows::Found> PlaceRows::found() const {
    const QString text = m_place->text().trimmed();
    const std::optional<Place> typed = placeFromText(text);
    if (typed)
        return Found{
            {}, *typed, std::string(nearestCity(typed->latitude_deg, typed->longitude_deg).zone)};
    const City* const city = findCity(utf8(text));
    if (!city)
        return std::nullopt;
    return Found{
        nameWithCountry(*city), {city->latitude_deg, city->longitude_deg}, std::string(city->zone)};
}

std::optional<Zone> PlaceRows::clock() const {
    const std::optional<Found> here = found();
    if (!here)
        return std::nullopt;
    const QString typed = m_zone->text().trimmed();
    const auto zone =
        Zone::written(typed.isEmpty() ? here->zone : utf8(typed), here->place.longitude_deg);
    return zone ? std::optional(zone.value()) : std::nullopt;
}

std::optional<StudiedSite> PlaceRows::site() const {
    const std::optional<Found> here = found();
    const std::optional<Zone> zone = clock();
    if (!here || !zone)
        return std::nullopt;
    return StudiedSite{here->city, zone->name(), here->place.latitude_deg,
                       here->place.longitude_deg, m_north->value()};
}

QString PlaceRows::placeFlaw() const {
    if (found())
        return {};
    const QString typed = m_place->text().trimmed();
    const auto meant = citiesLike(utf8(typed));
    if (typed.isEmpty() || meant.empty())
        return localized(L"No city is called \"%1\". Choose it on the map, or enter its latitude "
                         L"and longitude: 48.14, 11.58",
                         45527)
            .arg(typed);
    QStringList names;
    for (const City* const city : meant)
        names << QString::fromStdString(nameWithCountry(*city));
    return localized(L"\"%1\" names no single city. Did you mean %2?", 45528)
        .arg(typed, names.join("; "));
}

QString PlaceRows::zoneFlaw() const {
    if (!found() || clock())
        return {};
    return localized(L"There is no time zone \"%1\". Enter one as Europe/Berlin, +05:30 or solar, "
                     L"or nothing for the place's own.",
                     45529)
        .arg(m_zone->text().trimmed());
}

void PlaceRows::show(const Place& place) {
    const City* const city = LocationChoice(place).cityHere();
    m_place->setText(city ? QString::fromStdString(nameWithCountry(*city)) : textOfPlace(place));
}

/// Begins with what is entered, where that is a place.
void PlaceRows::choose() {
    const std::optional<Found> here = found();
    const auto chosen =
        askPlace(m_place->window(), localized(L"Place of the model", 45530).toStdWString(),
                 here ? here->place : Place{});
    if (!chosen)
        return;
    show(*chosen);
    m_place->setFocus();
}

void PlaceRows::followPlace() {
    const std::optional<Found> here = found();
    if (here && !m_has_own_zone)
        m_zone->setText(QString::fromStdString(here->zone));
    emit changed();
}

void PlaceRows::suggest(const QString& typed) {
    constexpr std::size_t MOST = 12;
    QStringList names;
    if (!typed.trimmed().isEmpty() && !placeFromText(typed))
        for (const City* const city : citiesOf(utf8(typed)))
            if (names.size() < qsizetype(MOST))
                names << QString::fromStdString(nameWithCountry(*city));
    static_cast<QStringListModel*>(m_place->completer()->model())->setStringList(names);
}

} // namespace quarn::desktop
