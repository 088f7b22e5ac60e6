#pragma once

#include "host/cities/LocationChoice.h"
#include "host/front_end/FrontEndChoices.h"

#include <QDialog>

#include <optional>
#include <string_view>

class QLabel;
class QLayout;
class QLineEdit;
class QPushButton;
class QTableView;

namespace quarn::desktop {

class CityTableModel;
class WorldMap;

/// Lets a person choose a place by its coordinates, among cities, or on a map of the world. What is
/// chosen in one of them shows in the others. Only a place on the earth can be confirmed.
///
/// Its widgets are called `search`, `cities`, `latitude`, `longitude`, `map`, `flaw` (the sentence
/// about a field that cannot be taken), `hover`, `ok` and `cancel`.
class LocationDialog final : public QDialog {
public:
    LocationDialog(QWidget* owner, std::wstring_view title, const Place& start);

    /// The place that is chosen now; nothing while a field cannot be taken.
    std::optional<Place> place() const { return m_choice.place(); }

protected:
    bool eventFilter(QObject* watched, QEvent* event) override;
    void showEvent(QShowEvent* event) override;

private:
    void layOut();
    QLayout* citiesSide();
    QLayout* mapSide();
    QLayout* fieldsRow();
    QLineEdit* makeAngleField(const char* name, const QString& hint);
    QLayout* buttonsRow();
    void connectParts();

    void search(const QString& text);
    void chooseFirstCity();
    bool wantsFirstCity() const;
    void showChoice();
    void showFlaws();
    void showCityRow();
    void showHovered(const std::optional<Place>& place);

    LocationChoice m_choice;
    CityTableModel* m_cities = nullptr;
    QLineEdit* m_search = nullptr;
    QTableView* m_table = nullptr;
    QLineEdit* m_latitude = nullptr;
    QLineEdit* m_longitude = nullptr;
    WorldMap* m_map = nullptr;
    QLabel* m_flaw = nullptr;
    QLabel* m_hover = nullptr;
    QPushButton* m_ok = nullptr;
    bool m_is_showing = false; ///< while the choice is shown, its widgets' changes are no choice
};

/// Shows a LocationDialog and waits until it is closed.
/// @return nothing when the person gave up
std::optional<Place> askPlace(QWidget* owner, std::wstring_view title, const Place& start);

} // namespace quarn::desktop
