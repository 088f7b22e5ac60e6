#include "vexui/forms/DayForm.h"

#include "vexui/texts/LocalText.h"

#include <QDateEdit>
#include <QFormLayout>
#include <QLocale>
#include <QTimeEdit>

namespace vexui {

namespace {

constexpr int minutes_of_a_day = 1440;

QString clockText(const QDateTime& moment) {
    return moment.toString(QString::fromLatin1("HH:mm"));
}

} // namespace

DayForm::DayForm(const IZoetrixDataUI& lists, const KM_3dmAnimationProperties& record,
                 QWidget* owner)
    : SunStudyForm("dayForm", localText(L"One-Day Sun Study", 44003), owner) {
    addPlace(record);
    QFormLayout& section = addTimes();
    m_date = &addDate(
        section,
        {"date", localText(L"&Date:", 44030), localText(L"The day whose sun is shown", 44050)},
        record.StartYear(), record.StartMonth(), record.StartDay());
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
