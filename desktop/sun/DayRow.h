#pragma once

#include "host/clock/Zone.h"

#include <QDate>
#include <QObject>

class QComboBox;
class QDateEdit;

namespace quarn::desktop {

/// The fields of a day: a date, and a list of days that the sun names, which set it.
///
/// They are called `date` and `namedDay`.
class DayRow final : public QObject {
    Q_OBJECT
public:
    /// Begins today.
    explicit DayRow(QWidget* form);

    QDateEdit* date() const { return m_date; }
    QComboBox* named() const { return m_named; }
    std::chrono::year_month_day day() const;
    /// Which day today is, and which days the sun names there.
    void setPlace(double latitude_deg, const Zone& clock);

signals:
    void changed();

private:
    enum Named { other, today, march_equinox, longest, september_equinox, shortest };
    QDate dateOf(int named, int year) const;
    void showName();

    QDateEdit* m_date;
    QComboBox* m_named;
    double m_latitude_deg = 0.0;
    Zone m_clock = Zone::fixed({});
};

/// A date field that shows dates as the user's language does.
QDateEdit* makeDateField(const char* name, QWidget* form);

} // namespace quarn::desktop
