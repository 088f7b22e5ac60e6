#include "desktop/sun/HoursForm.h"

#include "desktop/dialogs/FormField.h"
#include "desktop/sun/DayRow.h"
#include "desktop/sun/DaylightText.h"
#include "desktop/sun/OutputRow.h"
#include "desktop/sun/PlaceRows.h"
#include "desktop/texts/Texts.h"

#include <QCheckBox>
#include <QComboBox>
#include <QDateEdit>
#include <QDoubleSpinBox>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QSpinBox>
#include <QTimeEdit>

namespace quarn::desktop {

namespace {

using namespace std::chrono;

constexpr QSize PLAN_SIZE{1280, 720};
constexpr int FIRST_STEP_MINUTES = 10;
constexpr int LONGEST_STEP_MINUTES = 240;
enum Picture : int { plan, view };

QTimeEdit* makeTimeField(const char* name, int hour, QWidget* form) {
    auto* const field =
        qobject_cast<QTimeEdit*>(makeField({0, DialogControl::Kind::time, {}, {}, false}, form));
    field->setObjectName(name);
    field->setTime(QTime(hour, 0));
    return field;
}

template <class Box> Box* named(Box* box, const char* name) {
    box->setObjectName(name);
    return box;
}

minutes sinceMidnight(const QTimeEdit& field) {
    return hours(field.time().hour()) + minutes(field.time().minute());
}

year_month_day dayOf(const QDate& date) {
    return year(date.year()) / month(unsigned(date.month())) / day(unsigned(date.day()));
}

} // namespace

HoursForm::HoursForm(const SunOffer& offer, QWidget* owner)
    : SunDialog("hoursForm", localized(L"Hours of sun", 45548), owner), m_offer(offer),
      m_place(new PlaceRows(offer.site, this)), m_day(new DayRow(this)) {
    addRow(localized(L"Place", 45549), m_place->place(), {m_place->map()});
    auto* const north = new QLabel(localized(L"North", 45550), this);
    north->setBuddy(m_place->north());
    m_place->north()->setAccessibleName(north->text());
    addRow(localized(L"Time zone", 45551), m_place->zone(), {north, m_place->north()});
    addDays();
    addTimes();
    addPicture();
    addFolder();
    addChecks();
    finish(localized(L"OK", 45300));
    connect(m_place, &PlaceRows::changed, this, [this] { review(); });
    connect(m_day, &DayRow::changed, this, [this] { review(); });
    review();
}

void HoursForm::addDays() {
    addRow(localized(L"Day", 45552), m_day->date(), {m_day->named()});
    m_several = named(new QCheckBox(localized(L"and on until", 45553), this), "several");
    m_last_date = makeDateField("lastDate", this);
    m_last_date->setDate(QDate(m_day->date()->date().year(), 12, 31));
    m_every_days = named(new QSpinBox(this), "everyDays");
    m_every_days->setRange(1, 366);
    m_every_days->setValue(7);
    m_every_days->setPrefix(localized(L"every ", 45554));
    m_every_days->setSuffix(localized(L" days", 45555));
    m_every_days->setAccessibleName(localized(L"Days between those that are looked at", 45556));
    m_last_date->setAccessibleName(m_several->text());
    addRow({}, m_several, {m_last_date, m_every_days});
    const auto show = [this] {
        m_last_date->setEnabled(m_several->isChecked());
        m_every_days->setEnabled(m_several->isChecked());
    };
    connect(m_several, &QCheckBox::toggled, this, show);
    show();
}

void HoursForm::addTimes() {
    m_whole_day =
        named(new QCheckBox(localized(L"from sunrise to sunset", 45557), this), "wholeDay");
    m_whole_day->setChecked(true);
    m_daylight = named(new QLabel(this), "daylight");
    m_daylight->setTextFormat(Qt::PlainText);
    addRow(localized(L"Sun", 45558), m_whole_day, {m_daylight});
    m_from = makeTimeField("from", 9, this);
    m_to = makeTimeField("to", 17, this);
    auto* const to = new QLabel(localized(L"to", 45559), this);
    to->setBuddy(m_to);
    m_to->setAccessibleName(to->text());
    m_minutes = named(new QSpinBox(this), "minutes");
    m_minutes->setRange(1, LONGEST_STEP_MINUTES);
    m_minutes->setValue(FIRST_STEP_MINUTES);
    m_minutes->setPrefix(localized(L"every ", 45554));
    m_minutes->setSuffix(localized(L" min", 45560));
    m_minutes->setAccessibleName(localized(L"Minutes between two places of the sun", 45561));
    addRow(localized(L"From", 45562), m_from, {to, m_to, m_minutes});
    const auto show = [this] {
        m_from->setEnabled(!m_whole_day->isChecked());
        m_to->setEnabled(!m_whole_day->isChecked());
    };
    connect(m_whole_day, &QCheckBox::toggled, this, show);
    show();
}

void HoursForm::addPicture() {
    m_picture = named(new QComboBox(this), "picture");
    m_picture->addItems({localized(L"Plan, from straight above", 45563),
                         localized(L"As the active view shows it", 45564)});
    m_lines = named(new QCheckBox(localized(L"lines at whole hours", 45565), this), "lines");
    addRow(localized(L"Picture", 45566), m_picture, {m_lines});
}

void HoursForm::addFolder() {
    const OutputRow row = makeFolderRow(m_offer.folder, this);
    m_folder = row.path;
    addRow(localized(L"Folder", 45567), row.path, {row.choose});
    connect(m_folder, &QLineEdit::textChanged, this, [this] { forgetFlaws(); });
}

void HoursForm::addChecks() {
    check(m_place->place(), [this] { return m_place->placeFlaw(); });
    check(m_place->zone(), [this] { return m_place->zoneFlaw(); });
    check(m_last_date, [this] {
        const bool is_before =
            m_several->isChecked() && m_last_date->date() < m_day->date()->date();
        return is_before ? localized(L"The last day is before the first one.", 45568) : QString();
    });
    check(m_to, [this] {
        const bool is_before = !m_whole_day->isChecked() && m_to->time() <= m_from->time();
        return is_before ? localized(L"No time is left: it ends before it begins.", 45569)
                         : QString();
    });
    check(m_folder, [this] { return folderFlaw(m_folder->text()); });
}

void HoursForm::review() {
    forgetFlaws();
    const auto site = m_place->site();
    const auto clock = m_place->clock();
    if (!site || !clock) {
        m_daylight->clear();
        return;
    }
    m_day->setPlace(site->latitude_deg, *clock);
    m_daylight->setText(daylightText(daylightTimes(*site, *clock, m_day->day()), *clock));
}

StudiedSite HoursForm::site() const {
    return m_place->site().value_or(m_offer.site);
}

SunHoursRequest HoursForm::request() const {
    const StudiedSite place = site();
    SunHoursRequest wish;
    wish.title = wish.name = m_offer.name;
    wish.site = {place.city, place.latitude_deg, place.longitude_deg, place.north_deg,
                 m_place->clock().value_or(Zone::fixed({}))};
    wish.first_day = wish.last_day = m_day->day();
    if (m_several->isChecked()) {
        wish.last_day = dayOf(m_last_date->date());
        wish.every_days = m_every_days->value();
    }
    if (!m_whole_day->isChecked()) {
        wish.from = WantedTime{WantedTime::Since::midnight, sinceMidnight(*m_from)};
        wish.to = WantedTime{WantedTime::Since::midnight, sinceMidnight(*m_to)};
    }
    wish.every_minutes = m_minutes->value();
    wish.is_plan = m_picture->currentIndex() == plan;
    const QSize size = wish.is_plan || m_offer.view_size.isEmpty() ? PLAN_SIZE : m_offer.view_size;
    wish.width_px = size.width();
    wish.height_px = size.height();
    wish.isoline_hours = m_lines->isChecked() ? 1.0 : 0.0;
    wish.folder = nativePath(m_folder->text().trimmed());
    return wish;
}

} // namespace quarn::desktop
