#include "desktop/sun/PathForm.h"

#include "desktop/sun/OutputRow.h"
#include "desktop/sun/PlaceRows.h"
#include "desktop/texts/Texts.h"
#include "host/sun/SunYears.h"

#include <QComboBox>
#include <QDate>
#include <QDoubleSpinBox>
#include <QFileInfo>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QSpinBox>

#include <cmath>

namespace quarn::desktop {

namespace {

enum Projection : int { stereographic, orthographic, both };

/// "1,2,3.5"; nothing for another text.
std::optional<KM_3dPoint> pointFromText(const QString& text) {
    const QStringList parts = text.split(text.contains(';') ? ';' : ',');
    if (parts.size() != 3)
        return std::nullopt;
    double numbers[3];
    for (int index = 0; index < 3; ++index) {
        bool is_number = false;
        numbers[index] = QString(parts[index]).replace(',', '.').toDouble(&is_number);
        if (!is_number || !std::isfinite(numbers[index]))
            return std::nullopt;
    }
    return KM_3dPoint(numbers[0], numbers[1], numbers[2]);
}

} // namespace

PathForm::PathForm(const SunOffer& offer, QWidget* owner)
    : SunDialog("pathForm", localized(L"Sun path diagram", 45570), owner), m_offer(offer),
      m_place(new PlaceRows(offer.site, this)) {
    addRow(localized(L"Place", 45549), m_place->place(), {m_place->map()});
    auto* const north = new QLabel(localized(L"North", 45550), this);
    north->setBuddy(m_place->north());
    m_place->north()->setAccessibleName(north->text());
    addRow(localized(L"Time zone", 45551), m_place->zone(), {north, m_place->north()});
    addDiagram();
    addChecks();
    finish(localized(L"OK", 45300));
    connect(m_place, &PlaceRows::changed, this, [this] { forgetFlaws(); });
    connect(m_file, &QLineEdit::textChanged, this, [this] { forgetFlaws(); });
    connect(m_point, &QLineEdit::textChanged, this, [this] { forgetFlaws(); });
}

void PathForm::addDiagram() {
    m_year = new QSpinBox(this);
    m_year->setObjectName("year");
    m_year->setRange(FIRST_SUN_YEAR, LAST_SUN_YEAR);
    m_year->setValue(QDate::currentDate().year());
    m_projection = new QComboBox(this);
    m_projection->setObjectName("projection");
    m_projection->addItems({localized(L"Stereographic", 45571), localized(L"Orthographic", 45572),
                            localized(L"Both, side by side", 45573)});
    m_projection->setAccessibleName(localized(L"How the sky is laid on a disk", 45574));
    addRow(localized(L"Year", 45575), m_year, {m_projection});
    m_point = new QLineEdit(this);
    m_point->setObjectName("point");
    m_point->setPlaceholderText(localized(L"nothing hides the sky", 45576));
    m_point->setToolTip(localized(
        L"A point x,y,z of the model or the name of an object: what the model hides of the sky "
        L"there is drawn in grey",
        45577));
    addRow(localized(L"As seen from", 45578), m_point);
    const OutputRow row = makeDiagramRow(m_offer.folder / (m_offer.name + "-sunpath.svg"), this);
    m_file = row.path;
    addRow(localized(L"File", 45579), row.path, {row.choose});
}

void PathForm::addChecks() {
    check(m_place->place(), [this] { return m_place->placeFlaw(); });
    check(m_place->zone(), [this] { return m_place->zoneFlaw(); });
    check(m_file, [this] { return fileFlaw(); });
}

QString PathForm::fileFlaw() const {
    const QFileInfo file(m_file->text().trimmed());
    const QString kind = file.suffix().toLower();
    if (kind != "svg" && kind != "png")
        return localized(L"The name of the file must end in .svg or .png.", 45580);
    return folderFlaw(file.absolutePath());
}

StudiedSite PathForm::site() const {
    return m_place->site().value_or(m_offer.site);
}

SunPathRequest PathForm::request() const {
    const StudiedSite place = site();
    SunPathRequest wish;
    wish.place = place.city;
    wish.site = {place.latitude_deg, place.longitude_deg};
    wish.zone = m_place->clock().value_or(Zone::fixed({}));
    wish.year = m_year->value();
    wish.is_stereographic = m_projection->currentIndex() != orthographic;
    wish.is_orthographic = m_projection->currentIndex() != stereographic;
    wish.north_deg = place.north_deg;
    const QString from = m_point->text().trimmed();
    if (const auto point = pointFromText(from))
        wish.point = *point;
    else if (!from.isEmpty())
        wish.point = from.toStdString();
    wish.model = m_offer.name;
    wish.file = nativePath(m_file->text().trimmed());
    return wish;
}

} // namespace quarn::desktop
