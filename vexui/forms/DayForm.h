#pragma once

#include "vexui/forms/SunStudyForm.h"

class QComboBox;

namespace vexui {

/// The form of a sun study of one day.
class DayForm final : public SunStudyForm {
public:
    DayForm(const IZoetrixDataUI& lists, const KM_3dmAnimationProperties& record, QWidget* owner);

protected:
    Span span() const override;
    std::int64_t stepInSeconds() const override;
    bool isOneDay() const override { return true; }
    void offer(const QnSunStudyPlace& place, KM_3dmAnimationProperties& record) const override;
    void showTimes(const KM_3dmAnimationProperties& record) override;
    void review() override;
    void takeStep(KM_3dmAnimationProperties& record) const override;
    QString momentsText(const QDateTime& start, const StudyFrames& frames) const override;

private:
    void addNamedDays(QFormLayout& section);
    void showNamedDays();

    QComboBox* m_named = nullptr;
    QDateEdit* m_date = nullptr;
    QTimeEdit* m_start = nullptr;
    QTimeEdit* m_end = nullptr;
};

} // namespace vexui
