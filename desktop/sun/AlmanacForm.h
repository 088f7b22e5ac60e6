#pragma once

#include "desktop/sun/SunDialog.h"
#include "host/clock/Zone.h"
#include "host/session/StudiedSite.h"

class QLabel;
class QTableWidget;

namespace quarn::desktop {

class DayRow;
class PlaceRows;

/// Tells where the sun stands on a day at a place, by the clocks there.
///
/// Its fields are called as those of PlaceRows and DayRow, what happens that day is in `events`,
/// the table `hours`, the button that copies all of it `copy`.
class AlmanacForm final : public SunDialog {
public:
    AlmanacForm(const StudiedSite& offered, QWidget* owner);

private:
    void addTable();
    void review();
    void fillTable(const StudiedSite& site, const Zone& clock);
    void copy() const;

    PlaceRows* m_place;
    DayRow* m_day;
    QLabel* m_events = nullptr;
    QTableWidget* m_hours = nullptr;
};

} // namespace quarn::desktop
