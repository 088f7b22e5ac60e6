#pragma once

#include "host/cities/Cities.h"
#include "host/front_end/FrontEndChoices.h"
#include "sdk/qncore/QnExport.h"

#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace quarn {

/// The size of a picture of the whole earth in which degrees are lengths (plate carrée): its left
/// edge is the longitude -180, its upper edge the latitude 90.
struct WorldMapSize {
    double width = 0.0; ///< in whatever unit the picture is measured
    double height = 0.0;
};

/// A position in such a picture, from its upper left corner.
struct WorldMapPoint {
    double x = 0.0;
    double y = 0.0;
};

/// Where a place is in the picture.
QNCORE_API WorldMapPoint worldMapPoint(const Place& place, const WorldMapSize& size);

/// The place at a position of the picture; one beside the picture counts as the nearest on its
/// edge. In a picture without a size every position is latitude 0, longitude 0.
QNCORE_API Place placeOnWorldMap(const WorldMapPoint& point, const WorldMapSize& size);

/// Reads an angle as people type it: digits with a point or a comma, a sign, and behind them a
/// degree sign, `N`, `S`, `E` or `W` if they like; south and west turn the sign.
///
/// @param text       blanks around it do not matter
/// @param north      the letter of the positive side, `N` or `E`; it and its opposite are read
/// @return degrees, of any size; nothing for another text
QNCORE_API std::optional<double> angleFromText(std::wstring_view text, wchar_t north);

/// An angle as it is shown: a point, and no more decimals than it has, at most four.
QNCORE_API std::wstring textFromAngle(double angle_deg);

/// What a person sees and does while choosing a place: two typed angles, a search for cities, a
/// map. It knows nothing of windows; whoever shows one keeps it beside the controls.
class QNCORE_API LocationChoice {
public:
    /// What is wrong with a typed angle.
    enum class Flaw { none, no_number, out_of_range };

    /// Begins at a place, with all cities listed.
    explicit LocationChoice(const Place& start);

    const std::wstring& latitudeText() const { return m_latitude.text; }
    const std::wstring& longitudeText() const { return m_longitude.text; }
    /// The text that stands in the field now, whatever it is.
    void typeLatitude(std::wstring_view text);
    void typeLongitude(std::wstring_view text);
    /// Out of range is a latitude outside -90 to 90, or a longitude outside -180 to 180.
    Flaw latitudeFlaw() const { return m_latitude.flaw; }
    Flaw longitudeFlaw() const { return m_longitude.flaw; }

    bool isValid() const;
    /// The place that is typed; nothing unless both angles are valid.
    std::optional<Place> place() const;
    /// Puts a place into both fields, as textFromAngle writes it. The place is kept as it is until
    /// somebody types.
    void choose(const Place& place);
    void choose(const City& city);

    /// Lists the cities that somebody means by a name, or by the beginning of one: of the city, of
    /// one of the words of its name, or of its country. Where there is none, those whose name is
    /// like it. An empty text lists all cities.
    /// @param text  as findCity takes it; a comma parts the city from the beginning of a country
    void search(std::wstring_view text);
    /// The cities that are listed. After a search those found by the name come first, then by a
    /// word of it, then by the country; among each other they are in the order of cities().
    std::span<const City* const> listedCities() const { return m_listed; }

    /// The city at the chosen place, to a hundredth of a degree; null where there is none.
    const City* cityHere() const;
    /// The city nearest to the chosen place along a great circle; null when there is no place.
    const City* nearestCity() const;

private:
    struct Angle {
        std::wstring text;
        double value_deg = 0.0;
        Flaw flaw = Flaw::none;

        void show(double angle_deg);
        void type(std::wstring_view typed, wchar_t north, double limit_deg);
    };

    Angle m_latitude;
    Angle m_longitude;
    std::vector<const City*> m_listed;
};

} // namespace quarn
