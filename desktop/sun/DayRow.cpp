#include "desktop/sun/DayRow.h"

#include "desktop/dialogs/FormField.h"
#include "desktop/texts/Texts.h"
#include "host/sun/Seasons.h"
#include "host/sun/SunYears.h"

#include <QComboBox>
#include <QDateEdit>

#include <algorithm>

namespace quarn::desktop {

namespace {

using namespace std::chrono;

QDate qtDate(const Zone& clock, sys_seconds moment) {
    const year_month_day day{floor<days>(clock.at(moment).local)};
    return {int(day.year()), int(unsigned(day.month())), int(unsigned(day.day()))};
}

} // namespace

QDateEdit* makeDateField(const char* name, QWidget* form) {
    auto* const field =
        qobject_cast<QDateEdit*>(makeField({0, DialogControl::Kind::date, {}, {}, false}, form));
    field->setObjectName(name);
    field->setDateRange(QDate(FIRST_SUN_YEAR, 1, 1), QDate(LAST_SUN_YEAR, 12, 31));
    return field;
}

DayRow::DayRow(QWidget* form)
    : QObject(form), m_date(makeDateField("date", form)), m_named(new QComboBox(form)) {
    m_named->setObjectName("namedDay");
    m_named->setAccessibleName(localized(L"Days of the sun", 45531));
    m_named->addItems({localized(L"Other day", 45532), localized(L"Today", 45533),
                       localized(L"Equinox in March", 45534), localized(L"Longest day", 45535),
                       localized(L"Equinox in September", 45536),
                       localized(L"Shortest day", 45537)});
    connect(m_named, &QComboBox::activated, this, [this](int named) {
        if (named != other)
            m_date->setDate(dateOf(named, m_date->date().year()));
    });
    connect(m_date, &QDateEdit::dateChanged, this, [this] {
        showName();
        emit changed();
    });
}

year_month_day DayRow::day() const {
    const QDate shown = m_date->date();
    return year(shown.year()) / month(unsigned(shown.month())) /
           std::chrono::day(unsigned(shown.day()));
}

void DayRow::setPlace(double latitude_deg, const Zone& clock) {
    m_latitude_deg = latitude_deg;
    m_clock = clock;
    showName();
}

QDate DayRow::dateOf(int named, int year) const {
    if (named == today)
        return qtDate(m_clock, floor<seconds>(system_clock::now()));
    const Seasons seasons = seasonsOf(year);
    const bool is_north = m_latitude_deg >= 0.0;
    if (named == march_equinox)
        return qtDate(m_clock, seasons.march_equinox);
    if (named == september_equinox)
        return qtDate(m_clock, seasons.september_equinox);
    return qtDate(m_clock, (named == longest) == is_north ? seasons.june_solstice
                                                          : seasons.december_solstice);
}

/// A day that the sun names is called so also where it was typed; today is another day tomorrow.
void DayRow::showName() {
    const QDate shown = m_date->date();
    for (const int named : {march_equinox, longest, september_equinox, shortest, today})
        if (shown == dateOf(named, shown.year())) {
            m_named->setCurrentIndex(named);
            return;
        }
    m_named->setCurrentIndex(other);
}

} // namespace quarn::desktop
