#include "vexui/forms/SunStudyForm.h"

#include "vexui/forms/CountField.h"
#include "vexui/forms/NumberField.h"
#include "vexui/texts/LocalText.h"

#include <QDateEdit>
#include <QFormLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QTimeEdit>

#include <algorithm>
#include <array>
#include <cstdlib>
#include <limits>

namespace vexui {

namespace {

/// The nearest date of the calendar to any three numbers, of the years that a date field shows.
QDate nearestDate(int year, int month, int day) {
    const QDate first(std::clamp(year, 100, 9999), std::clamp(month, 1, 12), 1);
    return first.addDays(std::clamp(day, 1, first.daysInMonth()) - 1);
}

QTime nearestTime(int hour, int minute) {
    return {std::clamp(hour, 0, 23), std::clamp(minute, 0, 59)};
}

/// A step without its sign, as the commands take it at the command line.
int magnitude(int step) {
    return step == std::numeric_limits<int>::min() ? std::numeric_limits<int>::max()
                                                   : std::abs(step);
}

void takeStart(const QDateTime& start, KM_3dmAnimationProperties& record) {
    record.SetStartYear(start.date().year());
    record.SetStartMonth(start.date().month());
    record.SetStartDay(start.date().day());
    record.SetStartHour(start.time().hour());
    record.SetStartMinutes(start.time().minute());
    record.SetStartSeconds(start.time().second());
}

void takeEnd(const QDateTime& end, KM_3dmAnimationProperties& record) {
    record.SetEndYear(end.date().year());
    record.SetEndMonth(end.date().month());
    record.SetEndDay(end.date().day());
    record.SetEndHour(end.time().hour());
    record.SetEndMinutes(end.time().minute());
    record.SetEndSeconds(end.time().second());
}

/// Nobody has set times up in the document: they are those that every record begins with.
bool hasFirstTimes(const KM_3dmAnimationProperties& record) {
    const KM_3dmAnimationProperties fresh;
    const auto times = [](const KM_3dmAnimationProperties& of) {
        return std::array{of.StartYear(),    of.StartMonth(),   of.StartDay(),  of.StartHour(),
                          of.StartMinutes(), of.StartSeconds(), of.EndYear(),   of.EndMonth(),
                          of.EndDay(),       of.EndHour(),      of.EndMinutes()};
    };
    return !record.IsSunStudy() && times(record) == times(fresh);
}

} // namespace

SunStudyForm::SunStudyForm(const char* name, const QString& title, QWidget* owner)
    : Form(name, title, owner) {}

// ---- Fields

void SunStudyForm::addNumber(QFormLayout& section, const Caption& caption, NumberField& field) {
    addField(section, caption, field);
    connect(&field, &QLineEdit::textChanged, this, [this] { review(); });
}

void SunStudyForm::addPlace(const KM_3dmAnimationProperties& record) {
    m_place.zone = new QLabel(this);
    m_place.zone->setObjectName(QString::fromLatin1("zone"));
    m_place.zone->setTextFormat(Qt::PlainText);
    QFormLayout& section = addSection(localText(L"Place", 44008));
    m_place.latitude = new NumberField(-90.0, 90.0, this);
    addNumber(
        section,
        {"latitude", localText(L"&Latitude:", 44026),
         localText(L"Degrees north of the equator, from -90 to 90; south is negative", 44046)},
        *m_place.latitude);
    m_place.longitude = new NumberField(-180.0, 180.0, this);
    addNumber(section,
              {"longitude", localText(L"L&ongitude:", 44027),
               localText(L"Degrees east of Greenwich, from -180 to 180; west is negative", 44047)},
              *m_place.longitude);
    addChooser(section);
    m_place.north_angle = new NumberField(-360.0, 360.0, this);
    addNumber(section,
              {"northAngle", localText(L"North &angle:", 44029),
               localText(L"Where north is in the model: degrees clockwise from the Y axis, seen "
                         L"from above",
                         44049)},
              *m_place.north_angle);
    m_place.show(record);
    addClocks(section, record);
    check(*m_place.latitude, [this] { return m_place.latitudeFault(); });
    check(*m_place.longitude, [this] { return m_place.longitudeFault(); });
    check(*m_place.north_angle, [this] { return m_place.northAngleFault(); });
}

void SunStudyForm::addChooser(QFormLayout& section) {
    auto* button = new QPushButton(localText(L"C&hoose Place...", 44028), this);
    button->setObjectName(QString::fromLatin1("choosePlace"));
    button->setToolTip(localText(L"Find the place in a table of cities or on a map", 44048));
    button->setAutoDefault(false);
    connect(button, &QPushButton::clicked, this, [this] { m_place.choose(); });
    addBeneath(section, *button);
    m_place.city = new QLabel(this);
    m_place.city->setObjectName(QString::fromLatin1("city"));
    m_place.city->setTextFormat(Qt::PlainText);
    addBeneath(section, *m_place.city);
    addToTabOrder(*button);
}

void SunStudyForm::addClocks(QFormLayout& section, const KM_3dmAnimationProperties& record) {
    QnSunStudyPlace kept = QnPlaceOfSunStudy(record);
    const QString own = toQt(kept.clocks);
    kept.clocks = {};
    m_place.has_own_clocks = !own.isEmpty() && own != toQt(QnClocksOfSunStudy(kept));
    m_place.clocks = new QLineEdit(own, this);
    addField(section,
             {"clocks", localText(L"Cloc&ks there:", 44123),
              localText(L"Whose time the clocks on the walls show: Europe/Berlin, +05:30 or solar; "
                        L"empty: that of the nearest city",
                        44124)},
             *m_place.clocks);
    check(*m_place.clocks, [this] { return m_place.clocksFault(); });
    connect(m_place.clocks, &QLineEdit::textEdited, this, [this](const QString& text) {
        m_place.has_own_clocks = !text.trimmed().isEmpty();
        review();
    });
}

QFormLayout& SunStudyForm::addTimes() {
    QFormLayout& section = addSection(localText(L"Time", 44009));
    section.addRow(m_place.zone);
    m_local_times = new QLabel(this);
    m_local_times->setObjectName(QString::fromLatin1("localTimes"));
    m_local_times->setTextFormat(Qt::PlainText);
    m_local_times->setWordWrap(true);
    m_local_times->setMinimumHeight(2 * m_local_times->fontMetrics().lineSpacing() + 2);
    return section;
}

QDateEdit& SunStudyForm::addDate(QFormLayout& section, const Caption& caption, int year, int month,
                                 int day, bool is_offered) {
    auto* field = new QDateEdit(this);
    field->setDisplayFormat(QString::fromLatin1("yyyy-MM-dd"));
    field->setCalendarPopup(true);
    field->setDateRange(QDate(100, 1, 1), QDate(9999, 12, 31));
    field->setDate(nearestDate(year, month, day));
    addField(section, caption, *field);
    connect(field, &QDateEdit::dateChanged, this, [this, is_offered] {
        if (is_offered)
            changedByPerson();
        review();
    });
    return *field;
}

QTimeEdit& SunStudyForm::addTime(QFormLayout& section, const Caption& caption, int hour,
                                 int minute) {
    auto* field = new QTimeEdit(nearestTime(hour, minute), this);
    field->setDisplayFormat(QString::fromLatin1("HH:mm"));
    addField(section, caption, *field);
    connect(field, &QTimeEdit::timeChanged, this, [this] {
        changedByPerson();
        review();
    });
    return *field;
}

void SunStudyForm::addStep(QFormLayout& section, const Caption& caption, int step, int longest,
                           const QString& fault) {
    m_step = new CountField(0, longest, this);
    m_step->setValue(magnitude(step));
    addCount(section, caption, *m_step);
    section.addRow(m_local_times);
    check(*m_step, [this, fault] { return m_step->count().value_or(-1) < 0 ? fault : QString(); });
}

void SunStudyForm::finishWith(const IZoetrixDataUI& lists,
                              const KM_3dmAnimationProperties& record) {
    beginColumn();
    m_offers_times = hasFirstTimes(record);
    m_recording = addRecording(lists, record, BadCharacters::refused);
    finish([this] { return outcome(); });
}

// ---- What comes out

int SunStudyForm::step() const {
    return m_step->count().value_or(0);
}

void SunStudyForm::review() {
    if (!m_local_times || m_is_offering)
        return;
    m_place.tellZone();
    m_place.followPlace();
    offerTimes();
    tellLocalTimes();
    Form::review();
}

void SunStudyForm::changedByPerson() {
    if (!m_is_offering)
        m_offers_times = false;
}

void SunStudyForm::offerTimes() {
    const std::optional<QnSunStudyPlace> here = place();
    if (!m_offers_times || !here)
        return;
    KM_3dmAnimationProperties times;
    takeStart(span().start, times);
    takeEnd(span().end, times);
    takeStep(times);
    offer(*here, times);
    m_is_offering = true;
    showTimes(times);
    m_is_offering = false;
}

void SunStudyForm::tellLocalTimes() {
    const std::optional<QnSunStudyPlace> here = place();
    KM_3dmAnimationProperties times;
    takeStart(span().start, times);
    takeEnd(span().end, times);
    m_local_times->setText(here ? toQt(QnLocalTimesOfSunStudy(*here, times, isOneDay()))
                                : QString());
}

Outcome SunStudyForm::outcome() const {
    const Span study = span();
    const StudyFrames frames = studyFrames(study.start, study.end, stepInSeconds());
    if (frames.count == 0)
        return {localText(L"The end is before the start: there will be no frames.", 44086), true};
    if (stepInSeconds() == 0)
        return {localText(L"Without time between frames there is one frame, the first.", 44088),
                true};
    if (frames.count > many_frames)
        return {manyFramesText(frames.count), true};
    return {momentsText(study.start, frames)};
}

void SunStudyForm::takeInto(IZoetrixDataUI& lists, KM_3dmAnimationProperties& record) const {
    m_recording.takeInto(lists, record);
    m_place.takeInto(record);
    const Span study = span();
    takeStart(study.start, record);
    takeEnd(study.end, record);
    takeStep(record);
}

} // namespace vexui
