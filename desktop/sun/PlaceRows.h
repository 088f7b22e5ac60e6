#pragma once

#include "host/clock/Zone.h"
#include "host/front_end/FrontEndChoices.h"
#include "host/session/StudiedSite.h"

#include <QObject>

#include <optional>

class QDoubleSpinBox;
class QLabel;
class QLineEdit;
class QPushButton;

namespace quarn::desktop {

/// The fields of a place: a city or coordinates, typed or found on the map, its clocks, and how the
/// model is turned there. The clocks are those of the place until the person names others.
///
/// They are called `place`, `map`, `zone` and `north`.
class PlaceRows final : public QObject {
    Q_OBJECT
public:
    PlaceRows(const StudiedSite& offered, QWidget* form);

    QLineEdit* place() const { return m_place; }
    QPushButton* map() const { return m_map; }
    QLineEdit* zone() const { return m_zone; }
    QDoubleSpinBox* north() const { return m_north; }

    /// The place that is entered; nothing while a field cannot be taken.
    std::optional<StudiedSite> site() const;
    std::optional<Zone> clock() const;
    /// Why a field cannot be taken, in a sentence; empty where it can.
    QString placeFlaw() const;
    QString zoneFlaw() const;

signals:
    void changed();

private:
    struct Found {
        std::string city; ///< empty: coordinates
        Place place;
        std::string zone;
    };
    std::optional<Found> found() const;
    void show(const Place& place);
    void choose();
    void followPlace();
    void suggest(const QString& typed);

    QLineEdit* m_place;
    QPushButton* m_map;
    QLineEdit* m_zone;
    QDoubleSpinBox* m_north;
    bool m_has_own_zone; ///< that the person named
};

} // namespace quarn::desktop
