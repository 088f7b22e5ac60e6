#include "vexui/forms/DayForm.h"

#include "vexui/texts/LocalText.h"

#include <QComboBox>
#include <QDateEdit>
#include <QFormLayout>
#include <QLocale>
#include <QTimeEdit>

namespace vexui {

namespace {

constexpr int minutes_of_a_day = 1440;

QDate dateOf(const QnSunStudyDay& day) {
    return {day.year, day.month, day.day};
}

/// Of a document that nobody has set a day up in: today, by the clocks there.
QDate firstDate(const KM_3dmAnimationProperties& record) {
    const KM_3dmAnimationProperties fresh;
    const QDate date(record.StartYear(), record.StartMonth(), record.StartDay());
    const QDate first(fresh.StartYear(), fresh.StartMonth(), fresh.StartDay());
    if (record.IsSunStudy() || date != first)
        return date;
    return dateOf(QnDaysOfSunStudy(QnPlaceOfSunStudy(record), first.year())[0]);
}

QString clockText(const QDateTime& moment) {
    return moment.toString(QString::fromLatin1("HH:mm"));
}

} // namespace

DayForm::DayForm(const IZoetrixDataUI& lists, const KM_3dmAnimationProperties& record,
                 QWidget* owner)
    : SunStudyForm("dayForm", localText(L"One-Day Sun Study", 44003), owner) {
    addPlace(record);
    QFormLayout& section = addTimes();
    const QDate first = firstDate(record);
    const bool is_date = first.isValid();
    m_date = &addDate(
        section,
        {"date", localText(L"&Date:", 44030), localText(L"The day whose sun is shown", 44050)},
        is_date ? first.year() : record.StartYear(), is_date ? first.month() : record.StartMonth(),
        is_date ? first.day() : record.StartDay(), false);
    addNamedDays(section);
    m_start = &addTime(section,
                       {"startTime", localText(L"&Start time:", 44031),
                        localText(L"The time of the first frame", 44051)},
                       record.StartHour(), record.StartMinutes());
    m_end = &addTime(section,
                     {"endTime", localText(L"&End time:", 44032),
                      localText(L"No frame is later; one can be exactly then", 44052)},
                     record.EndHour(), record.EndMinutes());
    addStep(section,
            {"minutes", localText(L"&Minutes between frames:", 44033),
             localText(L"How many minutes pass from each frame to the next", 44053)},
            record.MinutesBetweenFrames(), minutes_of_a_day,
            localText(L"Enter how many minutes are between frames, 0 or more.", 44079));
    finishWith(lists, record);
}

void DayForm::addNamedDays(QFormLayout& section) {
    m_named = new QComboBox(this);
    addField(section,
             {"namedDay", localText(L"Day of the s&un:", 44126),
              localText(L"Days that the sun names; one that is chosen becomes the date", 44127)},
             *m_named);
    connect(m_named, &QComboBox::activated, this, [this](int) {
        const QDate chosen = m_named->currentData().toDate();
        if (chosen.isValid())
            m_date->setDate(chosen);
    });
}

/// An entry without a name is shown while the date is none of these.
void DayForm::showNamedDays() {
    const std::optional<QnSunStudyPlace> here = place();
    m_named->clear();
    m_named->addItem(QString());
    if (!here)
        return;
    for (const QnSunStudyDay& day : QnDaysOfSunStudy(*here, m_date->date().year())) {
        m_named->addItem(toQt(day.name), dateOf(day));
        if (dateOf(day) == m_date->date())
            m_named->setCurrentIndex(m_named->count() - 1);
    }
}

void DayForm::review() {
    if (m_end)
        showNamedDays();
    SunStudyForm::review();
}

void DayForm::offer(const QnSunStudyPlace& place, KM_3dmAnimationProperties& record) const {
    QnOfferSunTimes(place, record);
}

/// The date is the person's; the sun may be up a day earlier by the study's own clock.
void DayForm::showTimes(const KM_3dmAnimationProperties& record) {
    m_start->setTime({record.StartHour(), record.StartMinutes()});
    m_end->setTime({record.EndHour(), record.EndMinutes()});
}

SunStudyForm::Span DayForm::span() const {
    return {QDateTime(m_date->date(), m_start->time(), Qt::UTC),
            QDateTime(m_date->date(), m_end->time(), Qt::UTC)};
}

std::int64_t DayForm::stepInSeconds() const {
    return step() * std::int64_t{60};
}

void DayForm::takeStep(KM_3dmAnimationProperties& record) const {
    record.SetMinutesBetweenFrames(step());
}

QString DayForm::momentsText(const QDateTime& start, const StudyFrames& frames) const {
    if (frames.count == 1)
        return localText(L"1 frame, at %1.", 44104).arg(clockText(start));
    return localText(L"%1 frames, the first at %2, the last at %3.", 44105)
        .arg(QLocale().toString(static_cast<qlonglong>(frames.count)), clockText(start),
             clockText(frames.last));
}

} // namespace vexui
