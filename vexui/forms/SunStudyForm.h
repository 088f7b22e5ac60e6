#pragma once

#include "vexui/forms/Form.h"
#include "vexui/forms/PlaceFields.h"
#include "vexui/forms/StudyFrames.h"

class QDateEdit;
class QLabel;
class QTimeEdit;

namespace vexui {

class CountField;
class NumberField;

/// What the forms of both sun studies have in common: place, time, step, and recording.
class SunStudyForm : public Form {
public:
    /// Writes the selections, the name, the place, and start, end and step of the study.
    void takeInto(IZoetrixDataUI& lists, KM_3dmAnimationProperties& record) const override;

protected:
    /// First and last moment of a study, without a zone.
    struct Span {
        QDateTime start;
        QDateTime end;
    };

    SunStudyForm(const char* name, const QString& title, QWidget* owner);

    void addPlace(const KM_3dmAnimationProperties& record);
    /// A section for the times, with the zone they are of.
    QFormLayout& addTimes();
    /// Both show the nearest that a calendar or clock knows, whatever numbers they are given.
    /// @param is_offered  whether it is among what the sun offers: a person who changes it wants
    ///                    nothing else offered
    QDateEdit& addDate(QFormLayout& section, const Caption& caption, int year, int month, int day,
                       bool is_offered);
    QTimeEdit& addTime(QFormLayout& section, const Caption& caption, int hour, int minute);
    /// @param fault  told when the step is no number or negative
    void addStep(QFormLayout& section, const Caption& caption, int step, int longest,
                 const QString& fault);
    /// Ends the construction, when all else is there.
    void finishWith(const IZoetrixDataUI& lists, const KM_3dmAnimationProperties& record);

    void review() override;
    int step() const;
    /// The place that stands in the fields; nothing while one cannot be taken.
    std::optional<QnSunStudyPlace> place() const { return m_place.place(); }
    virtual bool isOneDay() const = 0;
    /// Has the times of a record go with the sun of a place.
    virtual void offer(const QnSunStudyPlace& place, KM_3dmAnimationProperties& record) const = 0;
    /// Shows the times of a record in the fields.
    virtual void showTimes(const KM_3dmAnimationProperties& record) = 0;
    virtual Span span() const = 0;
    virtual std::int64_t stepInSeconds() const = 0;
    virtual void takeStep(KM_3dmAnimationProperties& record) const = 0;
    /// Tells how many frames there are, at least one, and when they are.
    virtual QString momentsText(const QDateTime& start, const StudyFrames& frames) const = 0;

private:
    void addChooser(QFormLayout& section);
    void addNumber(QFormLayout& section, const Caption& caption, NumberField& field);
    void addClocks(QFormLayout& section, const KM_3dmAnimationProperties& record);
    void changedByPerson();
    void offerTimes();
    void tellLocalTimes();
    Outcome outcome() const;

    PlaceFields m_place;
    CountField* m_step = nullptr;
    RecordingFields m_recording;
    QLabel* m_local_times = nullptr;
    bool m_is_offering = false;
    bool m_offers_times = false; ///< nobody has chosen times yet: they go with the sun
};

} // namespace vexui
