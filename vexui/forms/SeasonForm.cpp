#include "vexui/forms/SeasonForm.h"

#include "vexui/texts/LocalText.h"

#include <QDateEdit>
#include <QFormLayout>
#include <QLocale>
#include <QTimeEdit>

namespace vexui {

namespace {

constexpr int longest_step_days = 36'525;

QString dateText(const QDateTime& moment) {
    return moment.toString(QString::fromLatin1("yyyy-MM-dd"));
}

} // namespace

SeasonForm::SeasonForm(const IZoetrixDataUI& lists, const KM_3dmAnimationProperties& record,
                       QWidget* owner)
    : SunStudyForm("seasonForm", localText(L"Seasonal Sun Study", 44004), owner) {
    addPlace(record);
    QFormLayout& section = addTimes();
    m_start = &addDate(section,
                       {"startDate", localText(L"&Start date:", 44034),
                        localText(L"The day of the first frame", 44054)},
                       record.StartYear(), record.StartMonth(), record.StartDay(), true);
    m_end = &addDate(section,
                     {"endDate", localText(L"&End date:", 44035),
                      localText(L"No frame is later; one can be on that day", 44055)},
                     record.EndYear(), record.EndMonth(), record.EndDay(), true);
    m_time = &addTime(section,
                      {"timeOfDay", localText(L"Time of &day:", 44036),
                       localText(L"The time of every frame", 44056)},
                      record.StartHour(), record.StartMinutes());
    addStep(section,
            {"days", localText(L"Da&ys between frames:", 44037),
             localText(L"How many days pass from each frame to the next", 44057)},
            record.DaysBetweenFrames(), longest_step_days,
            localText(L"Enter how many days are between frames, 0 or more.", 44080));
    finishWith(lists, record);
}

void SeasonForm::offer(const QnSunStudyPlace& place, KM_3dmAnimationProperties& record) const {
    QnOfferSunYear(place, record);
}

void SeasonForm::showTimes(const KM_3dmAnimationProperties& record) {
    m_start->setDate({record.StartYear(), record.StartMonth(), record.StartDay()});
    m_end->setDate({record.EndYear(), record.EndMonth(), record.EndDay()});
    m_time->setTime({record.StartHour(), record.StartMinutes()});
}

SunStudyForm::Span SeasonForm::span() const {
    return {QDateTime(m_start->date(), m_time->time(), Qt::UTC),
            QDateTime(m_end->date(), m_time->time(), Qt::UTC)};
}

std::int64_t SeasonForm::stepInSeconds() const {
    return step() * std::int64_t{86'400};
}

void SeasonForm::takeStep(KM_3dmAnimationProperties& record) const {
    record.SetDaysBetweenFrames(step());
}

QString SeasonForm::momentsText(const QDateTime& start, const StudyFrames& frames) const {
    if (frames.count == 1)
        return localText(L"1 frame, on %1.", 44106).arg(dateText(start));
    return localText(L"%1 frames, the first on %2, the last on %3.", 44107)
        .arg(QLocale().toString(static_cast<qlonglong>(frames.count)), dateText(start),
             dateText(frames.last));
}

} // namespace vexui
