#pragma once

#include "desktop/sun/SunDialog.h"
#include "desktop/sun/SunOffer.h"
#include "host/session/SunHours.h"

class QCheckBox;
class QComboBox;
class QDateEdit;
class QLabel;
class QLineEdit;
class QSpinBox;
class QTimeEdit;

namespace quarn::desktop {

class DayRow;
class PlaceRows;

/// Asks which hours of sun are to be found, in which picture, and where the files go.
///
/// Its fields are called as those of PlaceRows and DayRow, and `several`, `lastDate`, `everyDays`,
/// `wholeDay`, `from`, `to`, `minutes`, `picture`, `lines`, `folder` and `chooseFolder`; what the
/// sun does that day stands in `daylight`.
class HoursForm final : public SunDialog {
public:
    HoursForm(const SunOffer& offer, QWidget* owner);

    /// What is asked for, once the form was taken.
    SunHoursRequest request() const;
    StudiedSite site() const;

private:
    void addDays();
    void addTimes();
    void addPicture();
    void addFolder();
    void addChecks();
    void review();

    SunOffer m_offer;
    PlaceRows* m_place;
    DayRow* m_day;
    QCheckBox* m_several = nullptr;
    QDateEdit* m_last_date = nullptr;
    QSpinBox* m_every_days = nullptr;
    QCheckBox* m_whole_day = nullptr;
    QTimeEdit* m_from = nullptr;
    QTimeEdit* m_to = nullptr;
    QLabel* m_daylight = nullptr;
    QSpinBox* m_minutes = nullptr;
    QComboBox* m_picture = nullptr;
    QCheckBox* m_lines = nullptr;
    QLineEdit* m_folder = nullptr;
};

} // namespace quarn::desktop
