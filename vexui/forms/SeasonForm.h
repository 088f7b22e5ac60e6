#pragma once

#include "vexui/forms/SunStudyForm.h"

namespace vexui {

/// The form of a sun study at one time of day, over many days.
class SeasonForm final : public SunStudyForm {
public:
    SeasonForm(const IZoetrixDataUI& lists, const KM_3dmAnimationProperties& record,
               QWidget* owner);

protected:
    Span span() const override;
    std::int64_t stepInSeconds() const override;
    bool isOneDay() const override { return false; }
    void offer(const QnSunStudyPlace& place, KM_3dmAnimationProperties& record) const override;
    void showTimes(const KM_3dmAnimationProperties& record) override;
    void takeStep(KM_3dmAnimationProperties& record) const override;
    QString momentsText(const QDateTime& start, const StudyFrames& frames) const override;

private:
    QDateEdit* m_start = nullptr;
    QDateEdit* m_end = nullptr;
    QTimeEdit* m_time = nullptr;
};

} // namespace vexui
