#include "desktop/sun/AlmanacForm.h"

#include "desktop/sun/DayRow.h"
#include "desktop/sun/DaylightText.h"
#include "desktop/sun/PlaceRows.h"
#include "desktop/texts/Texts.h"
#include "host/clock/WallText.h"
#include "host/sun/SunPosition.h"

#include <QApplication>
#include <QClipboard>
#include <QComboBox>
#include <QDateEdit>
#include <QDoubleSpinBox>
#include <QHeaderView>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QTableWidget>
#include <QVBoxLayout>

namespace quarn::desktop {

namespace {

using namespace std::chrono;

QString degreesText(double degrees) {
    return QString::number(degrees, 'f', 1) + "°";
}

QTableWidgetItem* cell(const QString& text) {
    auto* const item = new QTableWidgetItem(text);
    item->setTextAlignment(Qt::AlignRight | Qt::AlignVCenter);
    item->setFlags(Qt::ItemIsEnabled | Qt::ItemIsSelectable);
    return item;
}

/// What happens that day, with the length of the day and the sun's way over the south or north.
QString eventsText(const DaylightTimes& times, const Zone& clock) {
    QString text = daylightText(times, clock);
    if (times.transit)
        text += '\n' + localized(L"Highest at %1; the day lasts %2 h %3 min", 45590)
                           .arg(QString::fromStdString(timeText(clock.at(*times.transit))))
                           .arg(duration_cast<hours>(times.length).count())
                           .arg(duration_cast<minutes>(times.length).count() % 60);
    return text;
}

} // namespace

AlmanacForm::AlmanacForm(const StudiedSite& offered, QWidget* owner)
    : SunDialog("almanacForm", localized(L"Where the sun stands", 45591), owner),
      m_place(new PlaceRows(offered, this)), m_day(new DayRow(this)) {
    addRow(localized(L"Place", 45549), m_place->place(), {m_place->map()});
    addRow(localized(L"Time zone", 45551), m_place->zone());
    m_place->north()->hide(); // directions are those of the earth here
    addRow(localized(L"Day", 45552), m_day->date(), {m_day->named()});
    addTable();
    finish({});
    connect(m_place, &PlaceRows::changed, this, [this] { review(); });
    connect(m_day, &DayRow::changed, this, [this] { review(); });
    review();
}

void AlmanacForm::addTable() {
    m_events = new QLabel(this);
    m_events->setObjectName("events");
    m_events->setTextFormat(Qt::PlainText);
    auto* const copy_all = new QPushButton(localized(L"&Copy", 45592), this);
    copy_all->setObjectName("copy");
    copy_all->setAutoDefault(false);
    connect(copy_all, &QPushButton::clicked, this, [this] { copy(); });
    addRow(localized(L"Sun", 45558), m_events, {copy_all});
    m_hours = new QTableWidget(0, 3, this);
    m_hours->setObjectName("hours");
    m_hours->setAccessibleName(localized(L"The sun at each hour", 45593));
    m_hours->setHorizontalHeaderLabels({localized(L"Time", 45594),
                                        localized(L"Azimuth, clockwise from north", 45595),
                                        localized(L"Altitude", 45596)});
    m_hours->horizontalHeader()->setSectionResizeMode(QHeaderView::ResizeToContents);
    m_hours->horizontalHeader()->setStretchLastSection(true);
    m_hours->verticalHeader()->hide();
    m_hours->verticalHeader()->setDefaultSectionSize(m_hours->fontMetrics().height() + 5);
    m_hours->setTabKeyNavigation(false);
    m_hours->setMinimumSize(460, 220);
    column().addWidget(m_hours, 1);
}

void AlmanacForm::review() {
    forgetFlaws();
    m_hours->setRowCount(0);
    const auto site = m_place->site();
    const auto clock = m_place->clock();
    if (!site || !clock) {
        const QString flaw = m_place->placeFlaw();
        m_events->setText(flaw.isEmpty() ? m_place->zoneFlaw() : flaw);
        return;
    }
    m_day->setPlace(site->latitude_deg, *clock);
    m_events->setText(eventsText(daylightTimes(*site, *clock, m_day->day()), *clock));
    fillTable(*site, *clock);
}

/// An hour that clocks skip is not there, one that they show twice is there twice.
void AlmanacForm::fillTable(const StudiedSite& site, const Zone& clock) {
    const local_days midnight(m_day->day());
    const sys_seconds end = clock.read(midnight + days(1)).first;
    for (sys_seconds moment = clock.read(midnight).first; moment < end; moment += hours(1)) {
        const SunPosition sun = sunPosition({site.latitude_deg, site.longitude_deg}, moment);
        const int row = m_hours->rowCount();
        m_hours->insertRow(row);
        m_hours->setItem(row, 0, cell(QString::fromStdString(timeWithZone(clock.at(moment)))));
        m_hours->setItem(row, 1, cell(degreesText(sun.azimuth_deg)));
        m_hours->setItem(row, 2, cell(degreesText(sun.altitude_deg)));
    }
}

/// As a table that other programs take.
void AlmanacForm::copy() const {
    QStringList lines = {m_place->place()->text(), m_day->date()->text(), m_events->text()};
    for (int row = 0; row < m_hours->rowCount(); ++row) {
        QStringList cells;
        for (int column = 0; column < m_hours->columnCount(); ++column)
            cells << m_hours->item(row, column)->text();
        lines << cells.join('\t');
    }
    QApplication::clipboard()->setText(lines.join('\n') + '\n');
}

} // namespace quarn::desktop
